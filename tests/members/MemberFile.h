#pragma once

#include "platform/sqlite/SqliteDatabase.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/TestDatabase.h"

/// A new installation's members file with four members added.
class MemberFile {
 public:
  MemberFile() {
    Execute(ReadFile(std::string(TESSARINE_RESOURCES) + "/members_default.sql"));
    Execute(
        "INSERT INTO Members (ContactID, FirstName, LastName, NickName, Clan, Birthdate) VALUES "
        "(1, 'Rhys', 'Morgan', NULL, 'Red Dragons', '1961-04-12 00:00:00'), (2, 'Alice', 'Belmont', 'Mole', "
        "'', "
        "NULL), (5, 'Sean', 'O''Brien', 'Shamrock', NULL, NULL), (9, '小明', '王', NULL, NULL, NULL)");
  }

  std::string Path() const { return folder_ / "members.mdb"; }
  void Execute(const std::string& sql) const { OtherConnection(Path()).Execute(sql); }
  std::string Query(const std::string& sql) const { return OtherConnection(Path()).Query(sql); }

  /// A column of one member, read through a separate connection.
  std::string Stored(const std::string& column, int member) const {
    return Query("SELECT " + column + " FROM Members WHERE ContactID = " + std::to_string(member));
  }

  std::unique_ptr<Database> Open() const {
    return SqliteEngine(std::chrono::milliseconds(30)).OpenDatabase(Path());
  }

 private:
  TemporaryFolder folder_;
};
