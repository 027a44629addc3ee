#include <gmock/gmock.h>

#include <functional>
#include <memory>
#include <vector>

#include "archive/DeletedGames.h"
#include "tests/archive/KeeperVenue.h"

namespace {

using Keeper = KeeperVenue;

class Reopening : public Keeper {
 protected:
  /// Loads a past game as the window of past games does.
  void Open(std::int64_t gameId, std::int64_t state = 0) {
    const std::unique_ptr<Database> file = venue.Databases.OpenDatabase(ArchivePath());
    const std::string bytes = GameArchive(*file, session.DbMembers(), venue.Strings).FileOf(gameId, state);
    session.LoadGame([&](Game& game, const Session::MissionChoice& choose) {
      std::string mission;
      const bool done = ReadGameFile(bytes, game, [&](const std::string& name) {
        mission = name;
        choose(name);
      });
      keeper->Open(gameId, state, game, mission);
      return done;
    });
    keeper->Keep();
  }
  void ChangeBonus(int points) {
    session.Game().Players(Red0).BonusPoints = points;
    session.CalculateScores();
    keeper->Keep();
  }
  std::string FileHolds(int state, const std::string& text) const {
    const std::unique_ptr<Database> file = SqliteEngine().OpenDatabase(ArchivePath());
    const std::string bytes = GameArchive(*file, session.DbMembers(), venue.Strings).FileOf(1, state);
    return bytes.find(text) != std::string::npos ? text : "not " + text;
  }
};

TEST_F(Reopening, KeepsTheGameAsTheOneThatItIs) {
  Pull();
  session.ClearPlayerData();
  session.Factors().Damage = 99;
  const std::string before = ReadFile(ArchivePath());
  venue.Time.Time = "18:00";
  Open(1);
  EXPECT_EQ(ReadFile(ArchivePath()), before);
  EXPECT_EQ(keeper->State().KeptAt, "18:00");
  ChangeBonus(50);
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(FileNames(), "2013-05-21/1430-000001.game.xml");
  EXPECT_EQ(FileHolds(0, "<BonusPoints> 50<"), "<BonusPoints> 50<");
}

TEST_F(Reopening, KeepsWhatTheGameWasPulledBefore) {
  Pull();
  Pull();
  EXPECT_EQ(Query("SELECT Pulls FROM Games"), "2");
  session.ClearPlayerData();
  Open(1);
  ChangeBonus(50);
  EXPECT_EQ(Query("SELECT Pulls FROM Games"), "2");
  Pull();
  EXPECT_EQ(Query("SELECT Pulls FROM Games"), "3");
  EXPECT_EQ(Games(), "1");
}

TEST_F(Reopening, OfAnEarlierStateDoesNotReplaceTheLastOne) {
  Pull();
  Pull();
  EXPECT_EQ(FileNames(), "2013-05-21/1430-000001-1.game.xml 2013-05-21/1430-000001.game.xml");
  session.ClearPlayerData();
  Open(1, 1);
  EXPECT_EQ(FileNames(), "2013-05-21/1430-000001-1.game.xml 2013-05-21/1430-000001.game.xml");
  ChangeBonus(50);
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(FileHolds(0, "<BonusPoints> 50<"), "<BonusPoints> 50<");
  EXPECT_EQ(FileHolds(1, "<ShotCount> 8<"), "<ShotCount> 8<");
  EXPECT_EQ(FileHolds(2, "<ShotCount> 16<"), "<ShotCount> 16<");
  ChangeBonus(60);  // from now on the last state is the one on the board
  EXPECT_EQ(Query("SELECT count(*) FROM sqlar"), "3");
}

TEST_F(Reopening, OfAFileOfAnEarlierStateDoesNotReplaceTheLastOneEither) {
  Pull();
  const std::string bytes = WriteGameFile(session.Game(), session.Missions().Text());
  Pull();
  session.ClearPlayerData();
  Load(bytes);
  EXPECT_EQ(Games(), "1");
  ChangeBonus(50);
  EXPECT_EQ(Query("SELECT count(*) FROM sqlar"), "3");
  EXPECT_EQ(FileHolds(2, "<ShotCount> 16<"), "<ShotCount> 16<");
}

TEST_F(Reopening, KeepsTheFormerStateWhereLoadingAloneMadeAnotherOfIt) {
  Pull();
  session.ClearPlayerData();
  ExecuteSql(venue.ScenariosFile(), "INSERT INTO Table1 (MissionName) VALUES ('Flag')");
  session.Reopen();
  session.SelectMission(2);
  Pull();  // of the mission that is about to go
  session.ClearPlayerData();
  session.SelectMission(0);
  ExecuteSql(venue.ScenariosFile(), "DELETE FROM Table1");
  session.Reopen();
  Open(2);
  EXPECT_EQ(session.Missions().Text(), "None");
  EXPECT_EQ(Query("SELECT Mission FROM Games WHERE GameID = 2"), "Flag");
  ChangeBonus(50);
  EXPECT_EQ(Games(), "2");
  EXPECT_EQ(Query("SELECT count(*) FROM GameFiles WHERE GameID = 2"), "2");
}

TEST_F(Reopening, KeepsAChangeThoughTheMembersWereLockedWhileItWasOpened) {
  Pull();
  session.Game().Players(Blue7).MemberIndex = 7;
  keeper->Keep();
  session.ClearPlayerData();
  {
    OtherConnection other(venue.MembersFile());
    other.Execute("BEGIN EXCLUSIVE");
    EXPECT_THROW(Open(1), RuntimeError);
    keeper->Keep();  // as at the end of each command
    other.Execute("ROLLBACK");
  }
  EXPECT_EQ(keeper->State().KeptAt, "14:30");
  ChangeBonus(50);
  EXPECT_EQ(FileHolds(0, "<BonusPoints> 50<"), "<BonusPoints> 50<");
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 1"),
            std::to_string(session.Game().Players(Red0).Soldiering));
}

