#pragma once

#include <cstdint>
#include <set>
#include <string>
#include <vector>

#include "platform/Database.h"
#include "platform/sqlite/SqliteConnection.h"
#include "platform/sqlite/SqliteTable.h"

/// Replaces the rows of a table in a new database file, in one transaction.
class TableImport {
 public:
  TableImport(const std::string& path, const std::string& table);

  /// The column names of the rows that follow. Columns that the table lacks are left out.
  void SetColumns(const std::vector<std::string>& columns);

  /// Throws RuntimeError if the table refuses the row.
  void AddRow(const std::vector<Value>& row);

  /// Commits the rows, reads them back and compares. Throws RuntimeError 3343 if they differ.
  void Finish();

  std::int64_t Rows() const { return rows_; }
  /// Columns that were left out.
  const std::vector<std::string>& UnknownColumns() const { return unknown_; }
  /// Number columns in which at least one text was not a number and became 0.
  const std::set<std::string>& ZeroedColumns() const { return zeroed_; }

 private:
  struct Target {
    std::size_t Source;  ///< index into a row passed to AddRow
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
