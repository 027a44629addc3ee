#pragma once

#include <array>
#include <cstdint>
#include <string_view>

/// Value of each character as a hexadecimal digit. A character that is none counts with its own code, so it
/// is never refused here: 71 for "G".
consteval std::array<std::uint8_t, 256> BuildHexDigits() {
  std::array<std::uint8_t, 256> digits{};
  for (unsigned int code = 0; code < digits.size(); ++code) {
    const unsigned int digit = code >= 'A' && code <= 'F'   ? code - 'A' + 10
                               : code >= 'a' && code <= 'f' ? code - 'a' + 10
                               : code >= '0' && code <= '9' ? code - '0'
                                                            : code;
    digits[code] = static_cast<std::uint8_t>(digit);
  }
  return digits;
}

inline constexpr std::array<std::uint8_t, 256> HexDigits = BuildHexDigits();

inline std::uint8_t HexDigit(char character) {
  return HexDigits[static_cast<unsigned char>(character)];
}

bool IsHexDigit(char character);

/// Value of a hexadecimal text, 0 for an empty one. Throws RuntimeError 6 above 32767.
std::int16_t Hex_Convert(std::string_view text);

/// The same, but throws RuntimeError 6 above 2147483647.
std::int32_t Hex_Convert2(std::string_view text);
