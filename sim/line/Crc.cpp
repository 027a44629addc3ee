#include "sim/line/Crc.h"

namespace sim {

std::uint8_t Crc8(std::span<const std::uint8_t> bytes) {
  constexpr unsigned reflectedPolynomial = 0x8C;
  unsigned crc = 0;
  for (const std::uint8_t byte : bytes) {
    crc ^= byte;
    for (int bit = 0; bit < 8; ++bit) {
      const bool feedback = (crc & 1U) != 0;
      crc >>= 1U;
      if (feedback) {
        crc ^= reflectedPolynomial;
      }
    }
  }
  return static_cast<std::uint8_t>(crc);
}

}  // namespace sim
