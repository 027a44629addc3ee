#include "members/MemberCursor.h"

#include <gtest/gtest.h>

#include "core/data/FieldValue.h"
#include "members/MemberQueries.h"
#include "tests/members/MemberFile.h"
#include "tests/support/FileSizeLimit.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/Thrown.h"

namespace {

/// Controls without a window.
class Controls final : public BoundControls {
 public:
  void ShowRow(Recordset& rows) override {
    Details = ReadDetails(rows);
    Number = TextOf(rows.Fields("ContactID"));
  }
  void ShowNoRow() override {
    Details = {};
    Number = "none";
  }
  MemberDetails Entered() const override { return Details; }
  void RowChanged() override { Changes += Number + " "; }

  MemberDetails Details;
  std::string Number;
  std::string Changes;
};

class CursorOnMembers : public testing::Test {
 protected:
  void Open() {
    database = file.Open();
    rows = std::make_unique<MemberCursor>(*database, controls);
    rows->Refresh(AllMembers);
    controls.Changes.clear();
  }

  MemberFile file;
  Controls controls;
  std::unique_ptr<Database> database;
  std::unique_ptr<MemberCursor> rows;
};

TEST_F(CursorOnMembers, ShowsTheFirstRowAfterARefresh) {
  Open();
  EXPECT_EQ(controls.Number, "1");
  rows->Refresh(SearchQuery("mole"));
  EXPECT_EQ(controls.Number, "2");
  EXPECT_TRUE(rows->HasRow());
}

TEST_F(CursorOnMembers, StopsAtBothEnds) {
  Open();
  rows->MovePrevious();
  for (int i = 0; i < 4; ++i) {
    rows->MoveNext();
  }
  rows->MoveFirst();
  rows->MoveLast();
  rows->MovePrevious();
  EXPECT_EQ(controls.Changes, "1 2 5 9 9 1 9 5 ");
}

TEST_F(CursorOnMembers, ShowsNoRowOfAnEmptySet) {
  file.Execute("DELETE FROM Members");
  Open();
  EXPECT_FALSE(rows->HasRow());
  controls.Details.FirstName = "typed";
  for (const auto move : {&MemberCursor::MoveFirst, &MemberCursor::MovePrevious, &MemberCursor::MoveNext,
                          &MemberCursor::MoveLast}) {
    ((*rows).*move)();
  }
  EXPECT_EQ(controls.Changes, "none none none none ");
  EXPECT_EQ(NumberThrownBy([&] { rows->Delete(); }), 3021);
}

TEST_F(CursorOnMembers, WritesBackWhenItLeavesTheRow) {
  Open();
  controls.Details.City = "Cardiff";
  rows->MoveNext();
  EXPECT_EQ(file.Stored("City", 1), "Cardiff");
  EXPECT_EQ(controls.Details.City, "");
  controls.Details.Clan = "Moles";
  rows->Refresh(SearchQuery("nobody"));
  EXPECT_EQ(file.Stored("Clan", 2), "Moles");
}

TEST_F(CursorOnMembers, WritesNothingWhenNothingWasChanged) {
  Open();
  OtherConnection other(file.Path());
  other.Execute("BEGIN IMMEDIATE");
  rows->MoveNext();
  rows->Refresh(AllMembers);
  rows->WriteBack();
  EXPECT_EQ(controls.Changes, "2 1 ");
}

TEST_F(CursorOnMembers, KeepsWhatOthersWroteIntoOtherColumnsOfTheRow) {
  Open();
  file.Execute("UPDATE Members SET TotalGamesPlayed = 7, City = 'Other' WHERE ContactID = 1");
  controls.Details.NickName = "Dragon";
  rows->MoveNext();
  EXPECT_EQ(file.Stored("TotalGamesPlayed || City || NickName", 1), "7OtherDragon");
}

TEST_F(CursorOnMembers, WalksToAMember) {
  Open();
  controls.Details.City = "Cardiff";
  rows->WalkTo(5);
  EXPECT_EQ(controls.Number, "5");
  EXPECT_EQ(file.Stored("City", 1), "Cardiff");
}

TEST_F(CursorOnMembers, StandsBehindTheLastRowForAMemberThatIsGone) {
  Open();
  rows->WalkTo(77);
  EXPECT_TRUE(rows->Rows().Eof());
  EXPECT_FALSE(rows->HasRow());
  rows->MovePrevious();
  EXPECT_EQ(controls.Number, "9");
  rows->WalkTo(77);
  rows->MoveNext();
  EXPECT_EQ(controls.Number, "9");
}

TEST_F(CursorOnMembers, AddsAMemberWithItsMomentAndShowsIt) {
  Open();
  controls.Details.City = "Cardiff";
  rows->AddMember("2013-05-21 14:30:05");
  rows->AddMember("2013-05-21 14:30:06");
  EXPECT_EQ(controls.Number, "11");
  EXPECT_EQ(file.Stored("City", 1), "Cardiff");
  EXPECT_EQ(file.Stored("DateJoined || FirstName || LastName || TotalGamesPlayed || PhotographLength", 10),
            "2013-05-21 14:30:05Enter NameEnter Name00");
  EXPECT_EQ(file.Stored("DateJoined", 11), "2013-05-21 14:30:06");
}

TEST_F(CursorOnMembers, ShowsTheFirstRowAfterADeletion) {
  Open();
  rows->WalkTo(5);
  controls.Details.City = "given up";
  rows->Delete();
  EXPECT_EQ(controls.Number, "1");
  EXPECT_EQ(file.Query("SELECT sum(ContactID) FROM Members"), "12");
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members WHERE City = 'given up'"), "0");
}

TEST_F(CursorOnMembers, WritesOneColumnAtOnceAndKeepsTheOpenChanges) {
  Open();
  controls.Details.City = "Cardiff";
  rows->SetField("DallasID", "EFCDAB8967452301");
  EXPECT_EQ(file.Stored("DallasID", 1), "EFCDAB8967452301");
  EXPECT_EQ(file.Stored("City", 1), "NULL");
  rows->MoveNext();
  EXPECT_EQ(file.Stored("City", 1), "Cardiff");
}

TEST_F(CursorOnMembers, StaysOnItsRowWithTheChangesWhileTheFileIsLocked) {
  Open();
  controls.Details.City = "Cardiff";
  {
    OtherConnection other(file.Path());
    other.Execute("BEGIN IMMEDIATE");
    EXPECT_EQ(NumberThrownBy([&] { rows->MoveNext(); }), 3050);
    EXPECT_EQ(NumberThrownBy([&] { rows->Refresh(AllMembers); }), 3050);
    EXPECT_EQ(NumberThrownBy([&] { rows->AddMember("now"); }), 3050);
  }
  EXPECT_EQ(controls.Changes, "");
  EXPECT_EQ(controls.Details.City, "Cardiff");
  rows->MoveNext();
  EXPECT_EQ(file.Stored("City", 1), "Cardiff");
}

TEST_F(CursorOnMembers, LeavesNothingPendingWhenAMemberCannotBeAdded) {
  Open();
  {
    OtherConnection other(file.Path());
    other.Execute("BEGIN IMMEDIATE");
    EXPECT_EQ(NumberThrownBy([&] { rows->AddMember("now"); }), 3050);
  }
  EXPECT_EQ(rows->Rows().EditMode(), EditMode::None);
}

TEST_F(CursorOnMembers, SaysThatAReadOnlyFileTakesNoChange) {
  std::filesystem::permissions(file.Path(), std::filesystem::perms(0444));
  const OrdinaryUser user;
  Open();
  rows->MoveNext();
  controls.Details.City = "Cardiff";
  EXPECT_EQ(NumberThrownBy([&] { rows->MoveNext(); }), 3027);
  EXPECT_EQ(controls.Number, "2");
  EXPECT_EQ(controls.Details.City, "Cardiff");
}

TEST_F(CursorOnMembers, KeepsTheOldRowsOnAFullDisk) {
  Open();
  controls.Details.Address = std::string(20000, 'x');
  {
    const FileSizeLimit full(4096);
    EXPECT_EQ(NumberThrownBy([&] { rows->MoveNext(); }), 3026);
    EXPECT_EQ(NumberThrownBy([&] { rows->Delete(); }), 3026);
  }
  EXPECT_EQ(file.Stored("Address", 1), "NULL");
  EXPECT_EQ(controls.Number, "1");
  rows->MoveNext();
  EXPECT_EQ(file.Stored("length(Address)", 1), "20000");
}

TEST_F(CursorOnMembers, GivesUpTheChangesOfARowThatIsGone) {
  Open();
  controls.Details.City = "Cardiff";
  file.Execute("DELETE FROM Members WHERE ContactID = 1");
  EXPECT_EQ(NumberThrownBy([&] { rows->MoveNext(); }), 3167);
  rows->MoveNext();
  EXPECT_EQ(controls.Number, "2");
}

TEST_F(CursorOnMembers, PassesOverARowThatIsGone) {
  Open();
  file.Execute("DELETE FROM Members WHERE ContactID = 2");
  EXPECT_EQ(NumberThrownBy([&] { rows->MoveNext(); }), 3167);
  EXPECT_FALSE(rows->HasRow());
  EXPECT_EQ(controls.Number, "none");
  controls.Details.City = "nowhere";
  rows->MoveNext();
  EXPECT_EQ(controls.Number, "5");
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members WHERE City = 'nowhere'"), "0");
}

TEST_F(CursorOnMembers, KeepsTheOldRowsWhenAQueryCannotBeRead) {
  Open();
  rows->MoveNext();
  EXPECT_EQ(NumberThrownBy([&] { rows->Refresh(SearchQuery("O'B")); }), 3075);
  EXPECT_EQ(controls.Number, "2");
  EXPECT_TRUE(rows->HasRow());
  rows->MoveNext();
  EXPECT_EQ(controls.Number, "5");
}

}  // namespace
