#include "platform/sqlite/SqliteRecordset.h"

#include <algorithm>
#include <utility>

#include "platform/RuntimeError.h"

namespace {

const Value Null;

// Resets a query that may stop before its last row, since it would go on holding the file's lock.
class ResetAtEnd {
 public:
  explicit ResetAtEnd(SqliteStatement& statement) : statement_(statement) {}
  ~ResetAtEnd() { statement_.Reset(); }
  ResetAtEnd(const ResetAtEnd&) = delete;
  ResetAtEnd& operator=(const ResetAtEnd&) = delete;

 private:
  SqliteStatement& statement_;
};

}  // namespace

SqliteRecordset::SqliteRecordset(SqliteConnection& connection, const std::string& table,
                                 const std::string& condition)
    : connection_(connection),
      table_(connection, table),
      walks_(table_.Columns().size()),
      wanted_(table_.Columns().size()),
      ownRow_(table_.Columns().size()),
      pending_(connection, table_) {
  ReadKeys(condition);
}

// The keys are read in whatever order is cheapest, since KeySet sorts them several times faster than SQLite
// would. The keys of a whole table can then come from an index, which is much smaller than the table: a cold
// start is several times faster.
void SqliteRecordset::ReadKeys(const std::string& condition) {
  connection_.PrepareRead();
  SqliteStatement search =
      condition.empty()
          ? SqliteStatement(connection_, "SELECT rowid FROM [" + table_.Name() + "]")
          : connection_.PrepareSearch(table_, condition, SqliteConnection::Order::Any, Fault::QuerySyntax);
  std::vector<std::int64_t> keys;
  while (search.Step()) {
    keys.push_back(search.Integer(0));
  }
  cursor_ = KeyCursor(KeySet(std::move(keys)));
}

std::size_t SqliteRecordset::LongColumnAt(std::string_view name) const {
  const std::size_t column = table_.ColumnAt(name);
  if (!table_.Columns()[column].IsLong) {
    throw RuntimeError(Fault::InvalidFieldType, "Invalid field data type: " + std::string(name));
  }
  return column;
}

void SqliteRecordset::GoTo(std::size_t position) {
  cursor_.MoveTo(position);
  ForgetRow();
}

void SqliteRecordset::ForgetRow() {
  row_ = nullptr;
  longValues_.clear();
}

void SqliteRecordset::Move(void (KeyCursor::*move)()) {
  pending_.Drop();
  lookedUp_ = false;
  (cursor_.*move)();
  ForgetRow();
}

void SqliteRecordset::MoveFirst() {
  Move(&KeyCursor::MoveFirst);
  // A new pass over the rows may need other columns than the last one did.
  wanted_.assign(wanted_.size(), false);
  read_ = SqliteStatement();
  cache_.Clear();
}

void SqliteRecordset::MoveTo(int position) {
  if (position < 0 || position >= RecordCount()) {
    throw RuntimeError(Fault::NoCurrentRecord);
  }
  pending_.Drop();
  lookedUp_ = false;
  GoTo(static_cast<std::size_t>(position));
}

std::optional<std::size_t> SqliteRecordset::FirstPosition(SqliteStatement& search) {
  connection_.PrepareRead();
  const ResetAtEnd reset(search);
  std::optional<std::size_t> first;
  while (search.Step()) {
    const std::optional<std::size_t> position = cursor_.Keys().PositionOf(search.Integer(0));
    if (position && (!first || *position < *first)) {
      first = position;
      // The query yields ascending keys, so no later one can come before this.
      if (cursor_.Keys().Ascending()) {
        break;
      }
    }
  }
  return first;
}

void SqliteRecordset::FindFirst(const std::string& criterion) {
  pending_.Drop();
  // The query is kept: scoring looks up the same mission once for each player.
  if (!find_ || criterion != findCriterion_) {
    connection_.PrepareRead();
    find_ =
        connection_.PrepareSearch(table_, criterion, SqliteConnection::Order::Table, Fault::CriterionSyntax);
    findCriterion_ = criterion;
  }
  const std::optional<std::size_t> position = FirstPosition(find_);
  noMatch_ = !position;
  if (position) {
    GoTo(*position);
  } else {
    connection_.Rollback();
  }
}

