#pragma once

#include <sqlite3.h>

#include <string>
#include <vector>

/// A copy of one of the default databases, in memory, so that a test's changes are not kept.
class DefaultDatabase {
 public:
  /// `name` is the file's name in the program's folder. Throws std::runtime_error if it cannot be read.
  explicit DefaultDatabase(const std::string& name);
  ~DefaultDatabase();
  DefaultDatabase(const DefaultDatabase&) = delete;
  DefaultDatabase& operator=(const DefaultDatabase&) = delete;

  /// Runs one statement; false if the database refuses it.
  bool Run(const std::string& sql);

  /// One column, counted from 0, of every row as text, "NULL" for NULL. Throws std::runtime_error if the
  /// statement fails.
  std::vector<std::string> Column(const std::string& sql, int column = 0);

  /// The value of a query with exactly one row. Throws std::runtime_error for any other number of rows.
  std::string Single(const std::string& sql);

  /// The database's query plan for a query on one table.
  std::string Plan(const std::string& sql);

 private:
  sqlite3* connection_ = nullptr;
};
