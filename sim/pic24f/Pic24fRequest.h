#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <variant>
#include <vector>

#include "sim/pic24f/Pic24fPacket.h"

namespace sim {

/// The first byte of a request. Version with a count of 0 is the command to run the application.
enum class Pic24fCommand : std::uint8_t {
  Version,
  ReadProgram,
  WriteProgram,
  EraseProgram,
  ReadEeprom,
  WriteEeprom,
  ReadConfiguration,
  WriteConfiguration,
  VerifyOk,
};

struct Pic24fRequest {
  Pic24fCommand Command = Pic24fCommand::Version;
  /// Instructions to read, rows to write, pages to erase, words of EEPROM or configuration.
  std::uint8_t Count = 0;
  std::uint32_t Address = 0;         ///< 24 bits
  std::vector<std::uint8_t> Data{};  ///< to write

  bool operator==(const Pic24fRequest&) const = default;
};

constexpr std::size_t InstructionBytes = 4;
constexpr std::size_t RowInstructions = 64;
constexpr std::size_t RowBytes = RowInstructions * InstructionBytes;
constexpr std::size_t PageInstructions = 512;
constexpr std::size_t WordBytes = 2;

/// Reads a packet's data: command, count, address (low, high, upper), bytes to write. Version and run end
/// behind the count, verify OK is the command alone.
std::variant<Pic24fRequest, BadPacket> ReadPic24fRequest(std::span<const std::uint8_t> data);

/// The five header bytes, with which the answer to a read begins.
std::vector<std::uint8_t> HeaderOf(const Pic24fRequest& request);

/// For the log: "write 1 at 000080".
std::string Describe(const Pic24fRequest& request);

}  // namespace sim
