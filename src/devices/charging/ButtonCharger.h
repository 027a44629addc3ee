#pragma once

#include "core/line/ReaderPoll.h"
#include "devices/charging/ButtonMemory.h"
#include "devices/charging/ChargingDisplay.h"
#include "platform/Clock.h"
#include "platform/EventPump.h"
#include "platform/MessageBoxes.h"

/// Charges the buttons that touch the reader, tick by tick, each once per touch. With the reader's own device
/// on the bus a pass without a button counts one device, which tells that the last button has left.
class ButtonCharger {
 public:
  /// All of it must outlive the object.
  struct Parts {
    OneWire& Wire;
    EventPump& Events;
    MessageBoxes& Boxes;
    const Clock& Time;
    ChargingDisplay& Display;
  };

  explicit ButtonCharger(const Parts& parts)
      : parts_(parts), poll_(parts.Wire), memory_(poll_, parts.Events) {}

  /// Makes one step along the bus, and charges the button that it meets. A reader that is missing is told
  /// once, until it was there again. Throws what the driver throws, likewise only once.
  void Tick();

  /// True while no session can be started.
  bool ReaderMissing() const { return readerMissing_; }

 private:
  enum class Reading { Good, Invalid, Failed };

  void Step();
  /// Returns true the first time.
  bool MissReader();
  void TakeDevice();
  /// Returns false if the button must be tried again.
  bool ChargeButton();
  /// Reads the block up to three times.
  Reading ReadWell(ChargeBlock& block);
  ChargeResult ReadBack(const ChargeBlock& written);
  void Note(ChargeResult result, std::optional<std::uint8_t> kind = {});

  const Parts parts_;
  ReaderPoll poll_;
  ButtonMemory memory_;
  ReaderPoll::RomNumber currentRom_{};  ///< of the device just found
  ReaderPoll::RomNumber lastRom_{};     ///< of the button charged last; zeros when it has left
  std::int16_t deviceCount_ = 0;        ///< devices in this pass over the bus
  bool metButton_ = false;              ///< one of them was not the reader's own
  bool readerMissing_ = false;
};
