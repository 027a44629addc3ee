#pragma once

#include <cstdint>
#include <span>

namespace sim {

/// CRC-8 of the 1-Wire family (x^8 + x^5 + x^4 + 1, least significant bit first, start value 0): closes score
/// frames and button ids.
std::uint8_t Crc8(std::span<const std::uint8_t> bytes);

}  // namespace sim
