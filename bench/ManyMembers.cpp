#include "bench/ManyMembers.h"

#include <cstdio>
#include <cstring>
#include <fstream>
#include <iterator>
#include <string_view>
#include <vector>

#include "tests/support/NumbersInBytes.h"

namespace {

constexpr std::size_t PageSize = 4096;

// Kinds of pages, their first byte.
constexpr char DataPage = 1;
constexpr char TablePage = 2;

// A data page: table at 4, number of rows at 12, then the offset of each row; rows fill it from its end.
constexpr std::size_t OwnerOffset = 4;
constexpr std::size_t RowCountOffset = 12;
constexpr unsigned int OffsetMask = 0x1FFF;

// A table's page: number of rows at 16, of columns at 45, place of its usage map at 55.
constexpr std::size_t TableRowsOffset = 16;
constexpr std::size_t TableColumnsOffset = 45;
constexpr std::size_t TableMapOffset = 55;

constexpr unsigned int ColumnCount = 25;
constexpr unsigned int PhotographColumn = 23;

// The number of columns stands before a row's first column, its key.
constexpr std::size_t KeyInRow = 2;

/// A Jet 4 file in memory.
class OldMembers {
 public:
  explicit OldMembers(std::string bytes) : bytes_(std::move(bytes)) {
    for (std::size_t page = 0; page < Pages(); ++page) {
      if (bytes_[page * PageSize] == TablePage &&
          NumberAt<std::uint16_t>(bytes_, page * PageSize + TableColumnsOffset) == ColumnCount) {
        table_ = page;
      }
    }
  }

  bool HasMembers() const { return table_ != 0 && MapPage() != 0; }

  /// The rows without a photograph. Their pages no longer belong to the table.
  std::vector<std::string> TakeRows() {
    std::vector<std::string> rows;
    for (std::size_t page = 0; page < Pages(); ++page) {
      const std::size_t at = page * PageSize;
      if (bytes_[at] == DataPage && NumberAt<std::uint32_t>(bytes_, at + OwnerOffset) == table_) {
        AddRows(bytes_.substr(at, PageSize), rows);
        SetUsed(page, false);
      }
    }
    return rows;
  }

  void AppendPage(const std::vector<std::string>& rows) {
    std::string page(PageSize, '\0');
    page[0] = DataPage;
    page[1] = 1;
    PutNumber(page, OwnerOffset, static_cast<std::uint32_t>(table_));
    PutNumber(page, RowCountOffset, static_cast<std::uint16_t>(rows.size()));
    std::size_t end = PageSize;
    std::size_t entry = RowCountOffset + 2;
    for (const std::string& row : rows) {
      end -= row.size();
      page.replace(end, row.size(), row);
      PutNumber(page, entry, static_cast<std::uint16_t>(end));
      entry += 2;
    }
    PutNumber(page, 2, static_cast<std::uint16_t>(end - entry));  // free bytes
    SetUsed(Pages(), true);
    bytes_ += page;
  }

  void SetRowCount(std::uint32_t count) { PutNumber(bytes_, table_ * PageSize + TableRowsOffset, count); }

  const std::string& Bytes() const { return bytes_; }

  /// Bytes that one more row takes of a page.
  static std::size_t RoomFor(const std::string& row) { return row.size() + 2; }
  static constexpr std::size_t RoomInPage = PageSize - RowCountOffset - 2;
  /// A map of one page has a bit for each page.
  static constexpr std::size_t MostPages = (PageSize - 4) * 8;

  std::size_t Pages() const { return bytes_.size() / PageSize; }

 private:
  static void AddRows(const std::string& page, std::vector<std::string>& rows) {
    const auto count = NumberAt<std::uint16_t>(page, RowCountOffset);
    std::size_t end = PageSize;
    for (std::size_t i = 0; i < count; ++i) {
      const auto entry = NumberAt<std::uint16_t>(page, RowCountOffset + 2 + 2 * i);
      const std::size_t start = entry & OffsetMask;
      const std::string row = page.substr(start, end - start);
      end = start;
      constexpr std::size_t maskSize = (ColumnCount + 7) / 8;
      const bool isWhole = entry == start && row.size() > maskSize;
      if (isWhole && (row[row.size() - maskSize + PhotographColumn / 8] >> (PhotographColumn % 8) & 1) == 0) {
        rows.push_back(row);
      }
    }
  }

  /// The page of the table's usage map, which is a list of map pages; 0 if it is of another kind.
  std::size_t MapPage() const {
    const auto place = NumberAt<std::uint32_t>(bytes_, table_ * PageSize + TableMapOffset);
    const std::size_t page = (place >> 8U) * PageSize;
    const std::size_t entry = page + RowCountOffset + 2 + std::size_t{2} * (place & 0xFFU);
    const std::size_t map = page + (NumberAt<std::uint16_t>(bytes_, entry) & OffsetMask);
    return bytes_[map] == 1 ? NumberAt<std::uint32_t>(bytes_, map + 1) : 0;
  }

  void SetUsed(std::size_t page, bool used) {
    char& eight = bytes_[MapPage() * PageSize + 4 + page / 8];
    const auto bit = static_cast<char>(1U << page % 8);
    eight = static_cast<char>(used ? eight | bit : eight & ~bit);
  }

  std::string bytes_;
  std::size_t table_ = 0;
};

/// Gives a row the key `number`, and puts it into the button number, if there is one.
void Renumber(std::string& row, std::uint32_t number) {
  PutNumber(row, KeyInRow, number);
  constexpr std::string_view compressed = "\xFF\xFE";
  constexpr std::size_t buttonDigits = 16;
  constexpr std::size_t ownDigits = 8;
  const std::size_t text = row.find(compressed) + compressed.size();
  const std::string_view button = std::string_view(row).substr(text, buttonDigits);
  if (button.find_first_not_of("0123456789ABCDEF") == std::string_view::npos) {
    char digits[ownDigits + 1];
    std::snprintf(digits, sizeof digits, "%08X", number);
    row.replace(text, ownDigits, digits, ownDigits);
  }
}

}  // namespace

bool MakeManyMembers(const std::string& source, const std::string& path, std::uint32_t count) {
  std::ifstream file(source, std::ios::binary);
  OldMembers old(std::string(std::istreambuf_iterator<char>(file), {}));
  const std::vector<std::string> rows = old.HasMembers() ? old.TakeRows() : std::vector<std::string>();
  if (rows.empty()) {
    return false;
  }
  std::vector<std::string> waiting;
  std::size_t room = OldMembers::RoomInPage;
  for (std::uint32_t number = 1; number <= count; ++number) {
    std::string row = rows[number % rows.size()];
    Renumber(row, number);
    if (OldMembers::RoomFor(row) > room) {
      old.AppendPage(waiting);
      waiting.clear();
      room = OldMembers::RoomInPage;
    }
    room -= OldMembers::RoomFor(row);
    waiting.push_back(std::move(row));
  }
  old.AppendPage(waiting);
  old.SetRowCount(count);
  std::ofstream(path, std::ios::binary) << old.Bytes();
  return old.Pages() <= OldMembers::MostPages;
}
