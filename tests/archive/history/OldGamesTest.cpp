#include "archive/history/OldGames.h"

#include <gmock/gmock.h>

#include "tests/archive/history/HistoryVenue.h"
#include "tests/support/OpenSession.h"
#include "tests/support/TightDisk.h"

namespace {

TEST(YearsToKeep, AreAWholeNumberFromOneOn) {
  EXPECT_EQ(YearsToKeep("3"), 3);
  EXPECT_EQ(YearsToKeep("100"), 100);
  for (const char* text : {"", "0", "-1", "101", "2.5", "3 years", "3 ", "99999999999"}) {
    EXPECT_EQ(YearsToKeep(text), std::nullopt) << text;
  }
}

TEST(YearsBefore, IsTheSameDayAndTime) {
  EXPECT_EQ(YearsBefore("2026-11-23 04:05:06", 3), "2023-11-23 04:05:06");
  EXPECT_EQ(YearsBefore("0007-01-01 00:00:00", 2), "0005-01-01 00:00:00");
}

class GamesOfYears : public testing::Test, protected HistoryVenue {
 protected:
  GamesOfYears() {
    Keep("2020-01-01 20:00:00", 1);
    Keep("2021-01-01 20:00:00", 2);
    Keep("2022-01-01 20:00:00", 3);
    Keep("", 4);
  }

  std::string Count(const std::string& table) const { return Query("SELECT count(*) FROM " + table); }
};

TEST_F(GamesOfYears, AreCountedWithDeletedOnesButNotWithoutATime) {
  Delete(1);
  EXPECT_EQ(GamesPlayedBefore(ArchiveSql(), "2022-01-01 20:00:00"), 2);
  EXPECT_EQ(GamesPlayedBefore(ArchiveSql(), "2030"), 3);
}

TEST_F(GamesOfYears, GoWithAllThatIsKeptOfThem) {
  ++Game.Players(Blue7).HitByPlayer(Red0);
  Archive->KeepAgain(1, State(), FormerState::KeptToo);
  EXPECT_EQ(Count("sqlar"), "5");
  EXPECT_EQ(DeleteGamesBefore(*ArchiveDatabase, "2022-01-01 20:00:00", 100), 2);
  EXPECT_EQ(Query("SELECT group_concat(GameID) FROM (SELECT GameID FROM Games ORDER BY GameID)"), "3,4");
  EXPECT_EQ(Query("SELECT group_concat(DISTINCT GameID) FROM GamePlayers"), "3,4");
  EXPECT_EQ(Query("SELECT group_concat(GameID) FROM GameFiles"), "3,4");
  EXPECT_EQ(Count("sqlar"), "2");
}

TEST_F(GamesOfYears, AreCountedThroughAnIndex) {
  PlannedSql sql(ArchiveSql());
  GamesPlayedBefore(sql, "2022");
  EXPECT_THAT(sql.Plan(), testing::HasSubstr("SEARCH Games USING COVERING INDEX GamesByPlayed"));
}

TEST_F(GamesOfYears, GoTheOldestFirst) {
  EXPECT_EQ(DeleteGamesBefore(*ArchiveDatabase, "2030", 1), 1);
  EXPECT_EQ(Query("SELECT group_concat(GameID) FROM (SELECT GameID FROM Games ORDER BY GameID)"), "2,3,4");
  EXPECT_EQ(DeleteGamesBefore(*ArchiveDatabase, "2030", 5), 2);
  EXPECT_EQ(DeleteGamesBefore(*ArchiveDatabase, "2030", 5), 0);
}

class GamesToDelete : public GamesOfYears {
 protected:
  OpenSession site;
  TightDisk disk;
  ArchiveAccess access{{.Session = site.session,
                        .Disk = disk,
                        .Engine = site.Databases,
                        .Strings = site.Strings,
                        .UserDataFolder = Folder.Path(),
                        .ProgramFolder = Folder.Path()}};
  std::string before = "2022-01-01 20:00:00";
};

TEST_F(GamesToDelete, GoSomeAtATime) {
  for (int day = 10; day < 15; ++day) {
    Keep("2019-03-" + std::to_string(day) + " 20:00:00", day);
  }
  EXPECT_TRUE(DeleteSomeGamesBefore(access, before));
  EXPECT_EQ(Count("Games"), "4");
  EXPECT_FALSE(DeleteSomeGamesBefore(access, before));
  EXPECT_EQ(Count("Games"), "2");
  EXPECT_EQ(before, "");
  EXPECT_FALSE(DeleteSomeGamesBefore(access, before));
  EXPECT_EQ(Count("Games"), "2");
}

TEST_F(GamesToDelete, StayWhileTheDiskIsNarrow) {
  disk.Space = LeastFreeSpace - 1;
  EXPECT_FALSE(DeleteSomeGamesBefore(access, before));
  EXPECT_EQ(Count("Games"), "4");
  disk.Space = LeastFreeSpace;
  DeleteSomeGamesBefore(access, before);
  EXPECT_EQ(Count("Games"), "2");
}

TEST_F(GamesToDelete, StayWhileAnotherProgramHasTheArchiveAndGoAfterwards) {
  OtherConnection other(ArchivePath());
  other.Execute("BEGIN IMMEDIATE");
  EXPECT_FALSE(DeleteSomeGamesBefore(access, before));
  EXPECT_EQ(Count("Games"), "4");
  other.Execute("ROLLBACK");
  DeleteSomeGamesBefore(access, before);
  EXPECT_EQ(Count("Games"), "2");
}

}  // namespace