bool SqliteRecordset::WalkTo(const std::string& column, const Value& value) {
  pending_.Drop();
  lookedUp_ = true;
  const std::size_t i = table_.ColumnAt(column);
  const auto* key = table_.Columns()[i].IsKey ? std::get_if<std::int64_t>(&value) : nullptr;
  if (key != nullptr ? WalkToKey(*key) : WalkToValue(i, value)) {
    return true;
  }
  cursor_.MoveBehind();
  ForgetRow();
  connection_.Rollback();
  return false;
}

// The most common look-up, for which reading the row also shows that it exists.
bool SqliteRecordset::WalkToKey(std::int64_t key) {
  const std::optional<std::size_t> position = cursor_.Keys().PositionOf(key);
  if (!position) {
    return false;
  }
  GoTo(*position);
  return TryReadRow();
}

bool SqliteRecordset::WalkToValue(std::size_t column, const Value& value) {
  const auto* text = std::get_if<std::string>(&value);
  if (text == nullptr || !connection_.InGroup()) {
    return WalkToPosition(FirstWith(column, value));
  }
  connection_.PrepareRead();
  cache_.Enter(connection_.State());
  if (const auto* found = cache_.Found(column, *text)) {
    return WalkToPosition(*found);
  }
  const std::optional<std::size_t> position = FirstWith(column, value);
  cache_.AddFound(column, *text, position);
  return WalkToPosition(position);
}

bool SqliteRecordset::WalkToPosition(std::optional<std::size_t> position) {
  if (position) {
    GoTo(*position);
  }
  return position.has_value();
}

std::optional<std::size_t> SqliteRecordset::FirstWith(std::size_t column, const Value& value) {
  SqliteStatement& walk = walks_[column];
  if (!walk) {
    connection_.PrepareRead();
    walk = SqliteStatement(connection_, "SELECT rowid FROM [" + table_.Name() + "] WHERE [" +
                                            table_.Columns()[column].Name +
                                            "] = ?1 COLLATE BINARY ORDER BY rowid");
  }
  walk.Bind(1, value);
  return FirstPosition(walk);
}

bool SqliteRecordset::TryReadRow() {
  const std::int64_t key = cursor_.Key();
  if (row_ != nullptr) {
    return true;
  }
  connection_.PrepareRead();
  if (!connection_.InGroup() || !lookedUp_) {
    row_ = ReadInto(ownRow_, key) ? &ownRow_ : nullptr;
    return row_ != nullptr;
  }
  cache_.Enter(connection_.State());
  row_ = cache_.Row(key);
  if (row_ == nullptr && ReadInto(ownRow_, key)) {
    row_ = &(cache_.AddRow(key) = ownRow_);
  }
  return row_ != nullptr;
}

bool SqliteRecordset::ReadInto(std::vector<Value>& row, std::int64_t key) {
  if (!read_) {
    std::string list;
    for (std::size_t i = 0; i < wanted_.size(); ++i) {
      list += wanted_[i] ? ", [" + table_.Columns()[i].Name + "]" : "";
    }
    read_ = SqliteStatement(connection_,
                            "SELECT rowid" + list + " FROM [" + table_.Name() + "] WHERE rowid = ?1");
  }
  read_.Bind(1, key);
  const ResetAtEnd reset(read_);
  if (!read_.Step()) {
    return false;
  }
  int read = 1;
  for (std::size_t i = 0; i < wanted_.size(); ++i) {
    if (wanted_[i]) {
      read_.Read(read++, row[i]);
    }
  }
  return true;
}

void SqliteRecordset::ReadRow() {
  if (!TryReadRow()) {
    FailDeleted();
  }
}

