#include "firmware/files/HexConvert.h"

#include <limits>

#include "platform/RuntimeError.h"

bool IsHexDigit(char character) {
  return (character >= '0' && character <= '9') || (character >= 'A' && character <= 'F') ||
         (character >= 'a' && character <= 'f');
}

std::int16_t Hex_Convert(std::string_view text) {
  const std::int32_t value = Hex_Convert2(text);
  if (value > std::numeric_limits<std::int16_t>::max()) {
    throw RuntimeError(Fault::Overflow);
  }
  return static_cast<std::int16_t>(value);
}

std::int32_t Hex_Convert2(std::string_view text) {
  constexpr int base = 16;
  std::int64_t value = 0;
  for (const char character : text) {
    value = value * base + HexDigit(character);
    if (value > std::numeric_limits<std::int32_t>::max()) {
      throw RuntimeError(Fault::Overflow);
    }
  }
  return static_cast<std::int32_t>(value);
}
