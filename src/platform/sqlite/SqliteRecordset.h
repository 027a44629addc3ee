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

/// A dynaset over one table. The first Fields after a move reads the current row, but only the columns used
/// since the last MoveFirst: few when many rows are looked up. Once many columns have been used without a
/// look-up, all are read. A long binary column (declared type BLOB) is read separately, when first used.
class SqliteRecordset : public Recordset {
 public:
  /// The rows of `table` for which `condition` is true (all if it is empty), in table order. Throws as
  /// Database::OpenRecordset does.
  SqliteRecordset(SqliteConnection& connection, const std::string& table, const std::string& condition);

  void MoveFirst() override;
  void MoveNext() override { Move(&KeyCursor::MoveNext); }
  void MovePrevious() override { Move(&KeyCursor::MovePrevious); }
  void MoveLast() override { Move(&KeyCursor::MoveLast); }
  void MoveTo(int position) override;
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

  // Indexed by column, like the other vectors.
  std::vector<SqliteStatement> walks_;
  std::vector<bool> wanted_;
  SqliteStatement read_;
  std::vector<Value> ownRow_;                ///< the last row read from the file
  const std::vector<Value>* row_ = nullptr;  ///< the current row once it has been read
  RowCache cache_;
  /// True if WalkTo found the current row. Such rows are cached, since they will be looked up again; moving
  /// along the rows reads each one only once.
  bool lookedUp_ = false;
  std::map<std::size_t, Value> longValues_;

  PendingRow pending_;
};
