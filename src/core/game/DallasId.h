#pragma once

#include <array>
#include <cstdint>
#include <string>

/// For a player or a reader without a membership button.
inline constexpr const char* NoDallasId = "0000000000000000";

/// Text of a button's number: 16 upper-case hexadecimal digits, from the last byte of `rom` (the CRC) down to
/// the first one (the family code).
std::string DallasIdOf(const std::array<std::uint8_t, 8>& rom);
