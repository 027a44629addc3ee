#include <gmock/gmock.h>

#include <memory>

#include "tests/archive/Forgetting.h"
#include "tests/archive/KeeperVenue.h"

namespace {

using testing::HasSubstr;

/// A game file that comes onto the board, of a game that the archive may have.
class LoadedGame : public KeeperVenue {
 protected:
  static constexpr const char* Button = "AB00000000000002";

  std::string Saved() const { return WriteGameFile(session.Game(), session.Missions().Text()); }

  void ChangeBonus() {
    session.Game().Players(Red0).BonusPoints = 50;
    session.CalculateScores();
    keeper->Keep();
  }

  /// The file on the board is the archive's only game, of which nothing has changed.
  void ExpectKnown(const std::string& archiveBefore) const {
    EXPECT_EQ(ReadFile(ArchivePath()), archiveBefore);
    EXPECT_EQ(keeper->State().KeptAt, "14:30");
    EXPECT_EQ(keeper->State().Failure, "");
  }

  /// What the operator changes then goes on with that game, of which what was there stays.
  void ExpectThatItGoesOn() {
    const std::string states = Query("SELECT count(*) FROM GameFiles");
    const std::string hash = Query("SELECT InputsHash FROM Games");
    ChangeBonus();
    EXPECT_EQ(Games(), "1");
    EXPECT_EQ(Query("SELECT count(*) - 1 FROM GameFiles"), states);
    EXPECT_EQ(Query("SELECT count(*) FROM GameFiles WHERE State > 0 AND InputsHash = '" + hash + "'"), "1");
    EXPECT_EQ(Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 1"),
              std::to_string(session.Game().Players(Red0).Soldiering));
  }

  void AddMission() {
    ExecuteSql(venue.ScenariosFile(), "INSERT INTO Table1 (MissionName) VALUES ('Flag')");
    session.Reopen();
    session.SelectMission(2);
  }
  void ChangeMissions(const std::string& sql) {
    session.SelectMission(0);
    ExecuteSql(venue.ScenariosFile(), sql);
    session.Reopen();
  }

