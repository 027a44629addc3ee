#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>

namespace sim {

/// The factory-set number of a 1-Wire device: family code, six serial bytes, CRC of those seven.
using RomId = std::array<std::uint8_t, 8>;

/// `family` with a serial number of up to 48 bits and the CRC of both.
RomId MakeRomId(std::uint8_t family, std::uint64_t serial);

/// Reads 16 hexadecimal digits, the CRC first and the family code last, as printed on players' cards. A CRC
/// that does not match the rest is accepted as it is. Throws std::invalid_argument with a text for the user.
RomId ParseRomId(std::string_view text);

/// The 16 upper-case digits that ParseRomId reads.
std::string RomIdText(const RomId& rom);

}  // namespace sim
