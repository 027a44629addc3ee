#pragma once

#include <array>
#include <cstdint>
#include <span>

/// What a driver keeps of the walk along the bus. Its owner hands the same one to every call, so that the
/// walk goes on where it stopped, in a later session too. A new one begins at the first device.
struct OneWireState {
  static constexpr int None = -1;

  bool Found = false;                 ///< the walk stands on a device
  std::array<std::uint8_t, 8> Rom{};  ///< its ROM number: family code, six bytes of serial number, CRC
  int Branch = None;  ///< bit of the ROM, 0 to 63, behind which devices are left; None: last one
};

/// Eight bytes of a ROM number, family code first, one in each element.
using OneWireRom = std::array<std::int16_t, 8>;

/// The 1-Wire bus behind the reader's adapter. A session has the adapter to itself; only one is open at a
/// time. A line or an adapter that fails in a session makes the operations fail, and the next session does
/// not start. Operations take a handle of an open session and do nothing on any other. A driver that cannot
/// work at all may throw; no operation hangs.
class OneWire {
 public:
  virtual ~OneWire() = default;

  /// The adapter that the settings name: port number (1 and up) and kind. Below 1 when they name none; the
  /// values are then not touched.
  virtual std::int16_t TMReadDefaultPort(std::int16_t& port, std::int16_t& type) = 0;

  /// Begins a session and makes sure that the adapter answers. Returns its handle, or 0 and below when the
  /// port, the adapter or that kind of adapter is not there, or is in use. `reserved` is 0.
  virtual std::int32_t TMExtendedStartSession(std::int16_t port, std::int16_t type,
                                              std::int32_t reserved = 0) = 0;

  /// Prepares the bus. 1 when done.
  virtual std::int16_t TMSetup(std::int32_t handle) = 0;

  /// Results of TMNext.
  static constexpr std::int16_t DeviceFound = 1;
  static constexpr std::int16_t EndOfBus = 0;
  static constexpr std::int16_t BadRead = -1;  ///< drivers may give any negative number

  /// Goes on to the next device. DeviceFound when there is one; it is then selected, and its number passed
  /// its CRC. EndOfBus at the end of the bus: behind the last one, and at once on a bus without any. Negative
  /// when nobody can tell: a bad read, a line or an adapter that failed, no session. After anything but 1 the
  /// next call begins at the first device again.
  virtual std::int16_t TMNext(std::int32_t handle, OneWireState& state) = 0;

  /// Reads the number of the device that the walk stands on. Element 0 of `rom` is 0 to ask for that. 1 when
  /// done.
  virtual std::int16_t TMRom(std::int32_t handle, OneWireState& state, OneWireRom& rom) = 0;

  /// Selects the device that the walk stands on. 1 when the bus answered.
  virtual std::int16_t TMAccess(std::int32_t handle, OneWireState& state) = 0;

  /// Sends a byte to the selected device and returns the one that was on the bus meanwhile, 0 to 255: the
  /// same when the device only listened. Send 255 to read. 255 also when nothing answers.
  virtual std::int16_t TMTouchByte(std::int32_t handle, std::uint8_t byte) = 0;

  /// The same for a block, in place. 1 when done; otherwise `bytes` is left as it was.
  virtual std::int16_t TMBlockStream(std::int32_t handle, std::span<std::uint8_t> bytes) = 0;

  /// Ends the session and lets go of the adapter. 1 when done.
  virtual std::int16_t TMEndSession(std::int32_t handle) = 0;
};
