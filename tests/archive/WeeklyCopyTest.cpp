#include <gmock/gmock.h>

#include "archive/ArchiveCopies.h"
#include "tests/archive/KeeperVenue.h"
#include "tests/support/OrdinaryUser.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class ArchivesWeeklyCopy : public KeeperVenue {
 protected:
  ArchivesWeeklyCopy() {
    disk.Space = std::uint64_t{1} << 30U;
    At("2026-11-01 10:00:00");
  }

  void At(const std::string& time) { venue.Time.DateAndTime = time; }

  /// Many megabytes among the games.
  void Fill() const {
    ExecuteSql(ArchivePath(),
               "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 8) "
               "INSERT INTO sqlar SELECT 'x' || i, 0, 0, 0, randomblob(1000000) FROM n");
  }

  /// Returns how many steps there were before the last.
  int CopyWhole() {
    int steps = 0;
    while (keeper->CopyAPart()) {
      ++steps;
    }
    EXPECT_EQ(keeper->State().CopyFailure, "");
    return steps;
  }

  std::vector<std::string> Files() const { return disk.FileNames(venue.Folder / "backups"); }
  std::string InCopy(const std::string& sql) const {
    return OtherConnection(ArchiveCopyPaths(disk, venue.Folder.Path()).at(0)).Query(sql);
  }
  std::string PartPath() const { return UnfinishedWeeklyCopy(ArchivePath(), venue.Folder.Path()); }
};

TEST_F(ArchivesWeeklyCopy, IsNotMadeWithoutAnArchive) {
  EXPECT_FALSE(keeper->CopyAPart());
  EXPECT_THAT(Files(), IsEmpty());
  EXPECT_FALSE(ArchiveExists());
}

TEST_F(ArchivesWeeklyCopy, IsMadeInStepsAndHoldsAll) {
  Pull();
  Fill();
  EXPECT_GE(CopyWhole(), 7);
  EXPECT_THAT(Files(), ElementsAre("games-2026-11-01-100000-weekly.mdb"));
  EXPECT_EQ(InCopy("PRAGMA integrity_check"), "ok");
  EXPECT_EQ(InCopy("SELECT count(*) FROM Games"), "1");
  EXPECT_EQ(InCopy("SELECT sum(length(data)) FROM sqlar WHERE name < 'y' AND name >= 'x'"), "8000000");
}

TEST_F(ArchivesWeeklyCopy, IsMadeOnceAWeekAndTheLastTwoStay) {
  Pull();
  for (const char* time : {"2026-11-01 10:00:00", "2026-11-08 09:59:00", "2026-11-08 10:00:00",
                           "2026-11-12 10:00:00", "2026-11-20 10:00:00"}) {
    At(time);
    CopyWhole();
  }
  EXPECT_THAT(Files(),
              ElementsAre("games-2026-11-08-100000-weekly.mdb", "games-2026-11-20-100000-weekly.mdb"));
}

TEST_F(ArchivesWeeklyCopy, LeavesOtherCopiesAlone) {
  Pull();
  std::filesystem::create_directory(venue.Folder / "backups");
  const std::vector<std::string> others = {"games-2020-01-01-100000-kept.mdb",
                                           "games-2020-01-01-100000-replaced.mdb",
                                           "members-2020-01-01-100000.mdb"};
  for (const std::string& other : others) {
    WriteFile(venue.Folder / ("backups/" + other), "x");
  }
  for (const char* time : {"2026-11-01 10:00:00", "2026-11-10 10:00:00", "2026-11-20 10:00:00"}) {
    At(time);
    CopyWhole();
  }
  EXPECT_THAT(Files(), testing::IsSupersetOf(others));
  EXPECT_EQ(Files().size(), 5U);
}

TEST_F(ArchivesWeeklyCopy, OfAnotherArchiveStaysWhenThatOneIsDamaged) {
  Pull();
  std::filesystem::create_directory(venue.Folder / "backups");
  const std::vector<std::string> others = {"games-new-2020-01-01-100000-weekly.mdb",
                                           "games-new-2020-01-08-100000-weekly.mdb"};
  for (const std::string& other : others) {
    WriteFile(venue.Folder / ("backups/" + other), "x");
  }
  for (const char* time : {"2026-11-01 10:00:00", "2026-11-10 10:00:00", "2026-11-20 10:00:00"}) {
    At(time);
    CopyWhole();
  }
  EXPECT_THAT(Files(), testing::IsSupersetOf(others));
  EXPECT_EQ(Files().size(), 4U);
}

TEST_F(ArchivesWeeklyCopy, IsMadeThoughAnEarlierOneIsFromAWrongClock) {
  Pull();
  for (const char* time : {"2036-01-01 10:00:00", "2037-01-01 10:00:00", "2026-11-01 10:00:00"}) {
    At(time);
    CopyWhole();
  }
  EXPECT_THAT(Files(),
              ElementsAre("games-2026-11-01-100000-weekly.mdb", "games-2037-01-01-100000-weekly.mdb"));
  EXPECT_FALSE(keeper->CopyAPart());
}

