#pragma once

#include <bitset>
#include <cstddef>
#include <cstdint>
#include <string_view>
#include <vector>

/// The program image of a QVM2 file and the flash pages and rows that it fills.
///
/// The file is text with lines that end in carriage return and line feed. Line 1: the pages, line 2: the
/// rows, both hexadecimal numbers separated by ","; from line 3 on the image, two digits a byte, from offset
/// 0 on. A code word takes 3 bytes of the image and 2 of the device's addresses.
class FirmwareImage {
 public:
  static constexpr std::size_t RowBytes = 192;    ///< unit of writing, 64 code words
  static constexpr std::size_t PageBytes = 1536;  ///< unit of erasing
  static constexpr int RowsOfAPage = 8;
  static constexpr int MostPages = 512;
  static constexpr int MostRows = MostPages * RowsOfAPage;
  static constexpr std::uint32_t AddressesOfARow = 128;
  static constexpr std::uint32_t AddressesOfAPage = 1024;

  FirmwareImage() : ImageBuffer(MostPages * PageBytes + 1) {}

  /// Reads the file's bytes. Page 0 and row 0 always count as used: the reset vector is there. Returns
  /// whether any row is used.
  ///
  /// Throws RuntimeError 62 if line 1 or 2 is missing; 9 for a page or row beyond the tables, and for an
  /// image beyond the buffer; 6 for a number or a pair of digits that is too large, a line of data with an
  /// odd count of characters or more than 32,767, and a line feed alone in line 1 or 2.
  bool LoadQvm2File(std::string_view bytes);

  std::vector<std::uint8_t> ImageBuffer;
  std::bitset<MostPages + 1> PageUsed;  ///< the last page and the last row exist, but are never written
  std::bitset<MostRows + 1> RowUsed;
  std::int16_t PageCount = 0;
  std::int16_t RowCount = 0;

  /// Bytes of the image that the file gave; what is behind them is 0xFF.
  std::size_t BytesLoaded = 0;

 private:
  void ReadData(std::string_view line);
};
