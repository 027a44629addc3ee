#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <string>

#include "tests/platform/sqlite/EditedMembers.h"
#include "tests/support/Thrown.h"

namespace {

using testing::HasSubstr;

using Editing = EditedMembers;

TEST_F(Editing, UpdateWritesTheChangedRowForOthersToSee) {
  rows->MoveNext();
  rows->Edit();
  EXPECT_EQ(rows->EditMode(), EditMode::InProgress);
  rows->SetField("FirstName", "Alicia");
  rows->SetField("TotalDamage", 12.5);
  rows->SetField("TotalGamesPlayed", std::int64_t{7});
  rows->SetField("NickName", Value());
  rows->Update();
  EXPECT_EQ(rows->EditMode(), EditMode::None);
  EXPECT_EQ(
      file.Query("SELECT FirstName || TotalDamage || TotalGamesPlayed FROM Members WHERE ContactID = 2"),
      "Alicia12.57");
  EXPECT_EQ(file.Query("SELECT NickName FROM Members WHERE ContactID = 2"), "NULL");
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Alicia");
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 2);
}

TEST_F(Editing, FieldsShowThePendingValuesAndTheOthersOfTheRow) {
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
  rows->Edit();
  rows->SetField("firstname", "John");
  EXPECT_EQ(TextOf(*rows, "FirstName"), "John");
  EXPECT_EQ(TextOf(*rows, "LastName"), "O'Brien");
  EXPECT_EQ(file.Query("SELECT FirstName FROM Members WHERE ContactID = 1"), "Sean");
}

TEST_F(Editing, UpdatesOneRowAfterTheOtherInTheSameAndInOtherColumns) {
  const auto set = [this](const char* column, const std::string& text) {
    rows->Edit();
    rows->SetField(column, text);
    rows->Update();
  };
  set("FirstName", "one");
  rows->MoveNext();
  set("FirstName", std::string(1000, 'x'));
  set("LastName", "two");
  rows->MoveNext();
  set("LastName", "three");
  set("FirstName", "four");
  EXPECT_EQ(file.Query("SELECT FirstName || LastName FROM Members WHERE ContactID = 1"), "oneO'Brien");
  EXPECT_EQ(file.Query("SELECT length(FirstName) || LastName FROM Members WHERE ContactID = 2"), "1000two");
  EXPECT_EQ(file.Query("SELECT FirstName || LastName FROM Members WHERE ContactID = 5"), "fourthree");
}

TEST_F(Editing, ManyColumnsOfManyRowsAreReadAsTheyAre) {
  std::string seen;
  for (; !rows->Eof(); rows->MoveNext()) {
    for (const char* column : {"DallasID", "FirstName", "LastName", "NickName", "Clan"}) {
      const auto* text = std::get_if<std::string>(&rows->Fields(column));
      seen += (text == nullptr ? "NULL" : *text) + " ";
    }
    EXPECT_EQ(IntegerOf(*rows, "TotalGamesPlayed"), 0);
  }
  EXPECT_EQ(seen,
            "AA Sean O'Brien Shamrock none BB Alice Belmont Mole none NULL Rhys Morgan NULL none "
            "BB Zoe Adams  none ");
}

TEST_F(Editing, UpdateLeavesColumnsThatOthersChangedMeanwhile) {
  rows->Edit();
  rows->SetField("FirstName", "John");
  file.Execute("UPDATE Members SET LastName = 'Changed' WHERE ContactID = 1");
  rows->Update();
  EXPECT_EQ(file.Query("SELECT FirstName || LastName FROM Members WHERE ContactID = 1"), "JohnChanged");
}

TEST_F(Editing, EditReadsTheRowAnew) {
  EXPECT_EQ(IntegerOf(*rows, "TotalGamesPlayed"), 0);
  file.Execute("UPDATE Members SET TotalGamesPlayed = 4");
  rows->Edit();
  rows->SetField("TotalGamesPlayed", IntegerOf(*rows, "TotalGamesPlayed") + 1);
  rows->Update();
  EXPECT_EQ(file.Query("SELECT TotalGamesPlayed FROM Members WHERE ContactID = 1"), "5");
}

