#pragma once

#include <sqlite3.h>

#include <string>
#include <vector>

/// A private copy of one of the default databases, in memory: what a test changes is gone with it.
class DefaultDatabase {
 public:
  /// `name` is the file's name in the program's folder. Throws std::runtime_error when it cannot be read.
  explicit DefaultDatabase(const std::string& name);
  ~DefaultDatabase();
  DefaultDatabase(const DefaultDatabase&) = delete;
  DefaultDatabase& operator=(const DefaultDatabase&) = delete;

  /// Runs one statement; false when the database refuses it.
  bool Run(const std::string& sql);

  /// One column, counted from 0, of every row as text, "NULL" for NULL. Throws std::runtime_error for a
  /// statement that fails.
  std::vector<std::string> Column(const std::string& sql, int column = 0);

  /// The one value of a query with one row. Throws std::runtime_error when there is not just one.
  std::string Single(const std::string& sql);

  /// How the database would run a query that reads one table, in its own words.
  std::string Plan(const std::string& sql);

 private:
  sqlite3* connection_ = nullptr;
};
