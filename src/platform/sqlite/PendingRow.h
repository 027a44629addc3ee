#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "platform/Database.h"
#include "platform/sqlite/SqliteConnection.h"
#include "platform/sqlite/SqliteStatement.h"
#include "platform/sqlite/SqliteTable.h"

/// What AddNew or Edit has begun and Update will write: values for some of a table's columns. A failing write
/// leaves the values as they are.
class PendingRow {
 public:
  PendingRow(SqliteConnection& connection, const SqliteTable& table);

  ::EditMode Mode() const { return mode_; }

  /// A new row begins with the table's defaults.
  void Start(::EditMode mode);
  void Drop();

  /// The value for a column, or null when it has none here.
  const Value* Find(std::size_t column) const { return values_[column] ? &*values_[column] : nullptr; }

  /// Throw RuntimeError 3020 unless started; Set also as SqliteColumn::Accept does, and 3164 for the key of a
  /// row that is there already. The first Append to a column replaces what the row holds.
  void Set(std::size_t column, Value value);
  void Append(std::size_t column, const Blob& bytes);

  /// Adds the row and returns its key.
  std::int64_t Insert();

  /// Changes the row `key`; false when there is none. Writes nothing when no column was set.
  bool Change(std::int64_t key);

 private:
  void TakeDefaults();
  void CheckStarted() const;
  std::vector<std::size_t> ColumnsSet() const;
  void PrepareChange(const std::vector<std::size_t>& columns);

  SqliteConnection& connection_;
  const SqliteTable& table_;
  ::EditMode mode_ = ::EditMode::None;
  std::vector<std::optional<Value>> values_;
  SqliteStatement change_;  ///< kept, since many rows are changed in the same columns one after the other
  std::vector<std::size_t> changedColumns_;
};
