#include "platform/sqlite/SqliteRecordset.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <string>

#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

const Value Five = std::int64_t{5};

class Dynaset : public testing::Test {
 protected:
  Dynaset() {
    file.AddMembers();
    database = file.Open();
    rows = database->OpenRecordset("Members");
  }

  TestDatabase file;
  std::unique_ptr<Database> database;
  std::unique_ptr<Recordset> rows;
};

TEST_F(Dynaset, StandsOnTheFirstRowWhenOpened) {
  EXPECT_FALSE(rows->Eof());
  EXPECT_FALSE(rows->Bof());
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 1);
}

TEST_F(Dynaset, MovesThroughItsRowsInTableOrder) {
  EXPECT_EQ(AllNumbers(*rows), "1 2 5 9 ");
}

TEST_F(Dynaset, MoveLastStandsOnTheLastRow) {
  rows->MoveLast();
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 9);
  EXPECT_FALSE(rows->Eof());
}

TEST_F(Dynaset, MoveToStandsOnTheRowAtThatPosition) {
  for (const auto& [position, number] : {std::pair{2, 5}, {0, 1}, {3, 9}, {1, 2}}) {
    rows->MoveTo(position);
    EXPECT_EQ(IntegerOf(*rows, "ContactID"), number);
    EXPECT_EQ(rows->AbsolutePosition(), position);
  }
}

TEST_F(Dynaset, MoveToAPositionWithoutARowIs3021) {
  rows->MoveTo(2);
  EXPECT_EQ(NumberThrownBy([&] { rows->MoveTo(4); }), 3021);
  EXPECT_EQ(NumberThrownBy([&] { rows->MoveTo(-1); }), 3021);
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 5);
}

TEST_F(Dynaset, MoveNextFromTheEndIs3021) {
  rows->MoveLast();
  rows->MoveNext();
  EXPECT_TRUE(rows->Eof());
  EXPECT_FALSE(rows->Bof());
  EXPECT_EQ(NumberThrownBy([&] { rows->MoveNext(); }), 3021);
  EXPECT_EQ(NumberThrownBy([&] { rows->Fields("ContactID"); }), 3021);
  EXPECT_EQ(NumberThrownBy([&] { rows->Edit(); }), 3021);
  EXPECT_EQ(NumberThrownBy([&] { rows->Delete(); }), 3021);
  EXPECT_EQ(NumberThrownBy([&] { rows->GetChunk("Photograph", 0, 1); }), 3021);
}

TEST(EmptyDynaset, StandsAtBothEnds) {
  const TestDatabase file;
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  for (int i = 0; i < 2; ++i) {
    EXPECT_TRUE(rows->Eof());
    EXPECT_TRUE(rows->Bof());
    rows->MoveFirst();
    rows->MoveLast();
  }
  EXPECT_EQ(NumberThrownBy([&] { rows->MoveNext(); }), 3021);
  EXPECT_EQ(NumberThrownBy([&] { rows->Fields("FirstName"); }), 3021);
  EXPECT_FALSE(rows->WalkTo("ContactID", Five));
  rows->FindFirst("ContactID= 5");
  EXPECT_TRUE(rows->NoMatch());
  EXPECT_TRUE(rows->Bof());
}

TEST(EmptyDynaset, HoldsTheFirstRowAddedToIt) {
  const TestDatabase file;
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  rows->AddNew();
  rows->SetField("FirstName", "Enter Name");
  rows->Update();
  EXPECT_TRUE(rows->Eof());
  rows->MoveLast();
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Enter Name");
  EXPECT_FALSE(rows->Bof());
}

