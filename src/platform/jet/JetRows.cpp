#include "platform/jet/JetRows.h"

#include <algorithm>

namespace {

// An entry of a page's row table: offset of the row, and two flags. An outgrown row has an entry with
// Elsewhere that holds page and row of its values; the entry there is Hidden. A deleted row is Hidden too.
constexpr int OffsetMask = 0x1FFF;
constexpr int Hidden = 0x8000;
constexpr int Elsewhere = 0x4000;

constexpr std::size_t EntrySize = 2;

}  // namespace

JetRows::JetRows(MdbTableDef* table) : table_(table), mdb_(table->entry->mdb), fields_(MDB_MAX_COLS) {
  mdb_rewind_table(table);
}

bool JetRows::NextPage() {
  if (mdb_read_next_dpg(table_) == 0) {
    return false;
  }
  page_ = mdb_->cur_pg;
  const int offset = mdb_->fmt->row_count_offset;
  const auto room = (static_cast<int>(mdb_->fmt->pg_size) - offset) / static_cast<int>(EntrySize) - 1;
  rowsOfPage_ = std::min(mdb_get_int16(mdb_->pg_buf, offset), room);
  nextRow_ = 0;
  return true;
}

bool JetRows::ReadPage(std::uint32_t page) {
  return page != 0 && mdb_read_pg(mdb_, page) == mdb_->fmt->pg_size;
}

bool JetRows::Next() {
  for (;;) {
    while (nextRow_ >= rowsOfPage_) {
      if (!NextPage()) {
        return false;
      }
    }
    if (!ReadPage(page_)) {
      return false;
    }
    const int row = nextRow_++;
    const int entry =
        mdb_get_int16(mdb_->pg_buf, mdb_->fmt->row_count_offset + static_cast<int>(EntrySize) * (row + 1));
    if ((entry & Hidden) == 0 && FindRow(page_, row)) {
      return true;
    }
  }
}

bool JetRows::FindRow(std::uint32_t page, int row) {
  constexpr int mostMoves = 16;  // a damaged file could lead in a circle
  for (int moves = 0; moves < mostMoves; ++moves) {
    int start = 0;
    std::size_t size = 0;
    if (!ReadPage(page) || mdb_->pg_buf[0] != MDB_PAGE_DATA ||
        mdb_get_int32(mdb_->pg_buf, 4) != static_cast<long>(table_->entry->table_pg) ||
        row >= mdb_get_int16(mdb_->pg_buf, mdb_->fmt->row_count_offset) ||
        mdb_find_row(mdb_, row, &start, &size) != 0) {
      return false;
    }
    const bool isElsewhere = (start & Elsewhere) != 0;
    start &= OffsetMask;
    if (!isElsewhere) {
      rowPage_ = page;
      rowStart_ = start;
      row_.assign(reinterpret_cast<const char*>(mdb_->pg_buf) + start, size);
      return size != 0 && mdb_crack_row(table_, start, size, fields_.data()) >= 0;
    }
    constexpr std::size_t placeSize = 4;
    if (size < placeSize) {
      return false;
    }
    const auto place = static_cast<std::uint32_t>(mdb_get_int32(mdb_->pg_buf, start));
    page = place >> 8U;
    row = static_cast<int>(place & 0xFFU);
  }
  return false;
}

std::string_view JetRows::Bytes(unsigned int i) const {
  const MdbField& field = fields_[i];
  const auto at = static_cast<std::size_t>(std::max(field.start - rowStart_, 0));
  if (at >= row_.size()) {
    return {};
  }
  return std::string_view(row_).substr(at, static_cast<std::size_t>(std::max(field.siz, 0)));
}

std::string JetRows::DecimalText(unsigned int i) {
  // The library's conversion takes the number from the current page.
  if (!ReadPage(rowPage_)) {
    return {};
  }
  char* const text = mdb_numeric_to_string(mdb_, fields_[i].start, Column(i).col_scale, Column(i).col_prec);
  std::string copy = text == nullptr ? "" : text;
  g_free(text);
  return copy;
}
