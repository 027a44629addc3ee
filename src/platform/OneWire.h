#pragma once

#include <array>
#include <cstdint>
#include <span>

/// A driver's position in the walk along the bus. The caller passes the same object to every call, so that
/// the walk continues where it stopped, even in a later session. A new one starts at the first device.
struct OneWireState {
  static constexpr int None = -1;

  bool Found = false;                 ///< the walk is at a device
  std::array<std::uint8_t, 8> Rom{};  ///< its ROM number: family code, six bytes of serial number, CRC
  int Branch = None;                  ///< ROM bit, 0 to 63, where the walk branches next; None: last device
};

/// The eight bytes of a ROM number, family code first, one per element.
using OneWireRom = std::array<std::int16_t, 8>;

/// The 1-Wire bus behind the reader's adapter. A session has exclusive use of the adapter; only one is open
/// at a time. If the line or the adapter fails during a session, the operations fail, and the next session
/// does not start. Operations take the handle of an open session and do nothing with any other. A driver that
/// cannot work at all may throw; no operation hangs.
class OneWire {
 public:
  virtual ~OneWire() = default;

  /// Reads the adapter's port number (1 and up) and type from the settings. Returns a value below 1 if they
  /// name no adapter; `port` and `type` are then unchanged.
  virtual std::int16_t TMReadDefaultPort(std::int16_t& port, std::int16_t& type) = 0;

  /// Begins a session and checks that the adapter answers. Returns its handle, or 0 or less if the port, the
  /// adapter or that type of adapter is missing or in use. `reserved` is 0.
  virtual std::int32_t TMExtendedStartSession(std::int16_t port, std::int16_t type,
                                              std::int32_t reserved = 0) = 0;

  /// Prepares the bus. 1 when done.
  virtual std::int16_t TMSetup(std::int32_t handle) = 0;

  /// Results of TMNext.
  static constexpr std::int16_t DeviceFound = 1;
  static constexpr std::int16_t EndOfBus = 0;
  static constexpr std::int16_t BadRead = -1;  ///< drivers may give any negative number

  /// Moves to the next device. DeviceFound if there is one; it is then selected, and its number passed the
  /// CRC check. EndOfBus after the last device, or at once on an empty bus. Negative if the result is
  /// unknown: a bad read, a failed line or adapter, no session. After any result except DeviceFound, the next
  /// call starts at the first device again.
  virtual std::int16_t TMNext(std::int32_t handle, OneWireState& state) = 0;

  /// Reads the number of the device that the walk is at. Element 0 of `rom` must be 0 to request this. 1 when
  /// done.
  virtual std::int16_t TMRom(std::int32_t handle, OneWireState& state, OneWireRom& rom) = 0;

  /// Selects the device that the walk is at. 1 if the bus answered.
  virtual std::int16_t TMAccess(std::int32_t handle, OneWireState& state) = 0;

  /// Sends a byte to the selected device and returns the one read from the bus meanwhile, 0 to 255: the same
  /// byte if the device only listened. Send 255 to read. Returns 255 also if nothing answers.
  virtual std::int16_t TMTouchByte(std::int32_t handle, std::uint8_t byte) = 0;

  /// The same for a block, in place. 1 when done; otherwise `bytes` is unchanged.
  virtual std::int16_t TMBlockStream(std::int32_t handle, std::span<std::uint8_t> bytes) = 0;

  /// Ends the session and releases the adapter. 1 when done.
  virtual std::int16_t TMEndSession(std::int32_t handle) = 0;
};
