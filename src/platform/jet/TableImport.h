#pragma once

#include <cstdint>
#include <set>
#include <string>
#include <vector>

#include "platform/Database.h"
#include "platform/sqlite/SqliteConnection.h"
#include "platform/sqlite/SqliteTable.h"

/// Fills a table of a new database file, whose rows it replaces. All of it is one transaction.
class TableImport {
 public:
  TableImport(const std::string& path, const std::string& table);

  /// Names of the columns of the rows to come. Columns that the table does not have are left out.
  void SetColumns(const std::vector<std::string>& columns);

  /// Throws RuntimeError when the table refuses the row.
  void AddRow(const std::vector<Value>& row);

  /// Makes the rows durable, reads them back and compares. Throws RuntimeError 3343 when they differ.
  void Finish();

  std::int64_t Rows() const { return rows_; }
  /// Columns that were left out.
  const std::vector<std::string>& UnknownColumns() const { return unknown_; }
  /// Columns in which a text that is no number became 0.
  const std::set<std::string>& ZeroedColumns() const { return zeroed_; }

 private:
  struct Target {
    std::size_t Source;  ///< place in the rows to come
    SqliteColumn Column;
  };

  Value Fitting(const Target& target, const Value& value);

  SqliteConnection connection_;
  SqliteTable table_;
  WriteTransaction transaction_;
  std::vector<Target> targets_;
  std::vector<std::string> unknown_;
  std::set<std::string> zeroed_;
  SqliteStatement insert_;
  std::int64_t rows_ = 0;
  std::uint64_t checksum_ = 0;
};