TEST_F(Editing, UpdateWithoutAnyChangeLeavesTheRow) {
  rows->Edit();
  rows->Update();
  EXPECT_EQ(rows->EditMode(), EditMode::None);
  EXPECT_EQ(file.Query("SELECT FirstName FROM Members WHERE ContactID = 1"), "Sean");
}

TEST_F(Editing, CancelUpdateDropsTheChanges) {
  rows->Edit();
  rows->SetField("FirstName", "John");
  rows->CancelUpdate();
  EXPECT_EQ(rows->EditMode(), EditMode::None);
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
  rows->Edit();
  rows->Update();
  EXPECT_EQ(file.Query("SELECT FirstName FROM Members WHERE ContactID = 1"), "Sean");
}

TEST_F(Editing, EveryMoveDropsTheChanges) {
  const std::function<void()> moves[] = {
      [&] { rows->MoveFirst(); },
      [&] { rows->MoveNext(); },
      [&] { rows->MoveLast(); },
      [&] { rows->FindFirst("ContactID= 1"); },
      [&] { rows->FindFirst("ContactID= 77"); },
      [&] { rows->WalkTo("ContactID", std::int64_t{1}); },
      [&] { rows->Edit(); },
      [&] { rows->AddNew(); },
  };
  int number = 0;
  for (const auto& move : moves) {
    rows->MoveFirst();
    rows->Edit();
    rows->SetField("FirstName", "John");
    move();
    if (rows->EditMode() == EditMode::None) {
      EXPECT_EQ(NumberThrownBy([&] { rows->Update(); }), 3020) << number;
    } else {
      rows->Update();
    }
    EXPECT_EQ(file.Query("SELECT FirstName FROM Members WHERE ContactID = 1"), "Sean") << number;
    ++number;
  }
}

TEST_F(Editing, WritesWithoutEditOrAddNewAre3020) {
  EXPECT_EQ(NumberThrownBy([&] { rows->SetField("FirstName", "x"); }), 3020);
  EXPECT_EQ(NumberThrownBy([&] { rows->AppendChunk("Photograph", {1}); }), 3020);
  EXPECT_EQ(NumberThrownBy([&] { rows->Update(); }), 3020);
  EXPECT_EQ(NumberThrownBy([&] { rows->CancelUpdate(); }), 3020);
}

TEST_F(Editing, UpdateOfARowThatWasDeletedMeanwhileIs3167) {
  rows->Edit();
  rows->SetField("FirstName", "John");
  file.Execute("DELETE FROM Members WHERE ContactID = 1");
  EXPECT_EQ(NumberThrownBy([&] { rows->Update(); }), 3167);
  EXPECT_EQ(rows->EditMode(), EditMode::InProgress);
  rows->MoveNext();
  rows->Edit();
  file.Execute("DELETE FROM Members WHERE ContactID = 2");
  EXPECT_EQ(NumberThrownBy([&] { rows->Update(); }), 3167);
  EXPECT_EQ(Count(), "2");
}

TEST_F(Editing, NumbersMayBeGivenAsText) {
  rows->Edit();
  rows->SetField("PhotographLength", "  15 ");
  rows->SetField("TotalDamage", "+2.5");
  rows->Update();
  EXPECT_EQ(rows->Fields("PhotographLength"), Value(std::int64_t{15}));
  EXPECT_EQ(rows->Fields("TotalDamage"), Value(2.5));
  rows->Edit();
  rows->SetField("TotalDamage", "-1e3");
  rows->SetField("PhotographLength", ".5");
  rows->Update();
  EXPECT_EQ(rows->Fields("TotalDamage"), Value(-1000.0));
  EXPECT_EQ(rows->Fields("PhotographLength"), Value(0.5));
}

