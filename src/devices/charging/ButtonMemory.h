#pragma once

#include "core/line/ReaderPoll.h"
#include "devices/charging/ChargeBlock.h"
#include "platform/EventPump.h"

/// The charge block in the memory of the device that the poll is at.
class ButtonMemory {
 public:
  /// Both must outlive this object.
  ButtonMemory(ReaderPoll& poll, EventPump& events) : poll_(poll), events_(events) {}

  /// Reads the block. False, with `block` unchanged, if the bus or the adapter does not answer or the bus did
  /// not take the command as it was sent. A button that leaves meanwhile reads as ones from then on.
  bool ReadBlock(ChargeBlock& block);

  /// Writes the block through the button's scratchpad. Whether the button took it is not known.
  void WriteBlock(const ChargeBlock& block);

 private:
  ReaderPoll& poll_;
  EventPump& events_;
};
