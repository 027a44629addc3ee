#include <gtest/gtest.h>

#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

class MovePrevious : public testing::Test {
 protected:
  void Open() {
    database = file.Open();
    rows = database->OpenRecordset("Members");
  }

  TestDatabase file;
  std::unique_ptr<Database> database;
  std::unique_ptr<Recordset> rows;
};

TEST_F(MovePrevious, GoesFromTheLastRowToBeforeTheFirst) {
  file.AddMembers();
  Open();
  std::string numbers;
  for (rows->MoveLast(); !rows->Bof(); rows->MovePrevious()) {
    numbers += std::to_string(IntegerOf(*rows, "ContactID")) + " ";
  }
  EXPECT_EQ(numbers, "9 5 2 1 ");
  EXPECT_FALSE(rows->Eof());
  EXPECT_EQ(NumberThrownBy([&] { rows->MovePrevious(); }), 3021);
  EXPECT_EQ(NumberThrownBy([&] { rows->Fields("ContactID"); }), 3021);
  rows->MoveNext();
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 1);
}

TEST_F(MovePrevious, FromTheEndStandsOnTheLastRow) {
  file.AddMembers();
  Open();
  rows->MoveLast();
  rows->MoveNext();
  rows->MovePrevious();
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 9);
}

TEST_F(MovePrevious, FromADeletedRowStandsOnTheOneBefore) {
  file.AddMembers();
  Open();
  rows->WalkTo("ContactID", std::int64_t{5});
  rows->Delete();
  rows->MovePrevious();
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 2);
}

TEST_F(MovePrevious, OnAnEmptySetIs3021) {
  Open();
  EXPECT_TRUE(rows->Bof());
  EXPECT_EQ(NumberThrownBy([&] { rows->MovePrevious(); }), 3021);
  EXPECT_TRUE(rows->Bof() && rows->Eof());
}

TEST_F(MovePrevious, DropsThePendingEdit) {
  file.AddMembers();
  Open();
  rows->MoveNext();
  rows->Edit();
  rows->SetField("FirstName", "dropped");
  rows->MovePrevious();
  EXPECT_EQ(rows->EditMode(), EditMode::None);
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members WHERE FirstName = 'dropped'"), "0");
}

TEST_F(MovePrevious, CountsRowsAndTellsThePlace) {
  Open();
  EXPECT_EQ(rows->RecordCount(), 0);
  EXPECT_EQ(rows->AbsolutePosition(), -1);
  file.AddMembers();
  Open();
  EXPECT_EQ(rows->RecordCount(), 4);
  EXPECT_EQ(rows->AbsolutePosition(), 0);
  rows->MoveLast();
  EXPECT_EQ(rows->AbsolutePosition(), 3);
  rows->MoveNext();
  EXPECT_EQ(rows->AbsolutePosition(), -1);
  rows->MovePrevious();
  rows->Delete();
  EXPECT_EQ(rows->RecordCount(), 3);
  EXPECT_EQ(rows->AbsolutePosition(), -1);
}

}  // namespace
