#include "core/game/DallasId.h"

std::string DallasIdOf(const std::array<std::uint8_t, 8>& rom) {
  constexpr const char* digits = "0123456789ABCDEF";
  std::string text;
  for (const std::uint8_t byte : rom) {
    text.insert(0, {digits[byte >> 4], digits[byte & 15]});
  }
  return text;
}
