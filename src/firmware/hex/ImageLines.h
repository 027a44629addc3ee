#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

/// A memory image as text: a line for each 16 bytes, with the address of the first one in six digits, a
/// blank, and the bytes in two digits each with a blank behind. Addresses are those of the HEX file: four for
/// each instruction of program memory, whose fourth byte is always 0.
namespace ImageLine {

inline constexpr std::size_t Bytes = 16;
inline constexpr std::size_t AddressDigits = 6;
inline constexpr std::size_t DataColumn = 7;  ///< counted from 0
inline constexpr std::size_t ByteColumns = 3;
inline constexpr std::size_t DataColumns = Bytes * ByteColumns;
inline constexpr std::size_t Columns = DataColumn + DataColumns;

using Data = std::array<std::uint8_t, Bytes>;

/// What erased program memory holds at a byte address.
constexpr std::uint8_t FillAt(std::size_t address) {
  return address % 4 == 3 ? 0x00 : 0xFF;
}

/// Appends a line, without a line end, to `text`.
void Append(std::string& text, std::uint32_t address, const std::uint8_t* sixteenBytes);

/// Throws RuntimeError 13 if the line does not begin with an address.
std::uint32_t AddressOf(std::string_view line);

/// The 16 bytes of a line. Throws RuntimeError 13 if one is missing.
Data DataOf(std::string_view line);

}  // namespace ImageLine

/// Sorts lines `low` to `high` by address, in place. Lines of one address keep no particular order. Throws
/// RuntimeError 13 for a line without address.
void SortImageLines(std::vector<std::string>& lines, std::ptrdiff_t low, std::ptrdiff_t high);
