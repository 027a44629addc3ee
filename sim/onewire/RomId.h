#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>

namespace sim {

/// The number that a 1-Wire device is born with: family code, six serial bytes, CRC of those seven.
using RomId = std::array<std::uint8_t, 8>;

/// `family` with a serial number of up to 48 bits and the CRC that belongs to them.
RomId MakeRomId(std::uint8_t family, std::uint64_t serial);

/// Reads 16 hexadecimal digits, the CRC first and the family code last, as players' cards print it. A CRC
/// that does not belong to the rest is taken as it stands. Throws std::invalid_argument with a text for the
/// user.
RomId ParseRomId(std::string_view text);

/// The 16 upper-case digits that ParseRomId reads.
std::string RomIdText(const RomId& rom);

}  // namespace sim
