#include "platform/sqlite/SqliteDatabase.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/stat.h>

#include <filesystem>
#include <string>

#include "tests/support/OrdinaryUser.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::HasSubstr;

Thrown OpenFailure(const std::string& path) {
  return ThrownBy([&] { SqliteEngine(std::chrono::milliseconds(30)).OpenDatabase(path); });
}

std::string NumbersOf(Database& database, const std::string& source) {
  return AllNumbers(*database.OpenRecordset(source));
}

TEST(OpenDatabase, MissingFileIs3024AndIsNotMade) {
  const TemporaryFolder folder;
  const Thrown thrown = OpenFailure(folder / "none.mdb");
  EXPECT_EQ(thrown.Number, 3024);
  EXPECT_EQ(thrown.Text, "Could not find file '" + folder / "none.mdb" + "'.");
  EXPECT_FALSE(std::filesystem::exists(folder / "none.mdb"));
}

TEST(OpenDatabase, FolderIs3051) {
  const TemporaryFolder folder;
  const Thrown thrown = OpenFailure(folder.Path());
  EXPECT_EQ(thrown.Number, 3051);
  EXPECT_THAT(thrown.Text, HasSubstr(folder.Path()));
}

TEST(OpenDatabase, FileWithoutReadPermissionIs3051) {
  const TestDatabase file;
  std::filesystem::permissions(file.Path(), std::filesystem::perms::none);
  const OrdinaryUser user;
  EXPECT_EQ(OpenFailure(file.Path()).Number, 3051);
}

TEST(OpenDatabase, FileThatIsNoDatabaseIs3343) {
  const TemporaryFolder folder;
  const std::string jet = std::string("\0\1\0\0Standard Jet DB\0", 20) + std::string(8172, '\0');
  const std::pair<std::string, std::string> cases[] = {
      {"jet.mdb", jet},
      {"empty.mdb", ""},
      {"short.mdb", "SQLite format 3"},
      {"zeroed.mdb", std::string(8192, '\0')},
      {"text.mdb", std::string(600, 'x')},
  };
  for (const auto& [name, bytes] : cases) {
    WriteFile(folder / name, bytes);
    const Thrown thrown = OpenFailure(folder / name);
    EXPECT_EQ(thrown.Number, 3343) << name;
    EXPECT_EQ(thrown.Text, "Unrecognized database format '" + folder / name + "'.");
    EXPECT_EQ(ReadFile(folder / name), bytes);
  }
}

TEST(OpenDatabase, FileCutShortIs3343) {
  const TestDatabase file;
  file.AddMembers();
  const std::string whole = ReadFile(file.Path());
  ASSERT_GT(whole.size(), 8192u);
  for (std::size_t size = 0; size < whole.size(); size += 512) {
    WriteFile(file.Path(), whole.substr(0, size));
    EXPECT_EQ(OpenFailure(file.Path()).Number, 3343) << size;
  }
}

TEST(OpenDatabase, DamagedSchemaIs3343) {
  const TestDatabase file;
  std::string bytes = ReadFile(file.Path());
  bytes.replace(100, 3900, std::string(3900, '\xFF'));
  WriteFile(file.Path(), bytes);
  EXPECT_EQ(OpenFailure(file.Path()).Number, 3343);
}

