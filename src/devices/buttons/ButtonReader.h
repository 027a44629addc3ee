#pragma once

#include <string>

#include "core/game/DallasId.h"
#include "core/line/ReaderPoll.h"
#include "platform/MessageBoxes.h"

/// Waits for a membership button to touch the reader, tick by tick.
class ButtonReader {
 public:
  /// Both must outlive this object.
  ButtonReader(OneWire& wire, MessageBoxes& boxes) : poll_(wire), boxes_(boxes) {}

  /// Forgets the last button and waits for the next one.
  void Activate();

  /// Makes the next tick the last one; a button that it reads still counts.
  void Cancel() { finished_ = true; }

  /// Looks once for a button. Boxes report a button that was read, a reader that does not answer and a
  /// failing driver. Returns true while there is more to wait for.
  bool Tick();

  /// The button that was read, or NoDallasId.
  const std::string& DallasID() const { return dallasId_; }

 private:
  void Poll();
  void TakeDevice();

  ReaderPoll poll_;
  MessageBoxes& boxes_;
  std::string dallasId_ = NoDallasId;
  bool finished_ = false;
};
