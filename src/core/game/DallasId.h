#pragma once

#include <array>
#include <cstdint>
#include <string>

/// Means "no button", in a player's record or at the reader.
inline constexpr const char* NoDallasId = "0000000000000000";

/// A button's number as text: 16 upper-case hexadecimal digits, from the last byte of `rom` (the CRC) down to
/// the first (the family code).
std::string DallasIdOf(const std::array<std::uint8_t, 8>& rom);
