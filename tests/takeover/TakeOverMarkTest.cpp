#include "takeover/TakeOverMark.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"
#include "tests/support/Thrown.h"

namespace {

constexpr const char* Mark = "/data/.takeover-ready";

class Marked : public testing::Test {
 protected:
  Marked() {
    disk.Put("/data/members.mdb", "old members");
    disk.Put("/data/tessarine.ini", "old settings");
    disk.Put("/data/.takeover/members.mdb", "new members");
    disk.Put("/data/.takeover/tessarine.ini", std::string(3U << 20U, 'n'));
  }

  void PutMark() { MarkTakeOver(disk, "/data", {"members.mdb", "tessarine.ini"}); }

  bool AllIsNew() const {
    return disk.Read("/data/members.mdb") == "new members" &&
           disk.Read("/data/tessarine.ini") == std::string(3U << 20U, 'n');
  }

  FakeFiles disk;
};

TEST_F(Marked, FilesTakeTheirPlacesAndNothingIsLeft) {
  PutMark();
  EXPECT_TRUE(FinishTakeOver(disk, "/data"));
  EXPECT_TRUE(AllIsNew());
  EXPECT_FALSE(disk.FileExists(Mark));
  EXPECT_TRUE(disk.FileNames("/data/.takeover").empty());
  EXPECT_FALSE(FinishTakeOver(disk, "/data"));
}

TEST_F(Marked, WithoutAMarkEverythingStays) {
  EXPECT_FALSE(FinishTakeOver(disk, "/data"));
  EXPECT_EQ(disk.Read("/data/members.mdb"), "old members");
}

TEST_F(Marked, AFailureInTheMiddleIsMadeUpForNextTime) {
  PutMark();
  FakeFiles atNextStart = disk;
  disk.FailReplace("/data/tessarine.ini", RuntimeError(Fault::DiskFull));
  EXPECT_EQ(NumberThrownBy([&] { FinishTakeOver(disk, "/data"); }), Fault::DiskFull);
  EXPECT_EQ(disk.Read("/data/members.mdb"), "new members");
  ASSERT_TRUE(HasTakeOverMark(disk, "/data"));
  atNextStart.Put("/data/members.mdb", "new members");
  EXPECT_TRUE(FinishTakeOver(atNextStart, "/data"));
  EXPECT_EQ(atNextStart.Read("/data/members.mdb"), "new members");
  EXPECT_EQ(atNextStart.Read("/data/tessarine.ini"), std::string(3U << 20U, 'n'));
}

TEST_F(Marked, AChangedOrMissingFileStopsItBeforeAnythingIsReplaced) {
  PutMark();
  disk.Put("/data/.takeover/tessarine.ini", std::string(3U << 20U, 'x'));
  const Thrown changed = ThrownBy([&] { FinishTakeOver(disk, "/data"); });
  EXPECT_EQ(changed.Number, Fault::InvalidFileFormat);
  EXPECT_EQ(changed.Text, "Invalid file format: /data/.takeover/tessarine.ini");
  disk.Remove("/data/.takeover/tessarine.ini");
  EXPECT_EQ(NumberThrownBy([&] { FinishTakeOver(disk, "/data"); }), Fault::FileNotFound);
  EXPECT_EQ(disk.Read("/data/members.mdb"), "old members");
}

TEST_F(Marked, AMarkOfAnotherHandGivesNothingAway) {
  for (const char* mark : {"", "Files to take over\n", "Files to take over\nmembers.mdb 11\nend\n",
                           "Files to take over\n../members.mdb 11 1\nend\n",
                           "Files to take over\ngames.mdb 11 1\nend\n", "something else\nend\n"}) {
    disk.Put(Mark, mark);
    EXPECT_EQ(NumberThrownBy([&] { FinishTakeOver(disk, "/data"); }), Fault::InvalidFileFormat) << mark;
    EXPECT_EQ(disk.Read("/data/members.mdb"), "old members");
  }
}

TEST_F(Marked, JournalsOfTheOldDatabaseGo) {
  disk.Put("/data/members.mdb-journal", "j");
  disk.Put("/data/members.mdb-wal", "w");
  PutMark();
  FinishTakeOver(disk, "/data");
  EXPECT_FALSE(disk.FileExists("/data/members.mdb-journal"));
  EXPECT_FALSE(disk.FileExists("/data/members.mdb-wal"));
}

TEST_F(Marked, TakenBackItLeavesAllOld) {
  PutMark();
  WithdrawTakeOver(disk, "/data");
  EXPECT_FALSE(FinishTakeOver(disk, "/data"));
  EXPECT_EQ(disk.Read("/data/members.mdb"), "old members");
  EXPECT_TRUE(disk.FileNames("/data/.takeover").empty());
}

TEST_F(Marked, AMarkThatAPowerFailureBroughtBackDoesNoHarm) {
  PutMark();
  disk.FailDelete(Mark, RuntimeError(Fault::PathAccess));
  EXPECT_EQ(NumberThrownBy([&] { FinishTakeOver(disk, "/data"); }), Fault::PathAccess);
  EXPECT_TRUE(AllIsNew());
  FakeFiles atNextStart = disk;
  for (const std::string& name : disk.FileNames("/data/.takeover")) {
    atNextStart.Remove("/data/.takeover/" + name);
  }
  EXPECT_EQ(NumberThrownBy([&] { FinishTakeOver(atNextStart, "/data"); }), Fault::PathAccess);
  EXPECT_EQ(atNextStart.Read("/data/members.mdb"), "new members");
}

TEST_F(Marked, NoMarkStandsWhenAFileCannotBeRead) {
  disk.FailRead("/data/.takeover/members.mdb", RuntimeError(Fault::PathAccess));
  EXPECT_EQ(NumberThrownBy([&] { PutMark(); }), Fault::PathAccess);
  EXPECT_FALSE(HasTakeOverMark(disk, "/data"));
}

}  // namespace
