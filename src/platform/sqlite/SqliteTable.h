#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "platform/Database.h"
#include "platform/sqlite/SqliteConnection.h"

struct SqliteColumn {
  std::string Name;
  std::string Default;    ///< SQL expression, empty for none
  bool IsLong = false;    ///< long binary
  bool IsNumber = false;  ///< takes numbers only
  bool IsKey = false;     ///< given by the database on insertion
  bool IsText = false;    ///< keeps texts as texts

  /// `value` as this column keeps it: a text that goes into a number column becomes the number that it says,
  /// blanks around it being no fault. Throws RuntimeError 3421 when it says none.
  Value Accept(Value value) const;
};

/// A table as its recordsets know it: by name and columns.
class SqliteTable {
 public:
  /// Throws RuntimeError 3078 when there is no such table.
  SqliteTable(SqliteConnection& connection, const std::string& name);

  const std::string& Name() const { return name_; }
  const std::vector<SqliteColumn>& Columns() const { return columns_; }

  /// Position of the column in Columns(); case does not count. Throws RuntimeError 3265 when there is none.
  std::size_t ColumnAt(std::string_view name) const;

 private:
  std::string name_;
  std::vector<SqliteColumn> columns_;
};
