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
  bool IsKey = false;     ///< assigned by the database on insertion
  bool IsText = false;    ///< does not convert texts that look like numbers

  /// `value` as this column stores it: in a number column a text becomes the number it spells, blanks around
  /// it ignored. Throws RuntimeError 3421 if it is not a number.
  Value Accept(Value value) const;
};

/// Name and columns of a table.
class SqliteTable {
 public:
  /// Throws RuntimeError 3078 if there is no such table.
  SqliteTable(SqliteConnection& connection, const std::string& name);

  const std::string& Name() const { return name_; }
  const std::vector<SqliteColumn>& Columns() const { return columns_; }

  /// Index of the column in Columns(), ignoring case. Throws RuntimeError 3265 if there is none.
  std::size_t ColumnAt(std::string_view name) const;

 private:
  std::string name_;
  std::vector<SqliteColumn> columns_;
};