TEST_F(Dynaset, GivesEachKindOfValue) {
  file.Execute(
      "UPDATE Members SET Photograph = X'00FF', TotalDamage = 12.5, NickName = '马库斯' WHERE ContactID = 1");
  EXPECT_EQ(rows->Fields("ContactID"), Value(std::int64_t{1}));
  EXPECT_EQ(rows->Fields("TotalDamage"), Value(12.5));
  EXPECT_EQ(rows->Fields("NickName"), Value("马库斯"));
  EXPECT_EQ(rows->Fields("Photograph"), Value(Blob{0x00, 0xFF}));
  EXPECT_EQ(rows->Fields("PhotographLength"), Value(std::int64_t{0}));
  rows->WalkTo("ContactID", Five);
  EXPECT_EQ(rows->Fields("NickName"), Value());
  EXPECT_EQ(rows->Fields("Photograph"), Value());
}

TEST_F(Dynaset, KeepsNullAndEmptyTextApart) {
  rows->WalkTo("ContactID", Five);
  EXPECT_EQ(rows->Fields("NickName"), Value());
  rows->MoveNext();
  EXPECT_EQ(rows->Fields("NickName"), Value(""));
}

TEST_F(Dynaset, ColumnNamesHaveNoCase) {
  EXPECT_EQ(TextOf(*rows, "fIRSTnAME"), "Sean");
}

TEST_F(Dynaset, UnknownColumnIs3265) {
  EXPECT_EQ(NumberThrownBy([&] { rows->Fields("Rank"); }), 3265);
  EXPECT_EQ(NumberThrownBy([&] { rows->Fields("FirstNam"); }), 3265);
  EXPECT_EQ(NumberThrownBy([&] { rows->WalkTo("Rank", Five); }), 3265);
  rows->Edit();
  EXPECT_EQ(NumberThrownBy([&] { rows->SetField("Rank", Five); }), 3265);
}

TEST_F(Dynaset, DoesNotSeeRowsAddedByOthers) {
  file.Execute("INSERT INTO Members (ContactID, FirstName, DallasID) VALUES (7, 'New', 'DD')");
  EXPECT_EQ(AllNumbers(*rows), "1 2 5 9 ");
  rows->FindFirst("ContactID= 7");
  EXPECT_TRUE(rows->NoMatch());
  EXPECT_FALSE(rows->WalkTo("ContactID", std::int64_t{7}));
  EXPECT_FALSE(rows->WalkTo("DallasID", "DD"));
}

TEST_F(Dynaset, SeesValuesChangedByOthersWhenItMoves) {
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
  file.Execute("UPDATE Members SET FirstName = 'Changed'");
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
  rows->MoveFirst();
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Changed");
  rows->MoveNext();
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Changed");
}

TEST_F(Dynaset, KeepsRowsThatNoLongerMatchItsQuery) {
  const auto found = database->OpenRecordset("SELECT * FROM Members WHERE DallasID = 'BB'");
  file.Execute("UPDATE Members SET DallasID = 'AA' WHERE ContactID = 2");
  EXPECT_EQ(AllNumbers(*found), "2 9 ");
}

TEST_F(Dynaset, FieldsOfARowDeletedByOthersIs3167) {
  file.Execute("DELETE FROM Members WHERE ContactID = 2");
  rows->MoveNext();
  EXPECT_FALSE(rows->Eof());
  EXPECT_EQ(NumberThrownBy([&] { rows->Fields("FirstName"); }), 3167);
  EXPECT_EQ(NumberThrownBy([&] { rows->Fields("Photograph"); }), 3167);
  EXPECT_EQ(NumberThrownBy([&] { rows->Edit(); }), 3167);
  EXPECT_EQ(NumberThrownBy([&] { rows->Delete(); }), 3167);
  EXPECT_EQ(rows->EditMode(), EditMode::None);
  rows->MoveNext();
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 5);
}

TEST_F(Dynaset, FindFirstTakesTheNumberFormWithItsBlank) {
  rows->FindFirst("ContactID= 5");
  EXPECT_FALSE(rows->NoMatch());
  EXPECT_EQ(TextOf(*rows, "LastName"), "Morgan");
}

