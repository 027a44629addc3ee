#include "core/line/Checksum.h"

std::uint8_t Crc8(std::span<const std::uint8_t> data, std::uint8_t crc) {
  for (const std::uint8_t byte : data) {
    crc = CrcTable[byte ^ crc];
  }
  return crc;
}
