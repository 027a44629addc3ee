#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <string_view>
#include <vector>

namespace sim {

/// What a PIC24F device has.
struct Pic24fDevice {
  std::string_view Name{};         ///< for the command line
  std::uint16_t Identity = 0;      ///< 0 to 65535, from 0xFF0000
  std::uint32_t Instructions = 0;  ///< whole pages of 512
  /// An even number, at most 32,764. The chip has them at the end of its program addresses, 512 bytes from
  /// 0x7FFE00 to 0x7FFFFF.
  std::uint32_t EepromBytes = 0;
  /// Program addresses of words that the loader keeps for itself, 0 for none: the application's start, taken
  /// from the reset words that a host writes, and the time that the loader waits before it.
  std::uint32_t UserResetVector = 0;
  std::uint32_t BootDelay = 0;
};

/// Three sizes of device. The identities are invented, since hosts look theirs up in lists of their own.
inline constexpr std::array<Pic24fDevice, 3> Pic24fDevices{{
    {.Name = "medium", .Identity = 1001, .Instructions = 44'032},
    {.Name = "large", .Identity = 1002, .Instructions = 87'552},
    {.Name = "small", .Identity = 1003, .Instructions = 5'632, .EepromBytes = 512},
}};

/// The memory of a PIC24F device as its bootloader shows it. An instruction has two program addresses and is
/// shown as four bytes, the last of them always 0. Programming only clears bits, an erased instruction is FF
/// FF FF. The two instructions of the reset vector always lead to the loader, whatever is written there; the
/// loader's own code is not shown.
///
/// The EEPROM goes by the byte addresses of HEX files, which have two for each program address: 512 bytes of
/// it are 0xFFFC00 to 0xFFFFFF there. What is written in this range is kept and shown byte for byte.
///
/// All operations return false or none, and change nothing, for addresses that the device does not have or
/// that are not those of a whole row, page, instruction or word.
class Pic24fMemory {
 public:
  using Bytes = std::vector<std::uint8_t>;

  /// Erased.
  explicit Pic24fMemory(const Pic24fDevice& device);

  /// Four bytes for each of `instructions`. Besides program memory this shows the EEPROM at its byte address,
  /// the configuration words from 0xF80000 and, at 0xFF0000, identity and revision.
  std::optional<Bytes> Read(std::uint32_t address, std::size_t instructions) const;
  bool WriteRows(std::uint32_t address, std::span<const std::uint8_t> bytes);
  bool ErasePages(std::uint32_t address, std::size_t pages);

  /// Words of two bytes, by byte address.
  std::optional<Bytes> ReadEeprom(std::uint32_t address, std::size_t words) const;
  bool WriteEeprom(std::uint32_t address, std::span<const std::uint8_t> bytes);

  /// Words of two bytes, at program addresses two apart.
  std::optional<Bytes> ReadConfiguration(std::uint32_t address, std::size_t words) const;
  bool WriteConfiguration(std::uint32_t address, std::span<const std::uint8_t> bytes);

  /// All of the program memory.
  const Bytes& Program() const { return program_; }

 private:
  std::optional<std::size_t> ProgramPlace(std::uint32_t address, std::size_t bytes, std::size_t unit) const;
  std::optional<std::size_t> EepromPlace(std::uint32_t address, std::size_t bytes) const;
  std::optional<std::size_t> ConfigurationPlace(std::uint32_t address, std::size_t bytes) const;
  void PutInstruction(std::uint32_t address, std::uint32_t value);
  void PutOwnWords();

  Pic24fDevice device_;
  Bytes program_;
  Bytes eeprom_;
  Bytes configuration_;
  std::uint32_t applicationStart_;
};

}  // namespace sim