const Value& SqliteRecordset::LongValue(std::size_t column) {
  const std::int64_t key = cursor_.Key();
  const auto held = longValues_.find(column);
  if (held != longValues_.end()) {
    return held->second;
  }
  connection_.PrepareRead();
  SqliteStatement read(connection_, "SELECT [" + table_.Columns()[column].Name + "] FROM [" + table_.Name() +
                                        "] WHERE rowid = ?1");
  read.Bind(1, key);
  if (!read.Step()) {
    FailDeleted();
  }
  Value& value = longValues_[column];
  read.Read(0, value);
  return value;
}

void SqliteRecordset::FailDeleted() {
  connection_.Rollback();
  throw RuntimeError(Fault::RecordDeleted);
}

const Value& SqliteRecordset::Fields(std::string_view column) {
  const std::size_t i = table_.ColumnAt(column);
  if (const Value* value = pending_.Find(i)) {
    return *value;
  }
  if (pending_.Mode() == ::EditMode::Add) {
    return Null;
  }
  if (table_.Columns()[i].IsLong) {
    return LongValue(i);
  }
  if (!wanted_[i]) {
    Want(i);
    read_ = SqliteStatement();
    row_ = nullptr;
    cache_.Clear();
  }
  ReadRow();
  return (*row_)[i];
}

// A caller that reads many columns of a row it has moved to, not looked up, is showing the whole row and will
// soon need the rest: read all of them at once.
void SqliteRecordset::Want(std::size_t column) {
  wanted_[column] = true;
  constexpr std::ptrdiff_t few = 3;
  if (!lookedUp_ && std::count(wanted_.begin(), wanted_.end(), true) > few) {
    for (std::size_t i = 0; i < wanted_.size(); ++i) {
      wanted_[i] = !table_.Columns()[i].IsLong;
    }
  }
}

void SqliteRecordset::AddNew() {
  pending_.Start(::EditMode::Add);
}

void SqliteRecordset::Edit() {
  pending_.Drop();
  ForgetRow();
  ReadRow();
  pending_.Start(::EditMode::InProgress);
}

void SqliteRecordset::SetField(std::string_view column, Value value) {
  pending_.Set(table_.ColumnAt(column), std::move(value));
}

void SqliteRecordset::Update() {
  switch (pending_.Mode()) {
    case ::EditMode::None:
      throw RuntimeError(Fault::UpdateWithoutEdit);
    case ::EditMode::InProgress:
      ForgetRow();
      if (!pending_.Change(cursor_.Key())) {
        FailDeleted();
      }
      break;
    case ::EditMode::Add:
      cursor_.Append(pending_.Insert());
      break;
  }
  pending_.Drop();
}

void SqliteRecordset::CancelUpdate() {
  if (pending_.Mode() == ::EditMode::None) {
    throw RuntimeError(Fault::UpdateWithoutEdit);
  }
  pending_.Drop();
}

void SqliteRecordset::Delete() {
  pending_.Drop();
  const std::int64_t key = cursor_.Key();
  WriteTransaction transaction(connection_);
  SqliteStatement deletion(connection_, "DELETE FROM [" + table_.Name() + "] WHERE rowid = ?1");
  deletion.Bind(1, key);
  deletion.Step();
  if (connection_.ChangedRows() == 0) {
    FailDeleted();
  }
  transaction.Written().Delete(table_.Name(), key);
  transaction.Commit();
  cursor_.Erase();
  ForgetRow();
}

Blob SqliteRecordset::GetChunk(std::string_view column, std::size_t offset, std::size_t count) {
  LongColumnAt(column);
  const auto* bytes = std::get_if<Blob>(&Fields(column));
  if (bytes == nullptr || offset >= bytes->size()) {
    return {};
  }
  const auto first = bytes->begin() + static_cast<std::ptrdiff_t>(offset);
  return {first, first + static_cast<std::ptrdiff_t>(std::min(count, bytes->size() - offset))};
}

void SqliteRecordset::AppendChunk(std::string_view column, const Blob& bytes) {
  pending_.Append(LongColumnAt(column), bytes);
}
