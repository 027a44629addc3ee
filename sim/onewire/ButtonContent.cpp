#include "sim/onewire/ButtonContent.h"

#include <algorithm>
#include <span>
#include <stdexcept>
#include <string>

#include "sim/line/Crc.h"

namespace sim {
namespace {

constexpr std::size_t CheckByte = 31;

ChargeBlock Empty(std::uint8_t kind, const RomId& rom) {
  ChargeBlock block{kind, 0};
  for (std::size_t i = 2; i < CheckByte; ++i) {
    block.at(i) = static_cast<std::uint8_t>(rom[1] + 17 * i);
  }
  block[CheckByte] = Crc8(std::span(block).first(CheckByte));
  return block;
}

ChargeBlock Filled(std::uint8_t byte) {
  ChargeBlock block{};
  block.fill(byte);
  return block;
}

}  // namespace

ChargeBlock MakeChargeBlock(ButtonContent content, const RomId& rom) {
  constexpr std::uint8_t ammoMag = 0;
  constexpr std::uint8_t bandage = 1;
  constexpr std::uint8_t unknown = 2;
  switch (content) {
    case ButtonContent::AmmoMag:
      return Empty(ammoMag, rom);
    case ButtonContent::Bandage:
      return Empty(bandage, rom);
    case ButtonContent::UnknownKind:
      return Empty(unknown, rom);
    case ButtonContent::WrongCheck: {
      ChargeBlock block = Empty(ammoMag, rom);
      block[CheckByte] ^= 0xFFU;
      return block;
    }
    case ButtonContent::Zeros:
      return Filled(0x00);
    case ButtonContent::Blank:
      break;
  }
  return Filled(0xFF);
}

ButtonContent ParseButtonContent(std::string_view name) {
  const auto* found = std::find_if(ButtonContents.begin(), ButtonContents.end(),
                                   [&](const ButtonContentInfo& info) { return info.Name == name; });
  if (found == ButtonContents.end()) {
    throw std::invalid_argument("A button cannot be filled with \"" + std::string(name) + "\"");
  }
  return found->Content;
}

}  // namespace sim