TEST_F(Dynaset, FindFirstSearchesFromTheFirstRowWhateverTheCursor) {
  rows->MoveLast();
  rows->FindFirst("DallasID = 'BB'");
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 2);
}

TEST_F(Dynaset, FindFirstWithoutMatchKeepsTheCursor) {
  rows->MoveNext();
  rows->FindFirst("ContactID= 77");
  EXPECT_TRUE(rows->NoMatch());
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 2);
  rows->FindFirst("ContactID= 9");
  EXPECT_FALSE(rows->NoMatch());
}

TEST_F(Dynaset, FindFirstSeesChangesBetweenTwoSearchesForTheSame) {
  rows->FindFirst("LastName = 'Adams'");
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 9);
  file.Execute("UPDATE Members SET LastName = 'Adams' WHERE ContactID = 5");
  rows->FindFirst("LastName = 'Adams'");
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 5);
}

TEST_F(Dynaset, FindFirstFollowsJetsLike) {
  rows->FindFirst("LastName LIKE 'mo*'");
  EXPECT_EQ(TextOf(*rows, "LastName"), "Morgan");
}

TEST_F(Dynaset, FindFirstStaysAmongTheRowsOfItsQuery) {
  const auto found = database->OpenRecordset("SELECT * FROM Members WHERE ContactID > 2");
  found->FindFirst("DallasID = 'BB'");
  EXPECT_EQ(IntegerOf(*found, "ContactID"), 9);
}

TEST_F(Dynaset, FindFirstDoesNotFindDeletedRows) {
  file.Execute("DELETE FROM Members WHERE ContactID = 5");
  rows->FindFirst("ContactID= 5");
  EXPECT_TRUE(rows->NoMatch());
}

TEST_F(Dynaset, UnreadableCriterionIs3077AndKeepsTheCursor) {
  rows->MoveNext();
  for (const char* criterion : {"ContactID=", "", "LastName = 'O'Brien'", "NoSuchColumn = 1", "ContactID = ?",
                                "1); DELETE FROM Members; --", "1) --"}) {
    EXPECT_EQ(NumberThrownBy([&] { rows->FindFirst(criterion); }), 3077) << criterion;
    EXPECT_EQ(IntegerOf(*rows, "ContactID"), 2);
  }
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members"), "4");
}

TEST_F(Dynaset, WalkToFindsTheFirstRowWithTheValue) {
  rows->MoveLast();
  EXPECT_TRUE(rows->WalkTo("DallasID", "BB"));
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 2);
  EXPECT_TRUE(rows->WalkTo("ContactID", Five));
  EXPECT_EQ(TextOf(*rows, "LastName"), "Morgan");
  EXPECT_TRUE(rows->WalkTo("TotalDamage", 0.0));
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 1);
}

TEST_F(Dynaset, WalkToWithoutSuchARowEndsAtTheEnd) {
  EXPECT_FALSE(rows->WalkTo("DallasID", "XX"));
  EXPECT_TRUE(rows->Eof());
  EXPECT_FALSE(rows->Bof());
  rows->MoveFirst();
  EXPECT_FALSE(rows->WalkTo("ContactID", std::int64_t{3}));
  EXPECT_TRUE(rows->Eof());
}

TEST_F(Dynaset, WalkToComparesTextsToTheLetter) {
  EXPECT_FALSE(rows->WalkTo("DallasID", "bb"));
  EXPECT_FALSE(rows->WalkTo("DallasID", "BB "));
  EXPECT_FALSE(rows->WalkTo("DallasID", "B*"));
}

TEST_F(Dynaset, WalkToComparesToTheLetterInAColumnWithoutCase) {
  file.Execute("CREATE TABLE Guns (Name TEXT COLLATE NOCASE); INSERT INTO Guns VALUES ('red'), ('RED')");
  const auto other = file.Open();
  const auto names = other->OpenRecordset("Guns");
  ASSERT_TRUE(names->WalkTo("Name", "RED"));
  EXPECT_EQ(TextOf(*names, "Name"), "RED");
}

