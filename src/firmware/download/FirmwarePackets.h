#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <span>

#include "firmware/files/FirmwareImage.h"

/// The two packets of the QVM2 route. Each begins with its command, has a 24-bit address of the device, high
/// byte first, and ends with a checksum that makes the sum of all its bytes 0 modulo 256.
inline constexpr std::size_t ErasePacketSize = 6;
inline constexpr std::size_t WritePacketSize = 198;

/// Erases page `page`, 0 to 511.
std::array<std::uint8_t, ErasePacketSize> ErasePacket(int page);

/// Writes row `row`, 0 to 4095, with its 192 bytes.
std::array<std::uint8_t, WritePacketSize> WritePacket(
    int row, std::span<const std::uint8_t, FirmwareImage::RowBytes> bytes);
