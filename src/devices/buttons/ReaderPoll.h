#pragma once

#include <array>

#include "platform/OneWire.h"

/// What a step along the bus came to. A bad read leaves open who is on the bus.
enum class BusStep { Device, End, BadRead };

/// How a window polls the reader: one session for each tick of its timer, and nothing held between two ticks
/// but the place in the walk along the bus. Throws what the driver throws.
class ReaderPoll {
 public:
  /// `wire` must outlive this object.
  explicit ReaderPoll(OneWire& wire) : wire_(wire) {}

  /// Begins a session on the default adapter. False when it cannot begin. End() is due in either case.
  bool Begin();

  /// Goes on to the next device. Behind anything but a device the next step begins at the first one.
  BusStep Next();

  /// ROM number of that device, family code first.
  std::array<std::uint8_t, 8> Rom();

  void End();

 private:
  OneWire& wire_;
  std::int16_t portNum_ = 0;
  std::int16_t portType_ = 0;
  std::int32_t sessionHandle_ = 0;
  bool setupDone_ = false;
  OneWireState stateBuffer_;
};
