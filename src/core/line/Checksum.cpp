#include "core/line/Checksum.h"

namespace {

consteval std::array<std::uint32_t, 256> BuildCrc32Table() {
  std::array<std::uint32_t, 256> table{};
  for (std::uint32_t entry = 0; entry < table.size(); ++entry) {
    std::uint32_t crc = entry;
    for (int bit = 0; bit < 8; ++bit)
      crc = (crc & 1U) != 0 ? (crc >> 1U) ^ 0xEDB88320U : crc >> 1U;
    table[entry] = crc;
  }
  return table;
}

constexpr std::array<std::uint32_t, 256> Crc32Table = BuildCrc32Table();

}  // namespace

std::uint8_t Crc8(std::span<const std::uint8_t> data, std::uint8_t crc) {
  for (const std::uint8_t byte : data) {
    crc = CrcTable[byte ^ crc];
  }
  return crc;
}

std::uint32_t Crc32(std::string_view data) {
  std::uint32_t crc = 0xFFFFFFFF;
  for (const char byte : data) {
    crc = Crc32Table[(crc ^ static_cast<std::uint8_t>(byte)) & 0xFFU] ^ (crc >> 8U);
  }
  return ~crc;
}
