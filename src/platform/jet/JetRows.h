#pragma once

#include <glib.h>  // which must not be included for the first time by the library
#include <mdbtools.h>

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

/// Goes through the rows of a table in the order of its pages. A row that outgrew its page is read where its
/// entry stands; what deleted rows leave behind is passed over.
///
/// The library's own mdb_fetch_row does neither, and turns every value into text, which takes most of its
/// time.
class JetRows {
 public:
  explicit JetRows(MdbTableDef* table);

  /// Reads the next row. False behind the last one. Rows that cannot be read are passed over: compare the
  /// number of rows with the table's own.
  bool Next();

  unsigned int ColumnCount() const { return table_->num_cols; }
  const MdbColumn& Column(unsigned int i) const {
    return *static_cast<const MdbColumn*>(g_ptr_array_index(table_->columns, i));
  }

  bool IsNull(unsigned int i) const { return fields_[i].is_null != 0; }

  /// The bytes that the row stores for a column; valid until the next row.
  std::string_view Bytes(unsigned int i) const;

  /// A decimal number (MDB_NUMERIC) as text.
  std::string DecimalText(unsigned int i);

 private:
  bool NextPage();
  bool ReadPage(std::uint32_t page);
  bool FindRow(std::uint32_t page, int row);

  MdbTableDef* table_;
  MdbHandle* mdb_;
  std::uint32_t page_ = 0;  ///< whose rows are gone through; 0 before the first
  int rowsOfPage_ = 0;
  int nextRow_ = 0;
  std::uint32_t rowPage_ = 0;  ///< that holds the current row's values
  int rowStart_ = 0;           ///< offset in that page
  std::string row_;            ///< its bytes
  std::vector<MdbField> fields_;
};
