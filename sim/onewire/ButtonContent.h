#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

#include "sim/onewire/RomId.h"

namespace sim {

/// What the memory of a button can be filled with.
enum class ButtonContent { AmmoMag, Bandage, Blank, Zeros, WrongCheck, UnknownKind };

struct ButtonContentInfo {
  ButtonContent Content;
  std::string_view Name;  ///< for commands
  std::string_view Meaning;
};

inline constexpr std::array<ButtonContentInfo, 6> ButtonContents{{
    {ButtonContent::AmmoMag, "ammo-mag", "an empty Ammo Mag"},
    {ButtonContent::Bandage, "bandage", "an empty Bandage"},
    {ButtonContent::Blank, "blank", "never used, each byte 255"},
    {ButtonContent::Zeros, "zeros", "each byte 0, which passes for an Ammo Mag"},
    {ButtonContent::WrongCheck, "wrong-check", "an Ammo Mag with a wrong check byte"},
    {ButtonContent::UnknownKind, "unknown-kind", "of kind 2, with the right check byte"},
}};

/// A charge block lies at this address of a button's memory: kind, charge, 29 other bytes, and the CRC of
/// these 31.
inline constexpr std::size_t ChargeBlockAddress = 0x20;
using ChargeBlock = std::array<std::uint8_t, 32>;

/// The block of a button with this content. Bytes that a charge must keep differ from button to button.
ChargeBlock MakeChargeBlock(ButtonContent content, const RomId& rom);

/// Throws std::invalid_argument with a text for the user if no content has that name.
ButtonContent ParseButtonContent(std::string_view name);

}  // namespace sim
