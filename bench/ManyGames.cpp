#include "bench/ManyGames.h"

#include <benchmark/benchmark.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>

BareSqlite::BareSqlite(const std::string& path) {
  sqlite3_open(path.c_str(), &handle_);
  Run("PRAGMA synchronous = EXTRA");
}

BareSqlite::~BareSqlite() {
  sqlite3_close_v2(handle_);
}

void BareSqlite::Run(const std::string& sql) {
  if (sqlite3_exec(handle_, sql.c_str(), nullptr, nullptr, nullptr) != SQLITE_OK) {
    std::fprintf(stderr, "%s\n", sqlite3_errmsg(handle_));
    std::abort();
  }
}

sqlite3_stmt* BareSqlite::Prepare(const std::string& sql) {
  sqlite3_stmt* statement = nullptr;
  if (sqlite3_prepare_v2(handle_, sql.c_str(), -1, &statement, nullptr) != SQLITE_OK) {
    std::fprintf(stderr, "%s\n", sqlite3_errmsg(handle_));
    std::abort();
  }
  return statement;
}

int BareSqlite::RowsOf(const std::string& sql, const std::string& first, const std::string& second) {
  sqlite3_stmt* statement = Prepare(sql);
  sqlite3_bind_text(statement, 1, first.c_str(), -1, SQLITE_STATIC);
  if (!second.empty()) {
    sqlite3_bind_text(statement, 2, second.c_str(), -1, SQLITE_STATIC);
  }
  int rows = 0;
  for (; sqlite3_step(statement) == SQLITE_ROW; ++rows) {
    for (int column = 0; column < sqlite3_column_count(statement); ++column) {
      benchmark::DoNotOptimize(sqlite3_column_text(statement, column));
    }
  }
  sqlite3_finalize(statement);
  return rows;
}

void MakeArchive(const std::string& path) {
  std::ostringstream script;
  script << std::ifstream(TESSARINE_RESOURCES "/games_default.sql").rdbuf();
  BareSqlite(path).Run(script.str());
}

void AddGames(const std::string& path, int games) {
  BareSqlite archive(path);
  archive.Run("PRAGMA synchronous = OFF; PRAGMA cache_size = -200000");
  const std::string count = std::to_string(games);
  archive.Run("WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < " + count +
              ") INSERT INTO Games SELECT i, datetime('2021-01-01', (i * 26) || ' minutes'), '', 'Mission ' "
              "|| (i % 9), "
              "'cable', 1, 24, 12, 100, 200, 0, 8, 1, -1, -1, -1, 1, -1, printf('%064d', i), NULL FROM n");
  archive.Run(
      "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < " + count +
      "), p(j) AS (SELECT 1 UNION ALL SELECT j + 1 FROM p WHERE j < 24) "
      "INSERT INTO GamePlayers SELECT i, j * 8, (i * 24 + j) * 7919 % 3430 + 1, '0000000000000000', j, "
      "240 - j * 10 + i % 7, (i + j) % 90 / 100.0, 100, 90, 300, 2, 3, 4, j % 2, NULL FROM n CROSS JOIN p");
}
