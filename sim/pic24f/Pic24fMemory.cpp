#include "sim/pic24f/Pic24fMemory.h"

#include <algorithm>

#include "sim/pic24f/Pic24fRequest.h"

namespace sim {
namespace {

constexpr std::uint32_t EepromEnd = 0x1000000;  // in a HEX file
constexpr std::size_t FileBytesOfAddress = 2;
constexpr std::uint32_t ConfigurationBegin = 0xF80000;
constexpr std::size_t ConfigurationBytes = 16;
constexpr std::uint32_t IdentityAddress = 0xFF0000;
constexpr std::uint8_t Revision = 1;
constexpr std::uint32_t BlankInstruction = 0xFFFFFF;
// GOTO 0x400: the place of the loader, in the two instructions that it has.
constexpr std::uint32_t ResetFirst = 0x040400;
constexpr std::uint32_t ResetSecond = 0x000000;
constexpr std::uint32_t OwnDelay = 0x000005;

std::uint32_t Join(std::span<const std::uint8_t> bytes) {
  return bytes[0] + 0x100U * bytes[1] + 0x10000U * bytes[2];
}

std::vector<std::uint8_t> Part(const std::vector<std::uint8_t>& bytes, std::size_t from, std::size_t count) {
  const auto begin = bytes.begin() + static_cast<std::ptrdiff_t>(from);
  return {begin, begin + static_cast<std::ptrdiff_t>(count)};
}

}  // namespace

Pic24fMemory::Pic24fMemory(const Pic24fDevice& device)
    : device_(device),
      program_(device.Instructions * InstructionBytes, 0xFF),
      eeprom_(device.EepromBytes * FileBytesOfAddress, 0xFF),
      configuration_(ConfigurationBytes, 0xFF),
      applicationStart_(BlankInstruction) {
  ErasePages(0, device.Instructions / PageInstructions);
}

std::optional<Pic24fMemory::Bytes> Pic24fMemory::Read(std::uint32_t address, std::size_t instructions) const {
  const std::size_t bytes = instructions * InstructionBytes;
  if (const auto place = ProgramPlace(address, bytes, InstructionBytes)) {
    return Part(program_, *place, bytes);
  }
  if (const auto place = EepromPlace(address, bytes)) {
    return Part(eeprom_, *place, bytes);
  }
  Bytes words;
  if (const auto place = ConfigurationPlace(address, instructions * WordBytes)) {
    words = Part(configuration_, *place, instructions * WordBytes);
  } else if (address == IdentityAddress && (instructions == 1 || instructions == 2)) {
    words = {static_cast<std::uint8_t>(device_.Identity), static_cast<std::uint8_t>(device_.Identity >> 8U),
             Revision, 0};
    words.resize(instructions * WordBytes);
  } else {
    return std::nullopt;
  }
  Bytes shown;
  for (std::size_t i = 0; i < words.size(); i += WordBytes) {
    shown.insert(shown.end(), {words[i], words[i + 1], 0, 0});
  }
  return shown;
}

bool Pic24fMemory::WriteRows(std::uint32_t address, std::span<const std::uint8_t> bytes) {
  const auto place = ProgramPlace(address, bytes.size(), RowBytes);
  if (!place) {
    return false;
  }
  if (*place == 0) {
    // A GOTO has the low 16 bits of its target in its first instruction and the rest in its second.
    applicationStart_ = (Join(bytes) & 0xFFFFU) + ((Join(bytes.subspan(InstructionBytes)) & 0xFFU) << 16U);
  }
  for (std::size_t i = 0; i < bytes.size(); ++i) {
    program_[*place + i] &= bytes[i];
  }
  PutOwnWords();
  return true;
}

bool Pic24fMemory::ErasePages(std::uint32_t address, std::size_t pages) {
  constexpr std::size_t pageBytes = PageInstructions * InstructionBytes;
  const auto place = ProgramPlace(address, pages * pageBytes, pageBytes);
  if (!place) {
    return false;
  }
  for (std::size_t i = 0; i < pages * pageBytes; ++i) {
    program_[*place + i] = i % InstructionBytes == InstructionBytes - 1 ? 0 : 0xFF;
  }
  if (*place == 0) {
    applicationStart_ = BlankInstruction;
  }
  PutOwnWords();
  return true;
}

std::optional<Pic24fMemory::Bytes> Pic24fMemory::ReadEeprom(std::uint32_t address, std::size_t words) const {
  const auto place = EepromPlace(address, words * WordBytes);
  return place ? std::optional(Part(eeprom_, *place, words * WordBytes)) : std::nullopt;
}

bool Pic24fMemory::WriteEeprom(std::uint32_t address, std::span<const std::uint8_t> bytes) {
  const auto place = EepromPlace(address, bytes.size());
  if (place) {
    std::copy(bytes.begin(), bytes.end(), eeprom_.begin() + static_cast<std::ptrdiff_t>(*place));
  }
  return place.has_value();
}

std::optional<Pic24fMemory::Bytes> Pic24fMemory::ReadConfiguration(std::uint32_t address,
                                                                   std::size_t words) const {
  const auto place = ConfigurationPlace(address, words * WordBytes);
  return place ? std::optional(Part(configuration_, *place, words * WordBytes)) : std::nullopt;
}

bool Pic24fMemory::WriteConfiguration(std::uint32_t address, std::span<const std::uint8_t> bytes) {
  const auto place = ConfigurationPlace(address, bytes.size());
  if (place) {
    std::copy(bytes.begin(), bytes.end(), configuration_.begin() + static_cast<std::ptrdiff_t>(*place));
  }
  return place.has_value();
}

// Index into program_ for `bytes` bytes, of which there must be whole units that begin where units do.
std::optional<std::size_t> Pic24fMemory::ProgramPlace(std::uint32_t address, std::size_t bytes,
                                                      std::size_t unit) const {
  const std::size_t place = std::size_t{address} * 2;
  const bool fits = bytes > 0 && place + bytes <= program_.size();
  return fits && place % unit == 0 && bytes % unit == 0 ? std::optional(place) : std::nullopt;
}

std::optional<std::size_t> Pic24fMemory::EepromPlace(std::uint32_t address, std::size_t bytes) const {
  const std::size_t begin = EepromEnd - eeprom_.size();
  const bool fits = bytes > 0 && address >= begin && address + bytes <= EepromEnd;
  return fits && address % WordBytes == 0 ? std::optional(address - begin) : std::nullopt;
}

// A word has two addresses and two bytes.
std::optional<std::size_t> Pic24fMemory::ConfigurationPlace(std::uint32_t address, std::size_t bytes) const {
  const bool fits = bytes > 0 && address >= ConfigurationBegin &&
                    address + bytes <= ConfigurationBegin + ConfigurationBytes;
  return fits && address % WordBytes == 0 ? std::optional<std::size_t>(address - ConfigurationBegin)
                                          : std::nullopt;
}

void Pic24fMemory::PutInstruction(std::uint32_t address, std::uint32_t value) {
  if (const auto place = ProgramPlace(address, InstructionBytes, InstructionBytes)) {
    program_[*place] = static_cast<std::uint8_t>(value);
    program_[*place + 1] = static_cast<std::uint8_t>(value >> 8U);
    program_[*place + 2] = static_cast<std::uint8_t>(value >> 16U);
    program_[*place + 3] = 0;
  }
}

void Pic24fMemory::PutOwnWords() {
  PutInstruction(0, ResetFirst);
  PutInstruction(2, ResetSecond);
  if (device_.UserResetVector != 0) {
    PutInstruction(device_.UserResetVector, applicationStart_);
  }
  if (device_.BootDelay != 0) {
    PutInstruction(device_.BootDelay, OwnDelay);
  }
}

}  // namespace sim
