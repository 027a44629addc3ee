#pragma once

#include <sqlite3.h>

#include <string>

/// SQLite used directly, as durable as our own layer. Errors end the program.
class BareSqlite {
 public:
  explicit BareSqlite(const std::string& path);
  ~BareSqlite();
  BareSqlite(const BareSqlite&) = delete;
  BareSqlite& operator=(const BareSqlite&) = delete;

  void Run(const std::string& sql);
  sqlite3_stmt* Prepare(const std::string& sql);
  /// Runs a query with one or two bound values to its end, reads all columns, and returns how many rows there
  /// were.
  int RowsOf(const std::string& sql, const std::string& first, const std::string& second = "");

 private:
  sqlite3* handle_ = nullptr;
};

/// Creates an empty archive at `path`.
void MakeArchive(const std::string& path);

/// Adds games of 24 players from 2021 to 2025 to an archive, without their files: 100,000 games give each of
/// 3,430 members 700 of them.
void AddGames(const std::string& path, int games);
