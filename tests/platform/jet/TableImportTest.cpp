#include "platform/jet/TableImport.h"

#include <gmock/gmock.h>

#include <cmath>

#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;

class Import : public testing::Test {
 protected:
  Import() { file.Execute("INSERT INTO Members (FirstName) VALUES ('left from before')"); }

  std::string Stored(const std::string& column) { return file.Query("SELECT " + column + " FROM Members"); }

  TestDatabase file;
};

TEST_F(Import, PutsRowsIntoTheColumnsOfTheirNames) {
  TableImport import(file.Path(), "Members");
  import.SetColumns({"contactid", "Clan", "Shoe size", "Photograph", "TotalDamage"});
  import.AddRow({std::int64_t{7}, "Owls", std::int64_t{44}, Blob{1, 2, 3}, 12.5});
  import.Finish();
  EXPECT_EQ(import.Rows(), 1);
  EXPECT_THAT(import.UnknownColumns(), ElementsAre("Shoe size"));
  EXPECT_EQ(Stored("count(*)"), "1");
  EXPECT_EQ(Stored("ContactID"), "7");
  EXPECT_EQ(Stored("Clan"), "Owls");
  EXPECT_EQ(Stored("hex(Photograph)"), "010203");
  EXPECT_EQ(Stored("TotalDamage"), "12.5");
}

TEST_F(Import, KeepsNullsExceptWhereTheTableForbidsThem) {
  TableImport import(file.Path(), "Members");
  import.SetColumns({"ContactID", "FirstName", "TotalGamesPlayed", "PhotographLength"});
  import.AddRow({std::int64_t{1}, std::monostate(), std::monostate(), std::monostate()});
  import.Finish();
  EXPECT_EQ(Stored("FirstName"), "NULL");
  EXPECT_EQ(Stored("TotalGamesPlayed"), "0");
  EXPECT_EQ(Stored("PhotographLength"), "NULL");
}

TEST_F(Import, TurnsNumbersAndTextsIntoEachOther) {
  TableImport import(file.Path(), "Members");
  import.SetColumns({"ContactID", "FirstName", "TotalDamage", "TotalGamesPlayed"});
  import.AddRow({std::int64_t{1}, 2.5, " 300 ", "many"});
  import.Finish();
  EXPECT_EQ(Stored("FirstName"), "2.5");
  EXPECT_EQ(Stored("TotalDamage"), "300.0");
  EXPECT_EQ(Stored("TotalGamesPlayed"), "0");
  EXPECT_THAT(import.ZeroedColumns(), ElementsAre("TotalGamesPlayed"));
}

TEST_F(Import, GoesOnCountingKeysBehindTheLargest) {
  {
    TableImport import(file.Path(), "Members");
    import.SetColumns({"ContactID"});
    import.AddRow({std::int64_t { 90 }});
    import.AddRow({std::int64_t { 7 }});
    import.Finish();
  }
  file.Execute("INSERT INTO Members (FirstName) VALUES ('next')");
  EXPECT_EQ(Stored("max(ContactID)"), "91");
}

TEST_F(Import, FailsOnADuplicateKeyAndChangesNothing) {
  {
    TableImport import(file.Path(), "Members");
    import.SetColumns({"ContactID"});
    import.AddRow({std::int64_t { 1 }});
    EXPECT_NE(NumberThrownBy([&] { import.AddRow({std::int64_t { 1 }}); }), 0);
  }
  EXPECT_EQ(Stored("FirstName"), "left from before");
}

NotTakenOver ValueIn(const std::string& row, const std::string& column) {
  return {.What = NotTakenOver::OneValue, .Name = column, .InTable = "Members", .InRow = row};
}

TEST_F(Import, NamesRowAndColumnOfAValueThatTheTableRefuses) {
  struct Case {
    Value Key;
    Value Clan;
    Value TotalDamage;
    NotTakenOver Named;
  };
  const std::vector<Case> cases = {
      {std::int64_t{9}, "refused", 1.5, ValueIn("2 (ContactID 9)", "Clan")},
      {std::int64_t{9}, "Owls", std::nan(""), ValueIn("2 (ContactID 9)", "TotalDamage")},
      {std::int64_t{7}, "Owls", 1.5, ValueIn("2 (ContactID 7)", "ContactID")},
      {"x", "refused", 1.5, ValueIn("2 (ContactID 0)", "Clan")},
  };
  for (const Case& one : cases) {
    TableImport import(file.Path(), "Members");
    import.SetColumns({"TotalDamage", "Clan", "ContactID"});
    import.AddRow({12.5, "Owls", std::int64_t { 7 }});
    try {
      import.AddRow({one.TotalDamage, one.Clan, one.Key});
      ADD_FAILURE() << one.Named.Name;
    } catch (const OldDatabaseRefused& error) {
      EXPECT_THAT(error.Parts(), ElementsAre(one.Named));
    }
  }
}

TEST_F(Import, NamesColumnsThatTheRowsLack) {
  TableImport import(file.Path(), "Members");
  import.SetColumns({"contactid", "FirstName", "LastName", "NickName", "Photograph", "TotalDamage", "Clan"});
  EXPECT_THAT(import.MissingColumns(), ElementsAre("DallasID", "PhotographLength", "TotalGamesPlayed"));
}

TEST_F(Import, NamesValuesThatAreNotWholeInColumnsThatItHas) {
  TableImport import(file.Path(), "Members");
  import.SetColumns({"ContactID", "Shoe size", "Photograph", "PhotographLength", "Clan"});
  import.AddRow({std::int64_t{1}, std::int64_t{44}, Blob{1, 2}, std::int64_t{2}, "Owls"});
  import.AddRow({std::int64_t{3}, std::monostate(), std::monostate(), std::int64_t{25000}, "Ow\uFFFD"},
                {1, 2, 4});
  import.Finish();
  EXPECT_THAT(import.UnreadValues(),
              ElementsAre(ValueIn("2 (ContactID 3)", "Photograph"), ValueIn("2 (ContactID 3)", "Clan")));
  EXPECT_EQ(Stored("group_concat(PhotographLength)"), "2,0");
}

TEST_F(Import, KeepsTheIndexes) {
  TableImport import(file.Path(), "Members");
  import.SetColumns({"ContactID"});
  import.AddRow({std::int64_t { 1 }});
  import.Finish();
  EXPECT_EQ(file.Query("SELECT sql FROM sqlite_master WHERE type = 'index'"),
            "CREATE INDEX MembersDallasID ON Members (DallasID)");
}

TEST_F(Import, FailsWithoutAnyKnownColumn) {
  TableImport import(file.Path(), "Members");
  EXPECT_EQ(NumberThrownBy([&] { import.SetColumns({"a", "b"}); }), 3343);
}

}  // namespace
