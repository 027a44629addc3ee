#include "platform/sqlite/PendingRow.h"

#include <algorithm>
#include <string>
#include <utility>

#include "platform/RuntimeError.h"

PendingRow::PendingRow(SqliteConnection& connection, const SqliteTable& table)
    : connection_(connection), table_(table), values_(table.Columns().size()) {}

void PendingRow::Start(::EditMode mode) {
  Drop();
  if (mode == ::EditMode::Add) {
    TakeDefaults();
  }
  mode_ = mode;
}

// Not for long columns: their first Append must start from nothing. The database fills in their defaults.
void PendingRow::TakeDefaults() {
  if (!defaults_) {
    std::string defaults;
    for (const SqliteColumn& column : table_.Columns()) {
      defaults += (defaults.empty() ? "SELECT " : ", ") +
                  (column.Default.empty() ? "NULL" : "(" + column.Default + ")");
    }
    defaults_ = SqliteStatement(connection_, defaults);
  }
  defaults_.Step();
  for (std::size_t i = 0; i < values_.size(); ++i) {
    const SqliteColumn& column = table_.Columns()[i];
    if (!column.Default.empty() && !column.IsLong) {
      defaults_.Read(static_cast<int>(i), values_[i].emplace());
    }
  }
  defaults_.Reset();
}

void PendingRow::Drop() {
  if (mode_ != ::EditMode::None) {
    mode_ = ::EditMode::None;
    std::fill(values_.begin(), values_.end(), std::nullopt);
  }
}

void PendingRow::CheckStarted() const {
  if (mode_ == ::EditMode::None) {
    throw RuntimeError(Fault::UpdateWithoutEdit);
  }
}

void PendingRow::Set(std::size_t column, Value value) {
  CheckStarted();
  const SqliteColumn& target = table_.Columns()[column];
  if (target.IsKey && mode_ == ::EditMode::InProgress) {
    throw RuntimeError(Fault::FieldReadOnly, "Field cannot be updated: " + target.Name);
  }
  values_[column] = target.Accept(std::move(value));
}

void PendingRow::Append(std::size_t column, const Blob& bytes) {
  CheckStarted();
  std::optional<Value>& value = values_[column];
  if (!value || !std::holds_alternative<Blob>(*value)) {
    value = Blob();
  }
  auto& held = std::get<Blob>(*value);
  held.insert(held.end(), bytes.begin(), bytes.end());
}

std::vector<std::size_t> PendingRow::ColumnsSet() const {
  std::vector<std::size_t> columns;
  for (std::size_t i = 0; i < values_.size(); ++i) {
    if (values_[i]) {
      columns.push_back(i);
    }
  }
  return columns;
}

void PendingRow::PrepareInsertion(const std::vector<std::size_t>& columns) {
  if (insertion_ && insertedColumns_ == columns) {
    return;
  }
  std::string names;
  std::string marks;
  for (const std::size_t i : columns) {
    names += (names.empty() ? "[" : ", [") + table_.Columns()[i].Name + "]";
    marks += marks.empty() ? "?" : ", ?";
  }
  insertion_ = SqliteStatement(
      connection_, "INSERT INTO [" + table_.Name() + "] " +
                       (columns.empty() ? "DEFAULT VALUES" : "(" + names + ") VALUES (" + marks + ")"));
  insertedColumns_ = columns;
}

std::int64_t PendingRow::Insert() {
  const std::vector<std::size_t> columns = ColumnsSet();
  WriteTransaction transaction(connection_);
  PrepareInsertion(columns);
  for (std::size_t i = 0; i < columns.size(); ++i) {
    insertion_.Bind(static_cast<int>(i + 1), *values_[columns[i]]);
  }
  insertion_.Step();
  const std::int64_t key = connection_.LastInsertedKey();
  TellOf(transaction, key, columns);
  transaction.Commit();
  return key;
}

void PendingRow::TellOf(WriteTransaction& transaction, std::int64_t key,
                        const std::vector<std::size_t>& columns) const {
  if (!transaction.Written().Write(table_.Name(), key)) {
    return;
  }
  for (const std::size_t i : columns) {
    transaction.Written().Set(table_.Name(), key, table_.Columns()[i].Name, *values_[i]);
  }
}

void PendingRow::PrepareChange(const std::vector<std::size_t>& columns) {
  if (change_ && changedColumns_ == columns) {
    return;
  }
  std::string assignments;
  for (const std::size_t i : columns) {
    assignments += (assignments.empty() ? "[" : ", [") + table_.Columns()[i].Name + "] = ?";
  }
  change_ =
      SqliteStatement(connection_, "UPDATE [" + table_.Name() + "] SET " + assignments + " WHERE rowid = ?");
  changedColumns_ = columns;
}

bool PendingRow::Change(std::int64_t key) {
  const std::vector<std::size_t> columns = ColumnsSet();
  if (columns.empty()) {
    connection_.PrepareRead();
    SqliteStatement row(connection_, "SELECT 1 FROM [" + table_.Name() + "] WHERE rowid = ?");
    row.Bind(1, key);
    return row.Step();
  }
  WriteTransaction transaction(connection_);
  PrepareChange(columns);
  for (std::size_t i = 0; i < columns.size(); ++i) {
    change_.Bind(static_cast<int>(i + 1), *values_[columns[i]]);
  }
  change_.Bind(static_cast<int>(columns.size() + 1), key);
  change_.Step();
  const bool changed = connection_.ChangedRows() != 0;
  if (changed) {
    TellOf(transaction, key, columns);
  }
  transaction.Commit();
  return changed;
}
