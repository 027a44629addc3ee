#pragma once

#include <string>

#include "devices/charging/ChargedButtons.h"

/// What shows the charging of buttons.
class ChargingDisplay {
 public:
  virtual ~ChargingDisplay() = default;

  /// Shows the status; empty when there is none. A new button takes the sign of the last one away.
  virtual void SetStatus(const std::string& text) = 0;
  virtual void BeginButton() = 0;

  /// Shows whether there is a reader.
  virtual void SetReader(bool present) = 0;

  /// A touch has ended.
  virtual void Note(const ChargedButton& button) = 0;

  /// True once the window is to close: nothing more is asked, told or written.
  virtual bool Closing() const = 0;
};