TEST_F(Editing, TextThatIsNoNumberIs3421InANumberColumn) {
  rows->Edit();
  for (const char* text : {"", " ", "abc", "1a", "1 2", "inf", "nan", "1e999", "--1", "0x10"}) {
    EXPECT_EQ(NumberThrownBy([&] { rows->SetField("TotalDamage", text); }), 3421) << text;
  }
  EXPECT_EQ(rows->EditMode(), EditMode::InProgress);
  rows->SetField("FirstName", "abc");
  rows->Update();
  EXPECT_EQ(rows->Fields("TotalDamage"), Value(0.0));
  EXPECT_EQ(rows->Fields("FirstName"), Value("abc"));
}

TEST_F(Editing, StrictTableRefusesWhatIsNotOfItsTypeWith3421) {
  file.Execute(
      "CREATE TABLE Guns (ID INTEGER PRIMARY KEY, Serial BLOB) STRICT; INSERT INTO Guns VALUES (1, X'01')");
  const auto guns = database->OpenRecordset("Guns");
  guns->Edit();
  guns->SetField("Serial", "text");
  EXPECT_EQ(NumberThrownBy([&] { guns->Update(); }), 3421);
  EXPECT_EQ(file.Query("SELECT hex(Serial) FROM Guns"), "01");
}

TEST_F(Editing, RefusedValueLeavesTheOldRowAndTheEditPending) {
  rows->Edit();
  rows->SetField("FirstName", "John");
  rows->SetField("Clan", "refused");
  EXPECT_EQ(NumberThrownBy([&] { rows->Update(); }), 3317);
  EXPECT_EQ(rows->EditMode(), EditMode::InProgress);
  EXPECT_EQ(file.Query("SELECT FirstName || Clan FROM Members WHERE ContactID = 1"), "Seannone");
  EXPECT_EQ(TextOf(*rows, "FirstName"), "John");
  rows->SetField("Clan", "allowed");
  rows->Update();
  EXPECT_EQ(file.Query("SELECT FirstName || Clan FROM Members WHERE ContactID = 1"), "Johnallowed");
}

TEST_F(Editing, NullWhereAValueIsNeededIs3314AndNamesTheColumn) {
  rows->Edit();
  rows->SetField("TotalGamesPlayed", Value());
  const Thrown thrown = ThrownBy([&] { rows->Update(); });
  EXPECT_EQ(thrown.Number, 3314);
  EXPECT_THAT(thrown.Text, HasSubstr("TotalGamesPlayed"));
}

TEST_F(Editing, KeyOfARowCannotBeChanged) {
  rows->Edit();
  EXPECT_EQ(NumberThrownBy([&] { rows->SetField("ContactID", std::int64_t{3}); }), 3164);
}

TEST_F(Editing, SecondRowOfAKeyIs3022) {
  rows->AddNew();
  rows->SetField("ContactID", std::int64_t{5});
  EXPECT_EQ(NumberThrownBy([&] { rows->Update(); }), 3022);
  EXPECT_EQ(rows->EditMode(), EditMode::Add);
  EXPECT_EQ(file.Query("SELECT FirstName FROM Members WHERE ContactID = 5"), "Rhys");
}

TEST_F(Editing, NewRowJoinsAtTheEndWithTheTablesDefaults) {
  rows->AddNew();
  EXPECT_EQ(rows->EditMode(), EditMode::Add);
  rows->SetField("FirstName", "Enter Name");
  rows->Update();
  EXPECT_EQ(AllNumbers(*rows), "1 2 5 9 10 ");
  rows->MoveLast();
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Enter Name");
  EXPECT_EQ(TextOf(*rows, "Clan"), "none");
  EXPECT_EQ(IntegerOf(*rows, "PhotographLength"), 0);
  EXPECT_EQ(file.Query("SELECT FirstName FROM Members WHERE ContactID = 10"), "Enter Name");
}

TEST_F(Editing, NewRowMayBeMadeOfDefaultsAlone) {
  rows->AddNew();
  rows->Update();
  EXPECT_EQ(Count(), "5");
}

