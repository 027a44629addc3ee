#pragma once

#include <sqlite3.h>

#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

/// The rows of a query, texts and blobs to the byte, each column ended by '|'.
inline std::vector<std::string> RowsOf(sqlite3* database, const std::string& sql) {
  sqlite3_stmt* prepared = nullptr;
  if (sqlite3_prepare_v2(database, sql.c_str(), -1, &prepared, nullptr) != SQLITE_OK) {
    throw std::runtime_error(sqlite3_errmsg(database));
  }
  const std::unique_ptr<sqlite3_stmt, decltype(&sqlite3_finalize)> query(prepared, sqlite3_finalize);
  std::vector<std::string> rows;
  int result = sqlite3_step(prepared);
  for (; result == SQLITE_ROW; result = sqlite3_step(prepared)) {
    std::string& row = rows.emplace_back();
    for (int column = 0; column < sqlite3_column_count(prepared); ++column) {
      if (sqlite3_column_type(prepared, column) == SQLITE_NULL) {
        row += "NULL|";
        continue;
      }
      const auto* bytes = static_cast<const char*>(sqlite3_column_blob(prepared, column));
      row.append(bytes == nullptr ? "" : bytes, sqlite3_column_bytes(prepared, column)).append("|");
    }
  }
  if (result != SQLITE_DONE) {
    throw std::runtime_error(sqlite3_errmsg(database));
  }
  return rows;
}

/// Every row of every table of the database at `path`, behind the result of its integrity check. What a
/// failed program left half done is put right first, as for any program that opens the file next.
inline std::string WholeContents(const std::string& path) {
  sqlite3* opened = nullptr;
  sqlite3_open_v2(path.c_str(), &opened, SQLITE_OPEN_READWRITE, nullptr);
  const std::unique_ptr<sqlite3, decltype(&sqlite3_close)> database(opened, sqlite3_close);
  std::string contents;
  for (const std::string& row : RowsOf(opened, "PRAGMA integrity_check")) {
    contents += row + "\n";
  }
  for (std::string table :
       RowsOf(opened, "SELECT name FROM sqlite_master WHERE type = 'table' ORDER BY name")) {
    table.pop_back();
    contents += table + "\n";
    const bool hasRowids =
        !RowsOf(opened, "SELECT 1 FROM pragma_table_list WHERE name = '" + table + "' AND wr = 0").empty();
    const std::string order = hasRowids ? "rowid" : "1, 2";
    for (const std::string& row : RowsOf(opened, "SELECT * FROM [" + table + "] ORDER BY " + order)) {
      contents += "  " + row + "\n";
    }
  }
  return contents;
}
