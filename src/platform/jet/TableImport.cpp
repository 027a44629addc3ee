#include "platform/jet/TableImport.h"

#include <charconv>
#include <functional>
#include <string_view>

#include "platform/RuntimeError.h"

namespace {

constexpr std::chrono::milliseconds BusyTimeout(1000);

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

TableImport::TableImport(const std::string& path, const std::string& table)
    : connection_(path, BusyTimeout), table_(connection_, table), transaction_(connection_) {
  connection_.Execute(("DELETE FROM [" + table_.Name() + "]").c_str());
}

void TableImport::SetColumns(const std::vector<std::string>& columns) {
  std::string names;
  std::string values;
  std::set<std::string> required;
  SqliteStatement info(connection_, "SELECT name FROM pragma_table_info(?1) WHERE [notnull]");
  const Value tableName = table_.Name();
  info.Bind(1, tableName);
  while (info.Step()) {
    required.insert(info.Text(0));
  }
  for (std::size_t source = 0; source < columns.size(); ++source) {
    try {
      const SqliteColumn& column = table_.Columns()[table_.ColumnAt(columns[source])];
      targets_.push_back({source, column});
      const std::string comma = names.empty() ? "" : ", ";
      const bool fill = required.count(column.Name) != 0 && !column.Default.empty();
      names += comma + "[" + column.Name + "]";
      values += comma + (fill ? "coalesce(?, " + column.Default + ")" : "?");
    } catch (const RuntimeError&) {
      unknown_.push_back(columns[source]);
    }
  }
  if (targets_.empty()) {
    throw RuntimeError(Fault::UnrecognizedDatabase,
                       "Its table " + table_.Name() + " has none of the columns that are needed.");
  }
  insert_ = SqliteStatement(connection_, "INSERT INTO [" + table_.Name() + "] (" + names + ") VALUES (" +
                                             values + ") RETURNING " + names);
}

void TableImport::AddRow(const std::vector<Value>& row) {
  std::vector<Value> fitting;
  for (const Target& target : targets_) {
    fitting.push_back(Fitting(target, row[target.Source]));
  }
  for (std::size_t i = 0; i < fitting.size(); ++i) {
    insert_.Bind(static_cast<int>(i + 1), fitting[i]);
  }
  std::uint64_t hash = 0;
  if (insert_.Step()) {
    Value stored;
    for (std::size_t i = 0; i < fitting.size(); ++i) {
      insert_.Read(static_cast<int>(i), stored);
      if (!std::holds_alternative<std::monostate>(fitting[i]) && HashOf(stored) != HashOf(fitting[i])) {
        throw RuntimeError(Fault::UnrecognizedDatabase,
                           "A value of its column " + targets_[i].Column.Name + " does not fit.");
      }
      hash = Mixed(hash, HashOf(stored));
    }
  }
  insert_.Reset();
  checksum_ += hash;
  ++rows_;
}

Value TableImport::Fitting(const Target& target, const Value& value) {
  const bool isText = std::holds_alternative<std::string>(value);
  if (target.Column.IsNumber && isText) {
    try {
      return target.Column.Accept(value);
    } catch (const RuntimeError&) {
      zeroed_.insert(target.Column.Name);
      return std::int64_t{0};
    }
  }
  const bool isNumber = std::holds_alternative<std::int64_t>(value) || std::holds_alternative<double>(value);
  if (isNumber && !target.Column.IsNumber && !target.Column.IsLong) {
    return TextOfNumber(value);
  }
  return value;
}

void TableImport::Finish() {
  transaction_.Commit();
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
