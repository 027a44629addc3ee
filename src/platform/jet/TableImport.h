#pragma once

#include <cstdint>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "platform/Database.h"
#include "platform/OldDatabases.h"
#include "platform/jet/ConversionBusyTimeout.h"
#include "platform/sqlite/SqliteConnection.h"
#include "platform/sqlite/SqliteTable.h"

/// Replaces the rows of a table in a new database file, in one transaction. The file is not durable when that
/// is done: flush it before it is used.
class TableImport {
 public:
  TableImport(const std::string& path, const std::string& table,
              std::chrono::milliseconds lockWait = ConversionBusyTimeout);

  /// The column names of the rows that follow. Columns that the table lacks are left out.
  void SetColumns(const std::vector<std::string>& columns);

  /// `unread` are the indexes of values that are not the old file's whole ones. Throws OldDatabaseRefused,
  /// which names row and column, if the table refuses a value.
  void AddRow(const std::vector<Value>& row, const std::vector<std::size_t>& unread = {});

  /// Commits the rows, reads them back and compares. Throws RuntimeError 3343 if they differ.
  void Finish();

  std::int64_t Rows() const { return rows_; }
  /// Columns that were left out.
  const std::vector<std::string>& UnknownColumns() const { return unknown_; }
  /// Columns of the table that the rows lack.
  const std::vector<std::string>& MissingColumns() const { return missing_; }
  /// Number columns in which at least one text was not a number and became 0.
  const std::set<std::string>& ZeroedColumns() const { return zeroed_; }
  /// Values of known columns that AddRow was told are not whole.
  const std::vector<NotTakenOver>& UnreadValues() const { return unreadValues_; }

 private:
  struct Target {
    std::size_t Source;  ///< index into a row passed to AddRow
    SqliteColumn Column;
    Value WhenNull;       ///< the default of a column that must not be NULL
    Value Converted;      ///< the current row's value in the form that the column takes
    const Value* Stored;  ///< what goes into the current row
  };

  void TakeIndexesAway();
  void PrepareInsert();
  void Insert();
  void NoteUnread(const std::vector<std::size_t>& unread);
  const Value& Fitting(Target& target, const Value& value);
  NotTakenOver ValueOf(const std::string& column) const;
  [[noreturn]] void Refuse(const std::string& column) const;
  std::uint64_t HashOfRow() const;

  SqliteConnection connection_;
  SqliteTable table_;
  std::optional<WriteTransaction> transaction_;
  std::vector<std::string> indexes_;  ///< statements that make them again
  std::vector<Target> targets_;
  std::vector<std::string> unknown_;
  std::vector<std::string> missing_;
  std::set<std::string> zeroed_;
  std::vector<NotTakenOver> unreadValues_;
  SqliteStatement insert_;
  std::int64_t rows_ = 0;
  std::int64_t lastKey_ = 0;
  std::uint64_t checksum_ = 0;
};
