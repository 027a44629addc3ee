#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

#include "platform/MessageBoxes.h"

/// The program of a larger device: three bytes for each instruction, and the flash pages and rows that it
/// fills.
struct HexImage {
  static constexpr std::size_t Bytes = 0xC0000;
  static constexpr std::size_t Pages = 512;  ///< of 512 instructions
  static constexpr std::size_t Rows = 4096;  ///< of 64 instructions

  /// One byte more than an image has, as the tables have one entry more.
  std::vector<std::uint8_t> ImageBuffer = std::vector<std::uint8_t>(Bytes + 1, 0xFF);
  std::vector<bool> PageUsed = std::vector<bool>(Pages + 1);
  std::vector<bool> RowUsed = std::vector<bool>(Rows + 1);
  std::int16_t PageCount = 0;
  std::int16_t RowCount = 0;
};

/// Reads the text of a HEX file into `image`, and copies its reset jump to where the boot loader expects the
/// one of the application. Returns false, after a box, for a program that would overwrite the boot loader or
/// has no reset jump. No record's checksum is looked at.
///
/// Throws RuntimeError 9 for an instruction beyond the image, 6 for one beyond number 32767 and for what is
/// no hexadecimal number of its size.
bool LoadHexImage(std::string_view text, HexImage& image, MessageBoxes& boxes);
