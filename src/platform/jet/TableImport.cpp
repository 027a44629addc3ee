#include "platform/jet/TableImport.h"

#include <charconv>
#include <cmath>
#include <functional>
#include <string_view>

#include "platform/RuntimeError.h"

namespace {

/// A value's share of its row's checksum. An integer and a double of equal value hash alike, since a column
/// may store a whole number as either.
std::uint64_t HashOf(const Value& value) {
  if (const auto* integer = std::get_if<std::int64_t>(&value)) {
    return std::hash<double>()(static_cast<double>(*integer)) + 1;
  }
  if (const auto* real = std::get_if<double>(&value)) {
    return std::hash<double>()(*real) + 1;
  }
  if (const auto* text = std::get_if<std::string>(&value)) {
    return std::hash<std::string>()(*text) + 2;
  }
  if (const auto* bytes = std::get_if<Blob>(&value)) {
    return std::hash<std::string_view>()({reinterpret_cast<const char*>(bytes->data()), bytes->size()}) + 3;
  }
  return 4;
}

std::uint64_t Mixed(std::uint64_t row, std::uint64_t value) {
  return (row ^ value) * 0x9E3779B97F4A7C15U;
}

std::string TextOfNumber(const Value& value) {
  char text[64];
  char* end = text;
  if (const auto* integer = std::get_if<std::int64_t>(&value)) {
    end = std::to_chars(text, text + sizeof text, *integer).ptr;
  } else if (const auto* real = std::get_if<double>(&value)) {
    end = std::to_chars(text, text + sizeof text, *real).ptr;
  }
  return {text, end};
}

}  // namespace

TableImport::TableImport(const std::string& path, const std::string& table,
                         std::chrono::milliseconds lockWait)
    : connection_(path, lockWait), table_(connection_, table) {
  connection_.Execute("PRAGMA synchronous = OFF");
  connection_.Execute("PRAGMA cache_size = -65536");  // KiB
  transaction_.emplace(connection_);
  connection_.Execute(("DELETE FROM [" + table_.Name() + "]").c_str());
  TakeIndexesAway();
}

// Making an index of all rows at the end takes a fraction of the time of adding to it row by row.
void TableImport::TakeIndexesAway() {
  std::vector<std::string> names;
  SqliteStatement query(
      connection_,
      "SELECT m.name, m.sql FROM sqlite_master m, pragma_index_list(?1) i "
      "WHERE m.type = 'index' AND m.name = i.name AND m.sql IS NOT NULL AND NOT i.[unique]");
  const Value tableName = table_.Name();
  query.Bind(1, tableName);
  while (query.Step()) {
    names.push_back(query.Text(0));
    indexes_.push_back(query.Text(1));
  }
  for (const std::string& name : names) {
    connection_.Execute(("DROP INDEX [" + name + "]").c_str());
  }
}

void TableImport::SetColumns(const std::vector<std::string>& columns) {
  std::set<std::string> required;
  SqliteStatement info(connection_, "SELECT name FROM pragma_table_info(?1) WHERE [notnull]");
  const Value tableName = table_.Name();
  info.Bind(1, tableName);
  while (info.Step()) {
    required.insert(info.Text(0));
  }
  std::set<std::string> known;
  for (std::size_t source = 0; source < columns.size(); ++source) {
    try {
      const SqliteColumn& column = table_.Columns()[table_.ColumnAt(columns[source])];
      targets_.push_back({source, column, {}, {}, nullptr});
      known.insert(column.Name);
      if (required.count(column.Name) != 0 && !column.Default.empty()) {
        SqliteStatement value(connection_, "SELECT " + column.Default);
        value.Step();
        value.Read(0, targets_.back().WhenNull);
      }
    } catch (const RuntimeError&) {
      unknown_.push_back(columns[source]);
    }
  }
  for (const SqliteColumn& column : table_.Columns()) {
    if (known.count(column.Name) == 0) {
      missing_.push_back(column.Name);
    }
  }
  PrepareInsert();
}

void TableImport::PrepareInsert() {
  if (targets_.empty()) {
    throw OldDatabaseRefused({{NotTakenOver::TableRows, table_.Name()}});
  }
  std::string names;
  std::string values;
  for (const Target& target : targets_) {
    names += (names.empty() ? "[" : ", [") + target.Column.Name + "]";
    values += values.empty() ? "?" : ", ?";
  }
  insert_ = SqliteStatement(connection_,
                            "INSERT INTO [" + table_.Name() + "] (" + names + ") VALUES (" + values + ")");
}

