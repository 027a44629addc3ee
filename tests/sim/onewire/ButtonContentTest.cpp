#include "sim/onewire/ButtonContent.h"

#include <gtest/gtest.h>

#include <stdexcept>

#include "sim/line/Crc.h"

namespace sim {
namespace {

constexpr RomId Rom{0x06, 0x1C, 0xB8, 0x01, 0x00, 0x00, 0x00, 0x56};

bool ChecksOut(const ChargeBlock& block) {
  return Crc8(std::span(block).first(31)) == block[31];
}

TEST(ButtonContent, IsKindChargeKeptBytesAndCheckByte) {
  EXPECT_EQ(MakeChargeBlock(ButtonContent::AmmoMag, Rom),
            (ChargeBlock{0x00, 0x00, 0x3E, 0x4F, 0x60, 0x71, 0x82, 0x93, 0xA4, 0xB5, 0xC6,
                         0xD7, 0xE8, 0xF9, 0x0A, 0x1B, 0x2C, 0x3D, 0x4E, 0x5F, 0x70, 0x81,
                         0x92, 0xA3, 0xB4, 0xC5, 0xD6, 0xE7, 0xF8, 0x09, 0x1A, 0xB0}));
  EXPECT_EQ(MakeChargeBlock(ButtonContent::Bandage, Rom),
            (ChargeBlock{0x01, 0x00, 0x3E, 0x4F, 0x60, 0x71, 0x82, 0x93, 0xA4, 0xB5, 0xC6,
                         0xD7, 0xE8, 0xF9, 0x0A, 0x1B, 0x2C, 0x3D, 0x4E, 0x5F, 0x70, 0x81,
                         0x92, 0xA3, 0xB4, 0xC5, 0xD6, 0xE7, 0xF8, 0x09, 0x1A, 0xF0}));
}

TEST(ButtonContent, ChecksOutOrNotAsItsNameSays) {
  for (const ButtonContentInfo& info : ButtonContents) {
    const bool wrong = info.Content == ButtonContent::Blank || info.Content == ButtonContent::WrongCheck;
    EXPECT_EQ(ChecksOut(MakeChargeBlock(info.Content, Rom)), !wrong) << info.Name;
  }
  EXPECT_EQ(MakeChargeBlock(ButtonContent::UnknownKind, Rom)[0], 2);
  EXPECT_EQ(MakeChargeBlock(ButtonContent::WrongCheck, Rom)[0], 0);
}

TEST(ButtonContent, DiffersFromButtonToButton) {
  constexpr RomId other{0x06, 0x1D, 0xB8, 0x01, 0x00, 0x00, 0x00, 0x08};
  EXPECT_NE(MakeChargeBlock(ButtonContent::AmmoMag, Rom), MakeChargeBlock(ButtonContent::AmmoMag, other));
}

TEST(ButtonContent, IsKnownByItsName) {
  for (const ButtonContentInfo& info : ButtonContents) {
    EXPECT_EQ(ParseButtonContent(info.Name), info.Content);
  }
  EXPECT_THROW(ParseButtonContent("grenade"), std::invalid_argument);
  EXPECT_THROW(ParseButtonContent(""), std::invalid_argument);
}

}  // namespace
}  // namespace sim
