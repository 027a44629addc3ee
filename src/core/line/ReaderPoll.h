#pragma once

#include <array>
#include <cstdint>
#include <span>

#include "platform/OneWire.h"

/// Result of one step of the search. After a bad read it is unknown what is on the bus.
enum class BusStep { Device, End, BadRead };

/// Polls the reader of buttons for a window: one session per tick of its timer. Between ticks only the
/// position in the search of the bus is kept. Throws what the driver throws.
class ReaderPoll {
 public:
  using RomNumber = std::array<std::uint8_t, 8>;  ///< family code first

  /// `wire` must outlive this object.
  explicit ReaderPoll(OneWire& wire) : wire_(wire) {}

  /// Begins a session on the default adapter; false if that fails. Call End() in either case.
  bool Begin();

  /// Moves on to the next device. After any other result the next call starts again at the first one.
  BusStep Next();

  /// ROM number of that device.
  RomNumber Rom();

  /// Selects that device. False if the bus does not answer.
  bool Access();

  /// Exchanges bytes with the selected device, in place: 255 reads. If the adapter does not answer, returns
  /// false and leaves `bytes` unchanged.
  bool Exchange(std::span<std::uint8_t> bytes);

  /// Looks for the device `rom` on the whole bus; Next() goes on where it was. No device is selected then.
  bool IsOnBus(const RomNumber& rom);

  void End();

  /// End() after the driver has thrown; what it throws again is dropped.
  void EndFailed();

 private:
  OneWire& wire_;
  std::int16_t portNum_ = 0;
  std::int16_t portType_ = 0;
  std::int32_t sessionHandle_ = 0;
  bool setupDone_ = false;
  OneWireState stateBuffer_;
};
