#pragma once

#include <array>
#include <cstdint>

/// A colour as its shares of red, green and blue, 0 to 255.
struct Rgb {
  std::uint8_t Red;
  std::uint8_t Green;
  std::uint8_t Blue;
};

/// Colours of team 1 to 3, from index 0: red, blue, yellow.
inline constexpr std::array<Rgb, 3> TeamRgb = {{{0xd9, 0x3a, 0x3a}, {0x2f, 0x6f, 0xd6}, {0xe6, 0xb0, 0x0f}}};
