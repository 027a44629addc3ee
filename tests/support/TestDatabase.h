#pragma once

#include <sqlite3.h>

#include <chrono>
#include <memory>
#include <stdexcept>
#include <string>

#include "platform/sqlite/SqliteDatabase.h"
#include "tests/support/TemporaryFolder.h"

/// Another program's connection to a database file.
class OtherConnection {
 public:
  explicit OtherConnection(const std::string& path) { sqlite3_open(path.c_str(), &handle_); }
  ~OtherConnection() { sqlite3_close(handle_); }
  OtherConnection(const OtherConnection&) = delete;
  OtherConnection& operator=(const OtherConnection&) = delete;

  int Try(const std::string& sql) { return sqlite3_exec(handle_, sql.c_str(), nullptr, nullptr, nullptr); }

  void Execute(const std::string& sql) {
    if (Try(sql) != SQLITE_OK) {
      throw std::runtime_error(sqlite3_errmsg(handle_) + (" in " + sql));
    }
  }

  /// First column of the first row as text; "NULL" for NULL, "none" without a row.
  std::string Query(const std::string& sql) {
    sqlite3_stmt* statement = nullptr;
    if (sqlite3_prepare_v2(handle_, sql.c_str(), -1, &statement, nullptr) != SQLITE_OK) {
      throw std::runtime_error(sqlite3_errmsg(handle_) + (" in " + sql));
    }
    std::string result = "none";
    if (sqlite3_step(statement) == SQLITE_ROW) {
      const auto* text = reinterpret_cast<const char*>(sqlite3_column_text(statement, 0));
      result = text == nullptr ? "NULL" : text;
    }
    sqlite3_finalize(statement);
    return result;
  }

 private:
  sqlite3* handle_ = nullptr;
};

/// A members file for one test.
class TestDatabase {
 public:
  /// Creates an empty table, with the photograph in the middle of its columns.
  TestDatabase() {
    Execute(
        "CREATE TABLE Members (ContactID INTEGER PRIMARY KEY AUTOINCREMENT, DallasID TEXT, FirstName TEXT, "
        "LastName TEXT, NickName TEXT, Photograph BLOB, PhotographLength INTEGER DEFAULT 0, "
        "TotalGamesPlayed INTEGER NOT NULL DEFAULT 0, TotalDamage REAL DEFAULT 0, "
        "Clan TEXT DEFAULT 'none' CHECK (Clan <> 'refused')); "
        "CREATE INDEX MembersDallasID ON Members (DallasID)");
  }

  std::string Path() const { return folder_ / "members.mdb"; }
  const TemporaryFolder& Folder() const { return folder_; }

  void Execute(const std::string& sql) const { OtherConnection(Path()).Execute(sql); }
  std::string Query(const std::string& sql) const { return OtherConnection(Path()).Query(sql); }

  /// Adds four members, with the numbers 1, 2, 5 and 9.
  void AddMembers() const {
    Execute(
        "INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName) VALUES "
        "(1, 'AA', 'Sean', 'O''Brien', 'Shamrock'), (2, 'BB', 'Alice', 'Belmont', 'Mole'), "
        "(5, NULL, 'Rhys', 'Morgan', NULL), (9, 'BB', 'Zoe', 'Adams', '')");
  }

  std::unique_ptr<Database> Open() const {
    return SqliteEngine(std::chrono::milliseconds(30)).OpenDatabase(Path());
  }

 private:
  TemporaryFolder folder_;
};

inline std::string TextOf(Recordset& rows, const std::string& column) {
  return std::get<std::string>(rows.Fields(column));
}

inline std::int64_t IntegerOf(Recordset& rows, const std::string& column) {
  return std::get<std::int64_t>(rows.Fields(column));
}

/// The numbers of all members of a dynaset, from its first row to its end, each followed by a blank.
inline std::string AllNumbers(Recordset& rows) {
  std::string numbers;
  for (rows.MoveFirst(); !rows.Eof(); rows.MoveNext()) {
    numbers += std::to_string(IntegerOf(rows, "ContactID")) + " ";
  }
  return numbers;
}
