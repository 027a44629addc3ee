#pragma once

#include <array>
#include <cstdint>

/// Entry i has the low i + 1 bits set, so entry 31 is -1.
consteval std::array<std::int32_t, 32> BuildBitMasks() {
  std::array<std::int32_t, 32> masks{};
  std::uint32_t mask = 0;
  for (unsigned int bit = 0; bit < masks.size(); ++bit) {
    mask += std::uint32_t{1} << bit;
    masks[bit] = static_cast<std::int32_t>(mask);
  }
  return masks;
}

inline constexpr std::array<std::int32_t, 32> BitMasks = BuildBitMasks();

/// `value` shifted left by 0 to 30 bits; bits beyond bit 31 are lost. Throws RuntimeError 9 for any other
/// `shift`.
std::int32_t ShiftLeft32(std::int32_t value, std::int16_t shift);

/// `value` shifted right by 1 bit or more, filling with zeros. Bit 0 is masked off first, so a shift of 0
/// clears it. A shift of 0 of a negative value, and any negative shift, throw RuntimeError 11.
std::int32_t ShiftRight32(std::int32_t value, std::int16_t shift);
