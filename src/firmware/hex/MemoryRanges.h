#pragma once

#include <cstdint>

/// The memories of a device that a HEX file has data for.
enum class Memory { None, Program, EeData, Config };

/// The memory that holds addresses with these upper 16 bits.
constexpr Memory MemoryOf(std::uint32_t upper) {
  constexpr std::uint32_t lastOfProgram = 253;
  constexpr std::uint32_t lastOfEeData = 255;
  constexpr std::uint32_t config = 0x1F0;
  if (upper <= lastOfProgram) {
    return Memory::Program;
  }
  if (upper <= lastOfEeData) {
    return Memory::EeData;
  }
  return upper == config ? Memory::Config : Memory::None;
}
