#pragma once

#include <array>
#include <cstdint>

/// The state that a consumable button keeps in its memory: kind, charge, a byte that is 0 for a recovered
/// Ammo Mag, 28 bytes of the equipment's own, and the check byte.
using ChargeBlock = std::array<std::uint8_t, 32>;

/// The block's first byte.
namespace ButtonKind {
inline constexpr std::uint8_t AmmoMag = 0;
inline constexpr std::uint8_t Bandage = 1;
}  // namespace ButtonKind

/// CRC-8 of all bytes but the last.
std::uint8_t CheckByteOf(const ChargeBlock& block);

/// True if the last byte is that.
bool CheckHolds(const ChargeBlock& block);

/// Turns an invalid block into one of an Ammo Mag, else of a Bandage; the check byte stays as it is.
void Recover(ChargeBlock& block, bool asAmmoMag);

/// Sets the charge of a full button and the check byte. False for an unknown kind, which stays as it is.
bool Charge(ChargeBlock& block);
