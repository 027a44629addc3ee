#pragma once

#include <cstdint>
#include <stdexcept>
#include <string>

#include "tests/support/NumbersInBytes.h"
#include "tests/support/TemporaryFolder.h"

inline constexpr std::size_t JetPageSize = 4096;

/// The bytes of one of the old files, "members" or "scenarios", to be changed.
inline std::string OldFileBytes(const std::string& name) {
  return ReadFile(std::string(TESSARINE_OLD_FILES "/") + name + ".mdb");
}

inline std::string EmptyDatabase(const std::string& name) {
  return TESSARINE_PROGRAM_FOLDER "/" + name + "_default.mdb";
}

/// Puts other bytes in the place of `old`, of the same number, which must occur in `bytes`.
inline void Exchange(std::string& bytes, const std::string& old, const std::string& other) {
  const std::size_t at = bytes.find(old);
  if (at == std::string::npos || old.size() != other.size()) {
    throw std::logic_error("cannot exchange these bytes");
  }
  bytes.replace(at, other.size(), other);
}

/// Places in members.mdb.
namespace MembersFile {

inline constexpr std::size_t CatalogPage = 14;
inline constexpr std::size_t TablePage = 24;
inline constexpr std::size_t RowCount = TablePage * JetPageSize + 16;
inline constexpr std::size_t FirstDataPage = 37;
inline constexpr std::size_t MapPage = 38;   ///< a bit for each page of the table
inline constexpr std::size_t RowTable = 12;  ///< in a data page: number of rows, then the entry of each

/// The entry of a row of the first data page.
inline std::size_t EntryOf(std::size_t row) {
  return FirstDataPage * JetPageSize + RowTable + 2 + 2 * row;
}

/// Moves a row of the first data page to a page of its own, as if it had outgrown its page.
inline void MoveRow(std::string& bytes, std::size_t row) {
  constexpr unsigned int offsetMask = 0x1FFF;
  constexpr unsigned int hidden = 0x8000;
  constexpr unsigned int elsewhere = 0x4000;
  const std::size_t newPage = bytes.size() / JetPageSize;
  const std::size_t start = NumberAt<std::uint16_t>(bytes, EntryOf(row)) & offsetMask;
  const std::size_t end =
      row == 0 ? JetPageSize : NumberAt<std::uint16_t>(bytes, EntryOf(row - 1)) & offsetMask;
  const std::string values = bytes.substr(FirstDataPage * JetPageSize + start, end - start);

  std::string page(JetPageSize, '\0');
  PutNumber(page, 0, std::uint16_t{0x0101});
  PutNumber(page, 4, static_cast<std::uint32_t>(TablePage));
  PutNumber(page, RowTable, std::uint16_t{1});
  const std::size_t newStart = JetPageSize - values.size();
  PutNumber(page, RowTable + 2, static_cast<std::uint16_t>(newStart | hidden));
  page.replace(newStart, values.size(), values);

  PutNumber(bytes, EntryOf(row), static_cast<std::uint16_t>(start | elsewhere));
  PutNumber(bytes, FirstDataPage * JetPageSize + start, static_cast<std::uint32_t>(newPage << 8U));
  char& eight = bytes[MapPage * JetPageSize + 4 + newPage / 8];
  eight = static_cast<char>(eight | 1 << newPage % 8);
  bytes += page;
}

}  // namespace MembersFile
