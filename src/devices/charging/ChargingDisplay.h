#pragma once

#include <string>

#include "devices/charging/ChargedButtons.h"

/// What shows the charging of buttons.
class ChargingDisplay {
 public:
  virtual ~ChargingDisplay() = default;

  /// Shows the status; empty when there is none.
  virtual void SetStatus(const std::string& text) = 0;

  /// A button was read, which takes the sign of the last one away.
  virtual void BeginButton() = 0;

  /// No button was met in a whole pass over the bus: the next one is a new touch.
  virtual void ButtonsLeft() = 0;

  /// Shows whether there is a reader.
  virtual void SetReader(bool present) = 0;

  /// A touch has ended.
  virtual void Note(const ChargedButton& button) = 0;

  /// True once the window is to close: nothing more is asked, told or written.
  virtual bool Closing() const = 0;
};