void TableImport::AddRow(const std::vector<Value>& row, const std::vector<std::size_t>& unread) {
  ++rows_;
  for (Target& target : targets_) {
    target.Stored = &Fitting(target, row[target.Source]);
  }
  for (const Target& target : targets_) {
    // SQLite would store it as NULL.
    if (const auto* real = std::get_if<double>(target.Stored); real != nullptr && std::isnan(*real)) {
      Refuse(target.Column.Name);
    }
  }
  if (!unread.empty()) {
    NoteUnread(unread);
  }
  Insert();
  lastKey_ = connection_.LastInsertedKey();
  checksum_ += HashOfRow();
}

void TableImport::Insert() {
  for (std::size_t i = 0; i < targets_.size(); ++i) {
    insert_.Bind(static_cast<int>(i + 1), *targets_[i].Stored);
  }
  try {
    insert_.Step();
  } catch (const RuntimeError& error) {
    switch (error.Number()) {
      case Fault::DuplicateKey:
      case Fault::ValueRequired:
      case Fault::ValueProhibited:
      case Fault::DataConversion:
        break;
      default:
        throw;
    }
    // SQLite tells the column only within the text of its error.
    const std::string text = error.what();
    std::string named;
    for (const Target& target : targets_) {
      if (target.Column.Name.size() > named.size() && text.find(target.Column.Name) != std::string::npos) {
        named = target.Column.Name;
      }
    }
    Refuse(named);
  }
}

void TableImport::NoteUnread(const std::vector<std::size_t>& unread) {
  for (const std::size_t source : unread) {
    for (const Target& target : targets_) {
      if (target.Source != source) {
        continue;
      }
      unreadValues_.push_back(ValueOf(target.Column.Name));
      // A column beside it may hold the length of a value that is now left out.
      for (Target& other : targets_) {
        if (target.Column.IsLong && other.Column.Name == target.Column.Name + "Length") {
          other.Converted = std::int64_t{0};
          other.Stored = &other.Converted;
        }
      }
    }
  }
}

NotTakenOver TableImport::ValueOf(const std::string& column) const {
  std::string row = std::to_string(rows_);
  for (const Target& target : targets_) {
    if (target.Column.IsKey && target.Stored != nullptr) {
      row += " (" + target.Column.Name + " " + TextOfNumber(*target.Stored) + ")";
    }
  }
  return {.What = NotTakenOver::OneValue, .Name = column, .InTable = table_.Name(), .InRow = row};
}

void TableImport::Refuse(const std::string& column) const {
  throw OldDatabaseRefused({ValueOf(column)});
}

const Value& TableImport::Fitting(Target& target, const Value& value) {
  const bool isText = std::holds_alternative<std::string>(value);
  if (target.Column.IsNumber && isText) {
    try {
      target.Converted = target.Column.Accept(value);
    } catch (const RuntimeError&) {
      zeroed_.insert(target.Column.Name);
      target.Converted = std::int64_t{0};
    }
    return target.Converted;
  }
  const bool isNumber = std::holds_alternative<std::int64_t>(value) || std::holds_alternative<double>(value);
  if (isNumber && !target.Column.IsNumber && !target.Column.IsLong) {
    target.Converted = TextOfNumber(value);
    return target.Converted;
  }
  return std::holds_alternative<std::monostate>(value) ? target.WhenNull : value;
}

std::uint64_t TableImport::HashOfRow() const {
  std::uint64_t hash = 0;
  for (const Target& target : targets_) {
    const bool isNew = target.Column.IsKey && std::holds_alternative<std::monostate>(*target.Stored);
    hash = Mixed(hash, isNew ? HashOf(lastKey_) : HashOf(*target.Stored));
  }
  return hash;
}

void TableImport::Finish() {
  for (const std::string& index : indexes_) {
    connection_.Execute(index.c_str());
  }
  if (rows_ > 0) {
    transaction_->Written().Write(table_.Name(), lastKey_);  // so that a commit that failed is known by it
  }
  transaction_->Commit();
  std::string names;
  for (const Target& target : targets_) {
    names += (names.empty() ? "[" : ", [") + target.Column.Name + "]";
  }
  SqliteStatement rows(connection_, "SELECT " + names + " FROM [" + table_.Name() + "]");
  std::uint64_t checksum = 0;
  std::int64_t count = 0;
  Value value;
  while (rows.Step()) {
    std::uint64_t hash = 0;
    for (std::size_t i = 0; i < targets_.size(); ++i) {
      rows.Read(static_cast<int>(i), value);
      hash = Mixed(hash, HashOf(value));
    }
    checksum += hash;
    ++count;
  }
  if (count != rows_ || checksum != checksum_) {
    throw RuntimeError(Fault::UnrecognizedDatabase, "The new file does not hold what was written to it.");
  }
}
