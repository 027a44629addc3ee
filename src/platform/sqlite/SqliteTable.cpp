#include "platform/sqlite/SqliteTable.h"

#include <strings.h>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdint>

#include "platform/RuntimeError.h"

namespace {

bool Contains(const std::string& type, std::string_view part) {
  return std::search(type.begin(), type.end(), part.begin(), part.end(), [](char a, char b) {
           return (a >= 'a' && a <= 'z' ? a - 'a' + 'A' : a) == b;
         }) != type.end();
}

// SQLite's own rule for a declared type, except that dates are not numbers.
bool TakesNumbers(const std::string& type) {
  return Contains(type, "INT") || Contains(type, "REAL") || Contains(type, "FLOA") ||
         Contains(type, "DOUB") || Contains(type, "NUMERIC");
}

bool IsTextType(const std::string& type) {
  return !Contains(type, "INT") && (Contains(type, "TEXT") || Contains(type, "CHAR"));
}

Value NumberFrom(std::string_view text) {
  const std::size_t first = text.find_first_not_of(" \t");
  if (first == std::string_view::npos) {
    throw RuntimeError(Fault::DataConversion, "Data type conversion error.");
  }
  text = text.substr(first, text.find_last_not_of(" \t") + 1 - first);
  if (text.starts_with('+') && !text.starts_with("+-")) {
    text.remove_prefix(1);
  }
  const char* const end = text.data() + text.size();
  std::int64_t integer = 0;
  if (const auto [rest, error] = std::from_chars(text.data(), end, integer);
      error == std::errc() && rest == end) {
    return integer;
  }
  double real = 0;
  const auto [rest, error] = std::from_chars(text.data(), end, real);
  if (error != std::errc() || rest != end || !std::isfinite(real)) {
    throw RuntimeError(Fault::DataConversion, "Data type conversion error.");
  }
  return real;
}

}  // namespace

Value SqliteColumn::Accept(Value value) const {
  const auto* text = std::get_if<std::string>(&value);
  return IsNumber && text != nullptr ? NumberFrom(*text) : value;
}

SqliteTable::SqliteTable(SqliteConnection& connection, const std::string& name) : name_(name) {
  SqliteStatement columns(connection,
                          "SELECT p.name, p.type, p.dflt_value, "
                          "p.pk = 1 AND max(p.pk) OVER () = 1 AND p.type = 'INTEGER' COLLATE NOCASE "
                          "FROM sqlite_master m, pragma_table_info(m.name) p "
                          "WHERE m.type = 'table' AND m.name = ?1 COLLATE NOCASE ORDER BY p.cid");
  const Value parameter = name;
  columns.Bind(1, parameter);
  while (columns.Step()) {
    const std::string type = columns.Text(1);
    columns_.push_back({columns.Text(0), columns.Text(2), Contains(type, "BLOB"), TakesNumbers(type),
                        columns.Integer(3) != 0, IsTextType(type)});
  }
  if (columns_.empty()) {
    throw RuntimeError(Fault::TableNotFound, "Could not find the input table or query '" + name + "'.");
  }
}

std::size_t SqliteTable::ColumnAt(std::string_view name) const {
  for (std::size_t i = 0; i < columns_.size(); ++i) {  // fast path: the exact name
    if (columns_[i].Name == name) {
      return i;
    }
  }
  for (std::size_t i = 0; i < columns_.size(); ++i) {
    const std::string& own = columns_[i].Name;
    if (own.size() == name.size() && strncasecmp(own.data(), name.data(), name.size()) == 0) {
      return i;
    }
  }
  throw RuntimeError(Fault::ItemNotFound, "Item not found in this collection: " + std::string(name));
}
