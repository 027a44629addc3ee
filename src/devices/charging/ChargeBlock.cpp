#include "devices/charging/ChargeBlock.h"

#include <span>

#include "core/line/Checksum.h"

namespace {

constexpr std::uint8_t FullAmmoMag = 1;
constexpr std::uint8_t FullBandage = 5;

}  // namespace

std::uint8_t CheckByteOf(const ChargeBlock& block) {
  return Crc8(std::span(block).first(block.size() - 1));
}

bool CheckHolds(const ChargeBlock& block) {
  return CheckByteOf(block) == block.back();
}

void Recover(ChargeBlock& block, bool asAmmoMag) {
  if (asAmmoMag) {
    block[0] = ButtonKind::AmmoMag;
    block[2] = 0;
  } else {
    block[0] = ButtonKind::Bandage;
  }
}

bool Charge(ChargeBlock& block) {
  switch (block[0]) {
    case ButtonKind::AmmoMag:
      block[1] = FullAmmoMag;
      break;
    case ButtonKind::Bandage:
      block[1] = FullBandage;
      break;
    default:
      return false;
  }
  block.back() = CheckByteOf(block);
  return true;
}
