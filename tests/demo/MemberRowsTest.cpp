#include "demo/MemberRows.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <stdexcept>

#include "core/data/Photo.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/TestDatabase.h"

namespace {

class MemberRows : public testing::Test {
 protected:
  MemberRows() {
    std::filesystem::copy_file(TESSARINE_PROGRAM_FOLDER "/members_default.mdb", folder / "members.mdb");
    database = SqliteEngine().OpenDatabase(folder / "members.mdb");
  }

  void Add(const std::vector<DemoMember>& members, const std::vector<std::string>& buttons) {
    AddMembers({*database, disk, boxes}, members, buttons, QDate(2026, 3, 2));
  }

  std::string Query(const std::string& sql) const {
    return OtherConnection(folder / "members.mdb").Query(sql);
  }

  TemporaryFolder folder;
  std::unique_ptr<Database> database;
  LinuxFiles disk;
  FakeMessageBoxes boxes;
};

DemoMember Ada() {
  DemoMember member = DemoMembers().front();
  member.Details = {"Ada", "Byron", "Count", "Engines", "1990-12-10 00:00:00", "", "", "", "", ""};
  member.DateJoined = "2025-01-31 18:00:00";
  member.DaysSincePlayed = 3;
  member.Games = 4;
  member.DamagePerGame = 100;
  member.SoldieringPerGame = 90;
  member.Accuracy = 0.25;
  return member;
}

TEST_F(MemberRows, HoldDetailsButtonAndHistory) {
  Add({Ada()}, {"0900002004030201"});
  EXPECT_EQ(Query("SELECT ContactID || ' ' || DallasID || ' ' || FirstName || ' ' || LastName || ' ' || "
                  "NickName || ' ' || Clan FROM Members"),
            "1 0900002004030201 Ada Byron Count Engines");
  EXPECT_EQ(Query("SELECT DateJoined || ', ' || LastPlayedDate FROM Members"),
            "2025-01-31 18:00:00, 2026-02-27 21:05:00");
  EXPECT_EQ(Query("SELECT TotalGamesPlayed || ' ' || TotalDamage || ' ' || AverageDamage || ' ' || "
                  "TotalSoldiering || ' ' || AverageSoldiering FROM Members"),
            "4 400.0 100.0 360.0 90.0");
  EXPECT_EQ(Query("SELECT TotalPrimaryAccuracy || ' ' || AveragePrimAccuracy FROM Members"), "1.0 0.25");
}

TEST_F(MemberRows, HoldThePhotograph) {
  const DemoMember ada = Ada();
  Add({ada}, {"0900002004030201"});
  const std::string file = PortraitFile(ada.Look).toStdString();
  const std::string stored =
      StoredPhoto(*database->OpenRecordset("Members"), "Photograph", "PhotographLength");
  EXPECT_EQ(Query("SELECT PhotographLength FROM Members"), std::to_string(file.size()));
  EXPECT_TRUE(stored.starts_with(file));
  EXPECT_TRUE(boxes.Boxes.empty());
}

TEST_F(MemberRows, TellWhoOwnsWhichButton) {
  DemoMember other = Ada();
  other.Details.FirstName = "晓雯";
  other.Details.LastName = "林";
  other.Details.NickName.clear();
  Add({Ada(), other}, {"0900002004030201", "0900004004030201"});
  EXPECT_EQ(ButtonOwners(*database->OpenRecordset("Members")).toStdString(),
            "Button\tMember number\tNickname\tNames\n"
            "0900002004030201\t1\tCount\tAda Byron\n"
            "0900004004030201\t2\t\t晓雯 林\n");
}

TEST_F(MemberRows, AreAllThereOrNone) {
  EXPECT_THROW(Add({Ada(), Ada()}, {"0900002004030201"}), std::out_of_range);
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "0");
}

TEST_F(MemberRows, HoldEveryMemberOfTheDemo) {
  const std::vector<DemoMember>& members = DemoMembers();
  Add(members, std::vector<std::string>(members.size(), "0900002004030201"));
  EXPECT_EQ(Query("SELECT count(*) FROM Members WHERE PhotographLength > 0 AND TotalGamesPlayed > 0"), "12");
}

}  // namespace
