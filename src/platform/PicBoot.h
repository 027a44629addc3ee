#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>

/// What a read or write of a device's memory works on.
struct PicRecord {
  std::uint8_t Command = 0;          ///< 1 read program memory, 2 write it, 4 read EEPROM, 5 write it
  std::uint16_t DataLength = 0;      ///< bytes of this operation
  std::uint32_t Address = 0;         ///< of the device: file address / BytesPerAddress
  std::uint16_t BlockSize = 0;       ///< the device's block size for this operation, in bytes
  std::uint8_t BytesPerAddress = 0;  ///< bytes per address of the device
  std::uint16_t MaxRetries = 0;
  std::uint16_t DeviceType = 0;
};
static_assert(sizeof(PicRecord) == 16 && offsetof(PicRecord, DataLength) == 2 &&
              offsetof(PicRecord, Address) == 4 && offsetof(PicRecord, BlockSize) == 8 &&
              offsetof(PicRecord, BytesPerAddress) == 10 && offsetof(PicRecord, MaxRetries) == 12 &&
              offsetof(PicRecord, DeviceType) == 14);

/// The library that talks to the boot loader of a PIC24F. It frames, escapes and repeats the packets;
/// `retries` is how often it sends one again when there is no right answer. Operations take the handle of the
/// open port; with any other they fail. They may throw RuntimeError once when the line is lost; the port is
/// then closed.
class PicBoot {
 public:
  virtual ~PicBoot() = default;

  /// Opens a port ("COM1"; "COM 1" is the same) at a bit rate; `timeOut` is in milliseconds. Returns the
  /// handle, above 0, or a negative number.
  virtual std::int32_t OpenPIC(const std::string& port, std::int32_t bitRate, std::int32_t timeOut) = 0;

  virtual void ClosePIC(std::int32_t handle) = 0;

  /// Sends a packet that has no answer.
  virtual void SendPacket(std::int32_t handle, std::span<const std::uint8_t> packet) = 0;

  /// Waits for a packet. Returns its length, or a negative number.
  virtual std::int32_t GetPacket(std::int32_t handle, std::span<std::uint8_t> buffer) = 0;

  /// Sends the first `length` bytes of `buffer` and puts the answer into it, at most `longest` bytes and no
  /// more than it holds. Returns the length of the answer, or a negative number.
  virtual std::int32_t SendGetPacket(std::int32_t handle, std::span<std::uint8_t> buffer, std::size_t length,
                                     std::size_t longest, std::int32_t retries) = 0;

  /// Reads memory into `buffer`. Returns the number of bytes, or a negative number.
  virtual std::int32_t ReadPIC(std::int32_t handle, const PicRecord& record,
                               std::span<std::uint8_t> buffer) = 0;

  /// Writes memory from `bytes`. Negative on failure.
  virtual std::int32_t WritePIC(std::int32_t handle, const PicRecord& record,
                                std::span<const std::uint8_t> bytes) = 0;

  /// Compares memory with `bytes`. 1 when they are equal, negative otherwise.
  virtual std::int32_t VerifyPIC(std::int32_t handle, const PicRecord& record,
                                 std::span<const std::uint8_t> bytes) = 0;

  /// Erases program memory from a device address on. Negative on failure, and for 0 blocks or more than 255.
  virtual std::int32_t ErasePIC(std::int32_t handle, std::uint32_t address, std::int32_t blocks,
                                std::int32_t retries) = 0;
};
