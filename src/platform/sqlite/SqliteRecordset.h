#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/Database.h"
#include "platform/sqlite/KeyCursor.h"
#include "platform/sqlite/PendingRow.h"
#include "platform/sqlite/RowCache.h"
#include "platform/sqlite/SqliteConnection.h"
#include "platform/sqlite/SqliteTable.h"

/// A dynaset over one table. The current row is read at the first Fields after a move, and of it only the
/// columns that were asked for since the last MoveFirst, which are few where many rows are looked up; all of
/// them once many were asked for without a look-up. A long binary column (declared type BLOB) is read whole
/// when the row's is first asked for.
class SqliteRecordset : public Recordset {
 public:
  /// The rows of `table` that `condition` holds for (all when it is empty), in table order. Throws as
  /// Database::OpenRecordset does.
  SqliteRecordset(SqliteConnection& connection, const std::string& table, const std::string& condition);

  void MoveFirst() override;
  void MoveNext() override { Move(&KeyCursor::MoveNext); }
  void MovePrevious() override { Move(&KeyCursor::MovePrevious); }
  void MoveLast() override { Move(&KeyCursor::MoveLast); }
  bool Eof() const override { return cursor_.Eof(); }
  bool Bof() const override { return cursor_.Bof(); }
  int RecordCount() const override { return static_cast<int>(cursor_.Keys().Size()); }
  int AbsolutePosition() const override {
    return cursor_.OnRow() ? static_cast<int>(cursor_.Position()) : -1;
  }
  void FindFirst(const std::string& criterion) override;
  bool NoMatch() const override { return noMatch_; }
  bool WalkTo(const std::string& column, const Value& value) override;

  const Value& Fields(std::string_view column) override;
  void AddNew() override;
  void Edit() override;
  void SetField(std::string_view column, Value value) override;
  void Update() override;
  void CancelUpdate() override;
  ::EditMode EditMode() const override { return pending_.Mode(); }
  void Delete() override;
  Blob GetChunk(std::string_view column, std::size_t offset, std::size_t count) override;
  void AppendChunk(std::string_view column, const Blob& bytes) override;

 private:
  void ReadKeys(const std::string& condition);
  std::size_t LongColumnAt(std::string_view name) const;

  void GoTo(std::size_t position);
  void Move(void (KeyCursor::*move)());
  void ForgetRow();
  std::optional<std::size_t> FirstPosition(SqliteStatement& search);
  bool WalkToKey(std::int64_t key);
  bool WalkToValue(std::size_t column, const Value& value);
  bool WalkToPosition(std::optional<std::size_t> position);
  std::optional<std::size_t> FirstWith(std::size_t column, const Value& value);

  void Want(std::size_t column);
  bool TryReadRow();
  bool ReadInto(std::vector<Value>& row, std::int64_t key);
  void ReadRow();
  const Value& LongValue(std::size_t column);
  [[noreturn]] void FailDeleted();

  SqliteConnection& connection_;
  SqliteTable table_;

  KeyCursor cursor_;

  std::string findCriterion_;
  SqliteStatement find_;
  bool noMatch_ = false;

  // By column, as are the other vectors.
  std::vector<SqliteStatement> walks_;
  std::vector<bool> wanted_;
  SqliteStatement read_;
  std::vector<Value> ownRow_;                ///< a row that was read outside of a group of reads
  const std::vector<Value>* row_ = nullptr;  ///< the current row once it is read
  RowCache cache_;
  /// The current row was searched by a value, as will be again; a walk reads each row once.
  bool lookedUp_ = false;
  std::map<std::size_t, Value> longValues_;

  PendingRow pending_;
};