TEST_F(Dynaset, WalkToNeverFindsNull) {
  EXPECT_FALSE(rows->WalkTo("DallasID", Value()));
}

TEST_F(Dynaset, WalkToFindsOnlyRowsThatExist) {
  file.Execute("DELETE FROM Members WHERE ContactID IN (2, 5)");
  EXPECT_TRUE(rows->WalkTo("DallasID", "BB"));
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 9);
  EXPECT_FALSE(rows->WalkTo("ContactID", Five));
  EXPECT_TRUE(rows->Eof());
}

TEST_F(Dynaset, WalkToSeesChangedValues) {
  EXPECT_FALSE(rows->WalkTo("DallasID", "CC"));
  file.Execute("UPDATE Members SET DallasID = 'CC' WHERE ContactID = 5");
  EXPECT_TRUE(rows->WalkTo("DallasID", "CC"));
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 5);
}

TEST_F(Dynaset, WalkToTheKeyReadsTheRowAnew) {
  EXPECT_TRUE(rows->WalkTo("ContactID", Five));
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Rhys");
  file.Execute("UPDATE Members SET FirstName = 'Changed' WHERE ContactID = 5");
  EXPECT_TRUE(rows->WalkTo("ContactID", Five));
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Changed");
}

TEST(LargeDynaset, FindsItsPositionAmong100000Rows) {
  const TestDatabase file;
  file.Execute(
      "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 100000) "
      "INSERT INTO Members (ContactID, DallasID, FirstName) SELECT i * 2, 'D' || (i % 50000), 'F' || i FROM "
      "n");
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  const ReadScope reads(*database);
  for (std::int64_t i = 1; i < 100'000; i += 37) {
    ASSERT_TRUE(rows->WalkTo("ContactID", i * 2));
    ASSERT_EQ(TextOf(*rows, "FirstName"), "F" + std::to_string(i));
    ASSERT_TRUE(rows->WalkTo("DallasID", "D" + std::to_string(i % 50'000)));
    const std::int64_t first = i % 50'000 == 0 ? 50'000 : i % 50'000;
    ASSERT_EQ(IntegerOf(*rows, "ContactID"), first * 2);
    rows->MoveNext();
    ASSERT_EQ(IntegerOf(*rows, "ContactID"), (first + 1) * 2);
    rows->FindFirst("ContactID= " + std::to_string(i * 2));
    ASSERT_EQ(TextOf(*rows, "FirstName"), "F" + std::to_string(i));
  }
  ASSERT_FALSE(rows->WalkTo("ContactID", std::int64_t{77'777}));
}

TEST(LargeDynaset, FindsItsPositionAlsoWhereAKeyWasAddedOutOfOrder) {
  const TestDatabase file;
  file.Execute(
      "WITH RECURSIVE n(i) AS (SELECT 10 UNION ALL SELECT i + 1 FROM n WHERE i < 100000) "
      "INSERT INTO Members (ContactID, DallasID) SELECT i, 'BB' FROM n");
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  rows->AddNew();
  rows->SetField("ContactID", std::int64_t{3});
  rows->SetField("DallasID", "BB");
  rows->Update();
  const ReadScope reads(*database);
  for (std::int64_t i = 10; i < 100'000; i += 37) {
    ASSERT_TRUE(rows->WalkTo("ContactID", i));
    rows->MoveNext();
    ASSERT_EQ(IntegerOf(*rows, "ContactID"), i + 1);
  }
  ASSERT_TRUE(rows->WalkTo("DallasID", "BB"));
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 10);
  ASSERT_TRUE(rows->WalkTo("ContactID", std::int64_t{3}));
  rows->MoveNext();
  EXPECT_TRUE(rows->Eof());
}

}  // namespace
