#include "sim/onewire/RomId.h"

#include <algorithm>
#include <charconv>
#include <span>
#include <stdexcept>

#include "sim/line/Crc.h"

namespace sim {

RomId MakeRomId(std::uint8_t family, std::uint64_t serial) {
  RomId rom{family};
  for (std::size_t i = 1; i < 7; ++i) {
    rom[i] = static_cast<std::uint8_t>(serial >> (8 * (i - 1)));
  }
  rom[7] = Crc8(std::span(rom).first(7));
  return rom;
}

RomId ParseRomId(std::string_view text) {
  RomId rom{};
  bool good = text.size() == 2 * rom.size();
  for (std::size_t i = 0; good && i < rom.size(); ++i) {
    const char* digits = text.data() + 2 * (rom.size() - 1 - i);
    const std::from_chars_result result = std::from_chars(digits, digits + 2, rom[i], 16);
    good = result.ec == std::errc() && result.ptr == digits + 2;
  }
  if (!good) {
    throw std::invalid_argument("A button has 16 hexadecimal digits, unlike \"" + std::string(text) + "\"");
  }
  return rom;
}

std::string RomIdText(const RomId& rom) {
  constexpr std::string_view digits = "0123456789ABCDEF";
  std::string text;
  std::for_each(rom.rbegin(), rom.rend(), [&](std::uint8_t byte) {
    text += digits[byte >> 4U];
    text += digits[byte & 15U];
  });
  return text;
}

}  // namespace sim