TEST_F(Editing, PendingNewRowShowsDefaultsAndNulls) {
  rows->AddNew();
  EXPECT_EQ(rows->Fields("Clan"), Value("none"));
  EXPECT_EQ(rows->Fields("TotalGamesPlayed"), Value(std::int64_t{0}));
  EXPECT_EQ(rows->Fields("FirstName"), Value());
  EXPECT_EQ(rows->Fields("ContactID"), Value());
  rows->SetField("FirstName", "New");
  EXPECT_EQ(rows->Fields("FirstName"), Value("New"));
}

TEST_F(Editing, CursorStaysWhereItWasAfterANewRow) {
  rows->MoveNext();
  rows->AddNew();
  rows->SetField("FirstName", "New");
  rows->Update();
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 2);
  while (!rows->Eof()) {
    rows->MoveNext();
  }
  rows->AddNew();
  rows->Update();
  EXPECT_TRUE(rows->Eof());
}

TEST_F(Editing, CancelledNewRowIsNotThere) {
  rows->AddNew();
  rows->SetField("FirstName", "New");
  rows->CancelUpdate();
  EXPECT_EQ(AllNumbers(*rows), "1 2 5 9 ");
  EXPECT_EQ(Count(), "4");
}

TEST_F(Editing, NewRowIsFoundByEveryMeans) {
  rows->AddNew();
  rows->SetField("DallasID", "NEW");
  rows->Update();
  EXPECT_TRUE(rows->WalkTo("DallasID", "NEW"));
  EXPECT_TRUE(rows->WalkTo("ContactID", std::int64_t{10}));
  rows->FindFirst("DallasID = 'NEW'");
  EXPECT_FALSE(rows->NoMatch());
}

TEST_F(Editing, NewRowThatReusesTheKeyOfADeletedOneIsListedOnceAndLast) {
  rows->MoveLast();
  file.Execute("DELETE FROM Members WHERE ContactID = 2");
  rows->AddNew();
  rows->SetField("ContactID", std::int64_t{2});
  rows->SetField("FirstName", "New");
  rows->Update();
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 9);
  EXPECT_EQ(AllNumbers(*rows), "1 5 9 2 ");
}

TEST_F(Editing, DeleteTakesTheRowAwayAndStandsOnNone) {
  rows->MoveNext();
  rows->Delete();
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members WHERE ContactID = 2"), "0");
  EXPECT_FALSE(rows->Eof());
  EXPECT_EQ(NumberThrownBy([&] { rows->Fields("ContactID"); }), 3021);
  EXPECT_EQ(NumberThrownBy([&] { rows->Edit(); }), 3021);
  EXPECT_EQ(NumberThrownBy([&] { rows->Delete(); }), 3021);
  rows->MoveNext();
  EXPECT_EQ(IntegerOf(*rows, "ContactID"), 5);
  EXPECT_EQ(AllNumbers(*rows), "1 5 9 ");
}

TEST_F(Editing, DeletingTheLastRowsLeavesAnEmptySet) {
  for (int i = 0; i < 4; ++i) {
    rows->MoveLast();
    rows->Delete();
  }
  EXPECT_EQ(Count(), "0");
  rows->MoveFirst();
  EXPECT_TRUE(rows->Eof());
  EXPECT_TRUE(rows->Bof());
}

TEST_F(Editing, MoveNextAfterDeletingTheLastRowReachesTheEnd) {
  rows->MoveLast();
  rows->Delete();
  rows->MoveNext();
  EXPECT_TRUE(rows->Eof());
  EXPECT_FALSE(rows->Bof());
}

TEST_F(Editing, TwoRecordsetsOfOneDatabaseSeeEachOthersChanges) {
  const auto other = database->OpenRecordset("SELECT * FROM Members WHERE ContactID = 1");
  other->Edit();
  other->SetField("FirstName", "John");
  other->Update();
  rows->MoveFirst();
  EXPECT_EQ(TextOf(*rows, "FirstName"), "John");
  other->Delete();
  rows->MoveFirst();
  EXPECT_EQ(NumberThrownBy([&] { rows->Fields("FirstName"); }), 3167);
}

}  // namespace
