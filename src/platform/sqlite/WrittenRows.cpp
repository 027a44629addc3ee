#include "platform/sqlite/WrittenRows.h"

#include <algorithm>

#include "platform/sqlite/SqliteConnection.h"

bool WrittenRows::Write(const std::string& table, std::int64_t key) {
  const Place place{table, key};
  if (!IsWatched(place)) {
    return false;
  }
  rows_[place].Deleted = false;
  return true;
}

void WrittenRows::Set(const std::string& table, std::int64_t key, const std::string& column,
                      const Value& value) {
  rows_[{table, key}].Columns[column] = value;
}

void WrittenRows::Delete(const std::string& table, std::int64_t key) {
  const Place place{table, key};
  if (IsWatched(place)) {
    rows_[place] = {.Deleted = true, .Columns = {}};
  }
}

bool WrittenRows::AreIn(SqliteConnection& connection) const {
  return std::all_of(rows_.begin(), rows_.end(),
                     [&](const auto& row) { return IsIn(connection, row.first, row.second); });
}

bool WrittenRows::IsIn(SqliteConnection& connection, const Place& place, const Row& row) {
  const auto& [table, key] = place;
  // The columns' own types decide, as they did when the values were written; IS lets NULL equal NULL.
  std::string sql = "SELECT 1 FROM [" + table + "] WHERE rowid = ?1";
  int parameter = 1;
  for (const auto& [name, value] : row.Columns) {
    sql += " AND [" + name + "] IS ?" + std::to_string(++parameter) + " COLLATE BINARY";
  }
  SqliteStatement search(connection, sql);
  search.Bind(1, key);
  parameter = 1;
  for (const auto& [name, value] : row.Columns) {
    search.Bind(++parameter, value);
  }
  const bool found = search.Step();
  search.Reset();
  return found != row.Deleted;
}