  /// Red 0 is member 7 in the archive and in the file that is returned.
  std::string PullWithMember() {
    Pull();
    session.Game().Players(Red0).MemberIndex = 7;
    session.Game().Players(Red0).DallasID = "AB00000000000001";
    session.CalculateScores();
    keeper->Keep();
    std::string file = Saved();
    session.ClearPlayerData();
    return file;
  }
};

TEST_F(LoadedGame, IsTheSameThoughAGuestsButtonHasAnOwnerByNow) {
  Pull();
  session.Game().Players(Blue7).DallasID = Button;
  keeper->Keep();
  const std::string file = Saved();
  session.ClearPlayerData();
  ExecuteSql(venue.MembersFile(),
             "INSERT INTO Members (ContactID, DallasID, NickName) VALUES (8, 'AB00000000000002', 'Owl')");
  session.Reopen();
  const std::string before = ReadFile(ArchivePath());
  Load(file);
  EXPECT_EQ(session.Game().Players(Blue7).MemberIndex, 8);
  ExpectKnown(before);
  ExpectThatItGoesOn();
}

TEST_F(LoadedGame, IsTheSameThoughItsMissionIsGone) {
  AddMission();
  Pull();
  const std::string file = Saved();
  session.ClearPlayerData();
  ChangeMissions("DELETE FROM Table1");
  const std::string before = ReadFile(ArchivePath());
  Load(file);
  EXPECT_EQ(session.Missions().Text(), "None");
  ExpectKnown(before);
  ExpectThatItGoesOn();
}

TEST_F(LoadedGame, IsTheSameThoughItsMissionHasAnotherName) {
  AddMission();
  Pull();
  const std::string file = Saved();
  session.ClearPlayerData();
  ChangeMissions("UPDATE Table1 SET MissionName = 'Capture' WHERE MissionName = 'Flag'");
  const std::string before = ReadFile(ArchivePath());
  Load(file);
  ExpectKnown(before);
  ExpectThatItGoesOn();
}

TEST_F(LoadedGame, IsTheSameThoughAMemberWasCutFromIt) {
  const std::string file = PullWithMember();
  ExecuteSql(venue.MembersFile(),
             "UPDATE Members SET DallasID = 'CD00000000000002', NickName = 'Owl', FirstName = 'Ann'");
  CheckMembers();
  EXPECT_EQ(keeper->State().CutGames, 1);
  const std::string before = ReadFile(ArchivePath());
  Load(file);
  ExpectKnown(before);
  ExpectThatItGoesOn();
}

TEST_F(LoadedGame, IsTheSameThoughAMemberWasForgotten) {
  const std::string file = PullWithMember();
  {
    const std::unique_ptr<Database> archive = venue.Databases.OpenDatabase(ArchivePath());
    EXPECT_EQ(ForgetIn(*archive, session.DbMembers(), venue.Strings, 7), 1);
  }
  const std::string before = ReadFile(ArchivePath());
  Load(file);
  ExpectKnown(before);
  ExpectThatItGoesOn();
}

TEST_F(LoadedGame, IsTheSameThoughItWasCommittedAfterItWasSaved) {
  const std::string file = PullWithMember();
  Load(file);
  session.Game().Players(Red0).Committed = true;
  keeper->Keep();
  EXPECT_EQ(Query("SELECT Committed FROM Games"), "1");
  session.ClearPlayerData();
  const std::string before = ReadFile(ArchivePath());
  Load(file);
  ExpectKnown(before);
  ExpectThatItGoesOn();
}

TEST_F(LoadedGame, IsTheSameThoughTheOperatorChangedItAfterItWasSaved) {
  Pull();
  const std::string file = Saved();
  session.SaveGame([](const Game& /*game*/, const std::string& /*mission*/) { return true; });
  session.Game().Players(Red0).Committed = true;
  keeper->Keep();
  EXPECT_EQ(Query("SELECT count(*) FROM GameFiles"), "1") << "a commit makes no other game of it";
  ChangeBonus();
  EXPECT_EQ(Query("SELECT count(*) FROM GameFiles"), "2");
  session.Game().Players(Red0).BonusPoints = 60;
  keeper->Keep();
  EXPECT_EQ(Query("SELECT count(*) FROM GameFiles"), "2") << "no file has the former bonus";
  session.ClearPlayerData();
  const std::string before = ReadFile(ArchivePath());
  Load(file);
  ExpectKnown(before);
}

TEST_F(LoadedGame, IsTheSameThoughItWasChangedAfterItWasLoadedBefore) {
  Game game(venue.Strings);
  game.Players(Red0).Active = true;
  game.GameDate = "21/05/2013 14:30";
  const std::string file = WriteGameFile(game, "None");
  Load(file);
  ChangeBonus();
  session.ClearPlayerData();
  const std::string before = ReadFile(ArchivePath());
  Load(file);
  ExpectKnown(before);
  EXPECT_EQ(Games(), "1");
}

TEST_F(LoadedGame, IsTheSameThoughAMemberWasCutFromItAndItsFactorsAreOthers) {
  const std::string file = PullWithMember();
  ExecuteSql(venue.MembersFile(),
             "UPDATE Members SET DallasID = 'CD00000000000002', NickName = 'Owl', FirstName = 'Ann'");
  CheckMembers();
  ExecuteSql(ArchivePath(), "UPDATE Games SET RedTotal = 4711, BlueTotal = 4711");
  const std::string before = ReadFile(ArchivePath());
  Load(file);
  ExpectKnown(before);
}

TEST_F(LoadedGame, IsTheSameThoughAMemberWasCutFromAnEarlierStateOfIt) {
  const std::string file = PullWithMember();
  Load(file);
  Pull();
  EXPECT_EQ(Query("SELECT max(State) FROM GameFiles"), "1");
  session.ClearPlayerData();
  ExecuteSql(venue.MembersFile(),
             "UPDATE Members SET DallasID = 'CD00000000000002', NickName = 'Owl', FirstName = 'Ann'");
  CheckMembers();
  const std::string before = ReadFile(ArchivePath());
  Load(file);
  ExpectKnown(before);
  ExpectThatItGoesOn();
}

TEST_F(LoadedGame, IsTheSameThoughTheArchiveIsLockedWhileItIsLoaded) {
  Pull();
  session.Game().Players(Blue7).DallasID = Button;
  keeper->Keep();
  const std::string file = Saved();
  session.ClearPlayerData();
  ExecuteSql(venue.MembersFile(),
             "INSERT INTO Members (ContactID, DallasID, NickName) VALUES (8, 'AB00000000000002', 'Owl')");
  session.Reopen();
  OtherConnection other(ArchivePath());
  other.Execute("BEGIN EXCLUSIVE");
  Load(file);
  EXPECT_THAT(keeper->State().Failure, HasSubstr(ArchivePath()));
  EXPECT_EQ(keeper->State().KeptAt, "");
  ChangeBonus();
  other.Execute("ROLLBACK");
  keeper->Keep();
  EXPECT_EQ(keeper->State().Failure, "");
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(Query("SELECT count(*) FROM GameFiles"), "2");
  EXPECT_EQ(Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 1"),
            std::to_string(session.Game().Players(Red0).Soldiering));
}

TEST_F(LoadedGame, IsTheSameWhenItsFileIsLoadedAgainThoughItsMissionWasGoneAtTheFirstTime) {
  Game game(venue.Strings);
  game.Players(Red0).Active = true;
  game.Players(Red0).DallasID = "AB00000000000001";
  game.GameDate = "some day";
  const std::string file = WriteGameFile(game, "Long Gone");
  Load(file, "2012-01-02 03:04:05");
  EXPECT_EQ(Query("SELECT Mission FROM Games"), "None");
  session.ClearPlayerData();
  const std::string before = ReadFile(ArchivePath());
  Load(file, "2012-01-03 03:04:05");
  ExpectKnown(before);
}

TEST_F(LoadedGame, IsAnotherOneWithOtherFiguresOfAGun) {
  const std::string file = PullWithMember();
  Load(file);
  ++session.Game().Players(Blue7).DeathCount;
  const std::string other = Saved();
  session.Game().Players(Blue7).DeathCount = 0;
  session.ClearPlayerData();
  EXPECT_EQ(Games(), "1");
  Load(other);
  EXPECT_EQ(Games(), "2");
}

TEST_F(LoadedGame, IsKeptOnceMoreIfItIsNotInTheArchiveThoughItsScoresCannotBeCalculated) {
  Game game(venue.Strings);
  game.Players(Red0).Active = true;
  game.Players(Red0).MemberIndex = 7;
  game.GameDate = "21/05/2013 14:30";
  const std::string file = WriteGameFile(game, "None");
  {
    OtherConnection other(venue.MembersFile());
    other.Execute("BEGIN EXCLUSIVE");
    EXPECT_THROW(Load(file), RuntimeError);
    other.Execute("ROLLBACK");
  }
  keeper->Keep();
  EXPECT_EQ(Games(), "1");
  ChangeBonus();
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 1"),
            std::to_string(session.Game().Players(Red0).Soldiering));
}

TEST_F(LoadedGame, IsFiledUnderTheDateInItWhateverItsForm) {
  venue.Time.DateAndTime = "2026-11-21 20:15:00";
  int shots = 0;
  for (const auto& [date, played] :
       {std::pair("25.11.2012 20:15", "2012-11-25 20:15:00"), std::pair("2012-11-26", "2012-11-26 00:00:00"),
        std::pair("11/27/2012 8:15 PM", "2012-11-27 20:15:00"),
        std::pair("09.11.2012 20:15", "2012-11-09 20:15:00"), std::pair("some day", "2012-11-09 23:59:58")}) {
    Game game(venue.Strings);
    game.Players(Red0).Active = true;
    game.Players(Red0).ShotCount = ++shots;
    game.GameDate = date;
    Load(WriteGameFile(game, "None"), "2012-11-09 23:59:58");
    EXPECT_EQ(Query("SELECT Played FROM Games WHERE GameID = " + std::to_string(shots)), played) << date;
  }
}

}  // namespace