TEST_F(ArchivesWeeklyCopy, GoesOnWhileGamesAreKeptAndHoldsThem) {
  Pull();
  Fill();
  int steps = 0;
  while (keeper->CopyAPart()) {
    ++steps;
    if (steps < 7) {  // until all is copied
      ++session.Game().Players(Red0).BonusPoints;
      keeper->Keep();
    }
    ASSERT_EQ(keeper->State().Failure, "");
    ASSERT_LT(steps, 200) << "it begins anew each time";
  }
  EXPECT_GE(steps, 7);
  EXPECT_EQ(InCopy("PRAGMA integrity_check"), "ok");
  EXPECT_EQ(InCopy("SELECT InputsHash FROM Games"), Query("SELECT InputsHash FROM Games"));
}

TEST_F(ArchivesWeeklyCopy, BeginsAnewWhenAnotherProgramChangesTheArchive) {
  Pull();
  Fill();
  EXPECT_TRUE(keeper->CopyAPart());
  EXPECT_TRUE(keeper->CopyAPart());
  ExecuteSql(ArchivePath(), "UPDATE Games SET Mission = 'late'");
  EXPECT_GE(CopyWhole(), 7);
  EXPECT_EQ(InCopy("SELECT Mission FROM Games"), "late");
  EXPECT_EQ(InCopy("PRAGMA integrity_check"), "ok");
}

TEST_F(ArchivesWeeklyCopy, BeginsAnewWhenWhatIsDoneOfItWasDeleted) {
  Pull();
  Fill();
  EXPECT_TRUE(keeper->CopyAPart());
  DeleteUnfinishedArchiveCopies(disk, venue.Folder.Path());
  int more = 0;
  while (Files().empty() && more < 100) {
    keeper->CopyAPart();
    ++more;
  }
  CopyWhole();
  EXPECT_EQ(InCopy("PRAGMA integrity_check"), "ok");
}

TEST_F(ArchivesWeeklyCopy, LeavesNothingHalfBehindWhenTheProgramEnds) {
  Pull();
  Fill();
  EXPECT_TRUE(keeper->CopyAPart());
  EXPECT_TRUE(std::filesystem::exists(PartPath()));
  keeper->End();
  EXPECT_THAT(Files(), IsEmpty());
  EXPECT_FALSE(keeper->CopyAPart());
}

TEST_F(ArchivesWeeklyCopy, TakesThePlaceOfWhatACrashLeft) {
  Pull();
  std::filesystem::create_directory(venue.Folder / "backups");
  WriteFile(PartPath(), std::string(100'000, 'x'));
  CopyWhole();
  EXPECT_THAT(Files(), ElementsAre("games-2026-11-01-100000-weekly.mdb"));
  EXPECT_EQ(InCopy("PRAGMA integrity_check"), "ok");
}

TEST_F(ArchivesWeeklyCopy, IsGivenUpForAnArchiveThatWasReplaced) {
  Pull();
  Fill();
  EXPECT_TRUE(keeper->CopyAPart());
  WriteFile(venue.Folder / "other.mdb", MadeDatabase("games"));
  std::filesystem::rename(venue.Folder / "other.mdb", ArchivePath());
  CopyWhole();
  EXPECT_EQ(InCopy("SELECT count(*) FROM sqlar"), "0");
}

TEST_F(ArchivesWeeklyCopy, LeavesRoomOnTheDiskAndTellsIt) {
  Pull();
  const std::uint64_t size = std::filesystem::file_size(ArchivePath());
  disk.Space = WeeklyCopy::RoomForOthers + size - 1;
  EXPECT_FALSE(keeper->CopyAPart());
  EXPECT_THAT(keeper->State().CopyFailure, HasSubstr("Delete what you no longer need"));
  EXPECT_THAT(Files(), IsEmpty());
  disk.Space = WeeklyCopy::RoomForOthers + size;
  CopyWhole();
  EXPECT_EQ(Files().size(), 1U);
}

TEST_F(ArchivesWeeklyCopy, OfADamagedArchiveLeavesTheOlderOnesAndTellsIt) {
  Pull();
  Fill();
  for (const char* time : {"2026-11-01 10:00:00", "2026-11-08 10:00:00"}) {
    At(time);
    CopyWhole();
  }
  const std::vector<std::string> older = Files();
  ASSERT_EQ(older.size(), 2U);
  const std::string sound = ReadFile(ArchivePath());
  std::string damaged = sound;
  damaged.replace(sound.size() / 2 / 4096 * 4096, 4096, std::string(4096, '\xEE'));
  WriteFile(ArchivePath(), damaged);
  Start();
  At("2026-11-16 10:00:00");
  while (keeper->CopyAPart()) {
  }
  EXPECT_EQ(keeper->State().CopyFailure, venue.Strings.Text(OwnText::WeeklyCopyDamaged));
  EXPECT_EQ(Files(), older);
  WriteFile(ArchivePath(), sound);
  Start();
  CopyWhole();
  EXPECT_THAT(Files(),
              ElementsAre("games-2026-11-08-100000-weekly.mdb", "games-2026-11-16-100000-weekly.mdb"));
}

TEST_F(ArchivesWeeklyCopy, ThatCannotBeWrittenStopsNoKeeping) {
  Pull();
  std::filesystem::create_directory(venue.Folder / "backups");
  {
    const OrdinaryUser user;
    EXPECT_FALSE(keeper->CopyAPart());
  }
  EXPECT_NE(keeper->State().CopyFailure, "");
  EXPECT_EQ(keeper->State().Failure, "");
  session.Game().Players(Red0).BonusPoints = 7;
  keeper->Keep();
  EXPECT_EQ(keeper->State().Failure, "");
  CopyWhole();
  EXPECT_EQ(Files().size(), 1U);
}

}  // namespace