TEST(OpenRecordset, DamagedRowsAre3343) {
  const TestDatabase file;
  file.Execute(
      "DROP INDEX MembersDallasID; WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < "
      "5000) "
      "INSERT INTO Members (ContactID, FirstName, LastName) SELECT i, 'First' || i, 'Last' || i FROM n");
  std::string bytes = ReadFile(file.Path());
  ASSERT_GT(bytes.size(), 60'000u);
  bytes.replace(40'960, 8192, std::string(8192, '\xFF'));
  WriteFile(file.Path(), bytes);
  const auto database = file.Open();
  const Thrown thrown = ThrownBy([&] { database->OpenRecordset("Members"); });
  EXPECT_EQ(thrown.Number, 3343);
  EXPECT_THAT(thrown.Text, HasSubstr(file.Path()));
}

TEST(OpenRecordset, TableNameCanBeInAnyCase) {
  const TestDatabase file;
  file.AddMembers();
  const auto database = file.Open();
  EXPECT_EQ(NumbersOf(*database, "members"), "1 2 5 9 ");
}

TEST(OpenRecordset, QueryWithoutConditionGivesAllRows) {
  const TestDatabase file;
  file.AddMembers();
  const auto database = file.Open();
  EXPECT_EQ(NumbersOf(*database, "SELECT * FROM Members"), "1 2 5 9 ");
  EXPECT_EQ(NumbersOf(*database, "  select  *\nfrom [Members]  "), "1 2 5 9 ");
}

TEST(OpenRecordset, QueryFindsNamesByTheirBeginning) {
  const TestDatabase file;
  file.AddMembers();
  const auto database = file.Open();
  const auto search = [&](const std::string& text) {
    const std::string pattern = text + "*";
    return NumbersOf(*database, "SELECT * FROM Members WHERE ([FirstName] LIKE '" + pattern +
                                    "' OR [LastName] LIKE '" + pattern + "' OR [NickName] LIKE '" + pattern +
                                    "')");
  };
  EXPECT_EQ(search("mo"), "2 5 ");
  EXPECT_EQ(search("BELM"), "2 ");
  EXPECT_EQ(search("*e"), "1 2 9 ");
  EXPECT_EQ(search("mont"), "");
}

TEST(OpenRecordset, QueryGivesTableOrderAlsoThroughAnIndex) {
  const TestDatabase file;
  file.AddMembers();
  file.Execute(
      "CREATE INDEX ByName ON Members (LastName, FirstName); UPDATE Members SET DallasID = 'CC' WHERE "
      "ContactID = 1");
  const auto database = file.Open();
  EXPECT_EQ(NumbersOf(*database, "SELECT * FROM Members WHERE ([LastName] > 'A')"), "1 2 5 9 ");
  EXPECT_EQ(NumbersOf(*database, "SELECT * FROM Members WHERE DallasID IN ('CC', 'BB')"), "1 2 9 ");
}

TEST(OpenRecordset, EqualNamesAreComparedToTheLetter) {
  const TestDatabase file;
  file.AddMembers();
  const auto database = file.Open();
  EXPECT_EQ(
      NumbersOf(*database, "SELECT * FROM Members WHERE ([FirstName] = 'Sean' AND [LastName] = 'O''Brien')"),
      "1 ");
  EXPECT_EQ(NumbersOf(*database, "SELECT * FROM Members WHERE ([FirstName] = 'sean')"), "");
}

TEST(OpenRecordset, NullIsLikeNothing) {
  const TestDatabase file;
  file.AddMembers();
  const auto database = file.Open();
  EXPECT_EQ(NumbersOf(*database, "SELECT * FROM Members WHERE NickName LIKE '*'"), "1 2 9 ");
  EXPECT_EQ(NumbersOf(*database, "SELECT * FROM Members WHERE NOT NickName LIKE 'x'"), "1 2 9 ");
  EXPECT_EQ(NumbersOf(*database, "SELECT * FROM Members WHERE FirstName LIKE NULL"), "");
}

TEST(OpenRecordset, PatternMayDifferFromRowToRow) {
  const TestDatabase file;
  file.AddMembers();
  file.Execute("UPDATE Members SET NickName = substr(FirstName, 1, 1) || '*' WHERE ContactID <> 2");
  const auto database = file.Open();
  EXPECT_EQ(NumbersOf(*database, "SELECT * FROM Members WHERE FirstName LIKE NickName"), "1 5 9 ");
}

TEST(OpenRecordset, MissingTableIs3078) {
  const TestDatabase file;
  const auto database = file.Open();
  const Thrown thrown = ThrownBy([&] { database->OpenRecordset("Guns"); });
  EXPECT_EQ(thrown.Number, 3078);
  EXPECT_THAT(thrown.Text, HasSubstr("'Guns'"));
  EXPECT_EQ(NumberThrownBy([&] { database->OpenRecordset("SELECT * FROM Guns"); }), 3078);
  EXPECT_EQ(NumberThrownBy([&] { database->OpenRecordset(""); }), 3078);
}

TEST(OpenRecordset, UnreadableQueryIs3075) {
  const TestDatabase file;
  file.AddMembers();
  const auto database = file.Open();
  for (const char* query : {
           "SELECT * FROM Members WHERE ([FirstName] LIKE 'O'Brien*')",
           "SELECT * FROM Members WHERE",
           "SELECT * FROM Members WHERE ([FirstName] = 'a'",
           "SELECT * FROM Members WHERE ([FirstName] = 'a'))",
           "SELECT * FROM Members WHERE [NoSuchColumn] = 1",
           "SELECT * FROM Members WHERE ContactID = ?",
           "SELECT * FROM Members WHERE 1) --",
           "SELECT * FROM Members ORDER BY LastName",
           "SELECT FirstName FROM Members",
           "SELECT * FROM",
           "SELECT",
       }) {
    EXPECT_EQ(NumberThrownBy([&] { database->OpenRecordset(query); }), 3075) << query;
  }
}

TEST(OpenRecordset, SearchTextCannotSmuggleInASecondStatement) {
  const TestDatabase file;
  file.AddMembers();
  const auto database = file.Open();
  EXPECT_EQ(NumberThrownBy([&] {
              database->OpenRecordset(
                  "SELECT * FROM Members WHERE ([FirstName] LIKE 'x'); DELETE FROM Members; --*')");
            }),
            3075);
  EXPECT_EQ(NumberThrownBy(
                [&] { database->OpenRecordset("SELECT * FROM Members WHERE 1); DELETE FROM Members; --"); }),
            3075);
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members"), "4");
}

TEST(OpenRecordset, BrokenPatternIs93) {
  const TestDatabase file;
  file.AddMembers();
  const auto database = file.Open();
  const Thrown thrown =
      ThrownBy([&] { database->OpenRecordset("SELECT * FROM Members WHERE FirstName LIKE '[*'"); });
  EXPECT_EQ(thrown.Number, 93);
  EXPECT_EQ(thrown.Text, "Invalid pattern string");
}

}  // namespace