TEST_F(Reopening, KeepsAChangeThoughTheMissionsWereLockedWhileItWasOpened) {
  ExecuteSql(venue.ScenariosFile(), "INSERT INTO Table1 (MissionName) VALUES ('Flag')");
  session.Reopen();
  session.SelectMission(2);
  Pull();
  session.ClearPlayerData();
  {
    OtherConnection other(venue.ScenariosFile());
    other.Execute("BEGIN EXCLUSIVE");
    EXPECT_THROW(Open(1), RuntimeError);
    keeper->Keep();
    other.Execute("ROLLBACK");
  }
  EXPECT_FALSE(session.Game().DataPresent) << "its mission was not found, so that nothing was read";
  EXPECT_EQ(keeper->State().KeptAt, "");
  Open(1);
  ChangeBonus(50);
  EXPECT_EQ(FileHolds(0, "<BonusPoints> 50<"), "<BonusPoints> 50<");
}

TEST_F(Reopening, GoesOnInAPullOntoTheGame) {
  Pull();
  session.ClearPlayerData();
  Open(1);
  Pull();
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(FileNames(), "2013-05-21/1430-000001-1.game.xml 2013-05-21/1430-000001.game.xml");
}

TEST_F(Reopening, EndsWithTheNextGame) {
  Pull();
  session.ClearPlayerData();
  Open(1);
  session.ClearPlayerData();
  Pull();
  venue.Play(Red0, 0).ShotCount += 100;
  Pull();
  EXPECT_EQ(Games(), "2");
}

TEST_F(Keeper, KeepsAGameAnewThatWasDeletedWhileItIsOnTheBoard) {
  Pull();
  OtherConnection(ArchivePath()).Execute("UPDATE Games SET Deleted = '2013-05-21 14:31:00'");
  session.ClearPlayerData();
  EXPECT_EQ(Games(), "1");
  Pull();
  OtherConnection(ArchivePath()).Execute("UPDATE Games SET Deleted = '2013-05-21 14:32:00'");
  session.Game().Players(Red0).BonusPoints = 50;
  session.CalculateScores();
  keeper->Keep();
  EXPECT_EQ(Query("SELECT count(*) FROM Games WHERE Deleted IS NULL"), "1");
  EXPECT_EQ(Query("SELECT count(*) FROM Games"), "3");
}

TEST_F(Keeper, RemovesWhatWasDeletedThirtyDaysAgo) {
  keeper->RemoveDeleted();
  EXPECT_FALSE(ArchiveExists());
  Pull();
  OtherConnection(ArchivePath()).Execute("UPDATE Games SET Deleted = '2013-04-21 14:30:05'");
  keeper->RemoveDeleted();
  EXPECT_EQ(Games(), "1");
  OtherConnection(ArchivePath()).Execute("UPDATE Games SET Deleted = '2013-04-21 14:30:04'");
  keeper->RemoveDeleted();
  EXPECT_EQ(Games(), "0");
  EXPECT_EQ(keeper->State().Failure, "");
}

TEST_F(Keeper, RemovesAndCutsNothingWhileTheDiskIsNarrow) {
  Pull();
  session.Game().Players(Red0).MemberIndex = 7;
  keeper->Keep();
  session.ClearPlayerData();
  OtherConnection(ArchivePath()).Execute("UPDATE Games SET Deleted = '2012-04-21 14:30:05'");
  ExecuteSql(venue.MembersFile(), "UPDATE Members SET FirstName = 'Ann'");
  const std::string before = ReadFile(ArchivePath());
  disk.Space = LeastFreeSpace - 1;
  const std::vector<std::function<void()>> writes = {
      [this] { keeper->RemoveDeleted(); }, [this] { keeper->NoteMembers(); }, [this] { CheckMembers(); }};
  for (const std::function<void()>& write : writes) {
    write();
    EXPECT_EQ(ReadFile(ArchivePath()), before);
    EXPECT_THAT(keeper->State().Failure, testing::HasSubstr("32 MB"));
  }
  disk.Space = LeastFreeSpace;
  CheckMembers();
  EXPECT_NE(ReadFile(ArchivePath()), before);
  keeper->RemoveDeleted();
  EXPECT_EQ(Games(), "0");
  EXPECT_EQ(keeper->State().Failure, "");
}

TEST(TimesOfDeletedGames, GoBackThirtyDays) {
  EXPECT_EQ(LastTimeOfRemoved("2026-12-01 10:20:30"), "2026-11-01 10:20:30");
  EXPECT_EQ(LastTimeOfRemoved("2024-03-01 00:00:00"), "2024-01-31 00:00:00");
  EXPECT_EQ(LastTimeOfRemoved("2026-01-05 23:59:59"), "2025-12-06 23:59:59");
  EXPECT_EQ(LastTimeOfRemoved("tomorrow"), "");
  EXPECT_EQ(LastTimeOfRemoved("2026-13-05 23:59:59"), "");
}

}  // namespace
