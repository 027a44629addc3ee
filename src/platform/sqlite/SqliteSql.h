#pragma once

#include <map>
#include <string>

#include "platform/Sql.h"
#include "platform/sqlite/SqliteConnection.h"
#include "platform/sqlite/SqliteStatement.h"

/// Statements on an SQLite file. Those that ran last stay prepared.
class SqliteSql : public Sql {
 public:
  explicit SqliteSql(SqliteConnection& connection) : connection_(connection) {}

  void Query(const std::string& statement, const SqlValues& values,
             const std::function<void(const SqlRow& row)>& act) override;
  std::int64_t Change(const std::string& statement, const SqlValues& values) override;
  std::int64_t Insert(const std::string& statement, const SqlValues& values) override;

 private:
  enum class Kind { Reads, Changes };

  SqliteStatement Take(const std::string& text, const SqlValues& values, Kind kind);
  SqliteStatement Prepare(const std::string& text);
  void Keep(const std::string& text, SqliteStatement statement);

  SqliteConnection& connection_;
  std::map<std::string, SqliteStatement> prepared_;  ///< by text; one that runs is not among them
};
