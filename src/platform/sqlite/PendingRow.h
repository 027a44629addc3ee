#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "platform/Database.h"
#include "platform/sqlite/SqliteConnection.h"
#include "platform/sqlite/SqliteStatement.h"
#include "platform/sqlite/SqliteTable.h"

/// The column values set between AddNew or Edit and Update, which writes them. A failed write keeps them.
class PendingRow {
 public:
  PendingRow(SqliteConnection& connection, const SqliteTable& table);

  ::EditMode Mode() const { return mode_; }

  /// A new row starts with the table's defaults.
  void Start(::EditMode mode);
  void Drop();

  /// The pending value of a column, or nullptr.
  const Value* Find(std::size_t column) const { return values_[column] ? &*values_[column] : nullptr; }

  /// Both throw RuntimeError 3020 unless started. Set also throws as SqliteColumn::Accept does, and 3164 for
  /// the key of an existing row. The first Append to a column replaces the row's old bytes.
  void Set(std::size_t column, Value value);
  void Append(std::size_t column, const Blob& bytes);

  /// Adds the row and returns its key.
  std::int64_t Insert();

  /// Changes the row `key`; false if it does not exist. Writes nothing if no column was set.
  bool Change(std::int64_t key);

 private:
  void TakeDefaults();
  void CheckStarted() const;
  std::vector<std::size_t> ColumnsSet() const;
  void TellOf(WriteTransaction& transaction, std::int64_t key, const std::vector<std::size_t>& columns) const;
  void PrepareInsertion(const std::vector<std::size_t>& columns);
  void PrepareChange(const std::vector<std::size_t>& columns);

  SqliteConnection& connection_;
  const SqliteTable& table_;
  ::EditMode mode_ = ::EditMode::None;
  std::vector<std::optional<Value>> values_;
  // Kept, since the same columns are often written in many rows in turn.
  SqliteStatement defaults_;
  SqliteStatement insertion_;
  std::vector<std::size_t> insertedColumns_;
  SqliteStatement change_;
  std::vector<std::size_t> changedColumns_;
};
