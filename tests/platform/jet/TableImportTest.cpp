#include "platform/jet/TableImport.h"

#include <gmock/gmock.h>

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

TEST_F(Import, FailsWithoutAnyKnownColumn) {
  TableImport import(file.Path(), "Members");
  EXPECT_EQ(NumberThrownBy([&] { import.SetColumns({"a", "b"}); }), 3343);
}

}  // namespace
