#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <string_view>

/// Lookup table of the 1-Wire CRC-8: polynomial x^8 + x^5 + x^4 + 1, reflected form 0x8C.
consteval std::array<std::uint8_t, 256> BuildCrcTable() {
  std::array<std::uint8_t, 256> table{};
  for (unsigned int entry = 0; entry < table.size(); ++entry) {
    unsigned int crc = entry;
    for (int bit = 0; bit < 8; ++bit)
      crc = (crc & 1U) != 0 ? (crc >> 1U) ^ 0x8CU : crc >> 1U;
    table[entry] = static_cast<std::uint8_t>(crc);
  }
  return table;
}

inline constexpr std::array<std::uint8_t, 256> CrcTable = BuildCrcTable();

/// CRC-8 of `data`, continued from `crc`; `crc` itself if `data` is empty. 0 for data followed by its own
/// CRC.
std::uint8_t Crc8(std::span<const std::uint8_t> data, std::uint8_t crc = 0);

/// CRC-32 of archives and networks: polynomial 0x04C11DB7 in its reflected form 0xEDB88320, all bits inverted
/// before and after. 0xCBF43926 for "123456789".
std::uint32_t Crc32(std::string_view data);
