#include "archive/GameKeeper.h"

#include <gmock/gmock.h>

#include "tests/archive/KeeperVenue.h"

namespace {

using testing::HasSubstr;

using Keeper = KeeperVenue;

TEST_F(Keeper, MakesNoArchiveWithoutAGame) {
  keeper->Keep();
  keeper->CheckMembers();
  keeper->NoteMembers();
  session.ClearPlayerData();
  EXPECT_FALSE(ArchiveExists());
  EXPECT_EQ(keeper->State(), KeptState());
}

TEST_F(Keeper, KeepsAPulledGameWithItsFigures) {
  Pull();
  EXPECT_EQ(Query("SELECT Played || '|' || Source || '|' || Pulls || '|' || BestPlayer FROM Games"),
            "2013-05-21 14:30:05|cable|1|40");
  EXPECT_EQ(Query("SELECT DamageDealt FROM GamePlayers WHERE PlayerIndex = 40"), "100");
  EXPECT_EQ(FileNames(), "2013-05-21/1430-000001.game.xml");
  EXPECT_EQ(keeper->State().KeptAt, "14:30");
  EXPECT_EQ(keeper->State().Failure, "");
}

TEST_F(Keeper, WritesNothingWhileNothingChanges) {
  Pull();
  const auto before = ReadFile(ArchivePath());
  venue.Time.Time = "14:31";
  session.CalculateScores();
  session.SortByHeader(3);
  keeper->Keep();
  EXPECT_EQ(ReadFile(ArchivePath()), before);
  EXPECT_EQ(keeper->State().KeptAt, "14:30");
}

TEST_F(Keeper, KeepsAChangeOfTheOperatorsAsTheSameGame) {
  Pull();
  venue.Time.Time = "14:31";
  session.Game().Players(Red0).BonusPoints = 50;
  session.CalculateScores();
  keeper->Keep();
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 1"),
            std::to_string(session.Game().Players(Red0).Soldiering));
  EXPECT_EQ(FileNames(), "2013-05-21/1430-000001.game.xml");
  EXPECT_EQ(keeper->State().KeptAt, "14:31");
}

TEST_F(Keeper, KeepsEachInputThatChanges) {
  Pull();
  Game& game = session.Game();
  const std::vector<std::function<void()>> changes = {
      [&] { game.Players(Red0).MemberIndex = 7; }, [&] { game.Players(Red0).Committed = true; },
      [&] { game.Players(Red0).BonusPoints = 1; }, [&] { game.ObjectiveTeams(1).PrimaryAchieved = true; },
      [&] { game.ObjectiveTeams(1).Name = "Blue"; }};
  for (std::size_t i = 0; i < changes.size(); ++i) {
    const std::string before = Query("SELECT InputsHash FROM Games");
    changes[i]();
    keeper->Keep();
    EXPECT_NE(Query("SELECT InputsHash FROM Games"), before) << i;
    EXPECT_EQ(Games(), "1");
  }
}

TEST_F(Keeper, KeepsOtherFactorsForAPulledGame) {
  Pull();
  session.Factors().Damage *= 3;
  session.CalculateScores();
  keeper->Keep();
  EXPECT_EQ(Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 40"),
            std::to_string(session.Game().Players(Blue7).Soldiering));
  EXPECT_EQ(Query("SELECT DamageFactor FROM Games"),
            Query("SELECT " + std::to_string(session.Factors().Damage)));
}

TEST_F(Keeper, LeavesTheFiguresOfAnOldGameUntilAnInputChanges) {
  Pull();
  const std::string file = WriteGameFile(session.Game(), session.Missions().Text());
  const std::string soldiering = Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 40");
  session.ClearPlayerData();
  session.Factors().Damage *= 3;
  Load(file);
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 40"), soldiering);
  EXPECT_NE(keeper->State().KeptAt, "");
  session.Game().Players(Red0).BonusPoints = 5;
  session.CalculateScores();
  keeper->Keep();
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(Query("SELECT Soldiering FROM GamePlayers WHERE PlayerIndex = 40"),
            std::to_string(session.Game().Players(Blue7).Soldiering));
}

TEST_F(Keeper, KeepsALoadedGameThatItDoesNotHaveUnderItsOwnDate) {
  venue.Time.DateAndTime = "2026-11-21 20:15:00";
  Game game(venue.Strings);
  game.Players(Red0).Active = true;
  game.GameDate = "21/05/2013 14:30";
  Load(WriteGameFile(game, "None"));
  EXPECT_EQ(Query("SELECT Played || '|' || Source FROM Games"), "2013-05-21 14:30:00|file");
}

TEST_F(Keeper, FilesALoadedGameWithoutADateUnderTheTimeOfItsLoad) {
  venue.Time.DateAndTime = "2026-11-21 20:15:00";
  Game game(venue.Strings);
  game.Players(Red0).Active = true;
  game.GameDate = "last week";
  Load(WriteGameFile(game, "None"));
  EXPECT_EQ(Query("SELECT Played FROM Games"), "2026-11-21 20:15:00");
}

TEST_F(Keeper, KeepsTheStateBeforeASecondPullAsAFurtherFile) {
  Pull();
  Pull();
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(Query("SELECT Pulls FROM Games"), "2");
  EXPECT_EQ(Query("SELECT DamageDealt FROM GamePlayers WHERE PlayerIndex = 40"), "200");
  EXPECT_EQ(FileNames(), "2013-05-21/1430-000001-1.game.xml 2013-05-21/1430-000001.game.xml");
}

TEST_F(Keeper, KeepsNoFurtherFileAfterAPullThatBroughtNothing) {
  Pull();
  keeper->BeginPull(GameSource::Cable);
  keeper->Keep();
  session.Game().Players(Red0).BonusPoints = 5;
  keeper->Keep();
  EXPECT_EQ(FileNames(), "2013-05-21/1430-000001.game.xml");
  EXPECT_EQ(Query("SELECT Pulls FROM Games"), "1");
}

TEST_F(Keeper, FindsALoadedGameAfterAPullThatBroughtNothing) {
  Pull();
  const std::string file = WriteGameFile(session.Game(), session.Missions().Text());
  session.ClearPlayerData();
  keeper->BeginPull(GameSource::Cable);
  keeper->Keep();
  Load(file);
  EXPECT_EQ(Games(), "1");
  session.Factors().Damage = 99;
  session.CalculateScores();
  keeper->Keep();
  EXPECT_EQ(Query("SELECT DamageDealt FROM GamePlayers WHERE PlayerIndex = 40"), "100");
}

TEST_F(Keeper, KeepsGunsThatComeOneByOneAsOneState) {
  keeper->BeginPull(GameSource::Radio);
  venue.Play(Red0, 0).ShotCount = 3;
  keeper->Keep();
  venue.Play(Blue7, 0).ShotCount = 4;
  keeper->Keep();
  EXPECT_EQ(Query("SELECT Source || '|' || Players || '|' || Pulls FROM Games"), "radio|2|1");
  EXPECT_EQ(FileNames(), "2013-05-21/1430-000001.game.xml");
}

TEST_F(Keeper, KeepsTheStateBeforeAGunIsAddedUp) {
  keeper->BeginPull(GameSource::Radio);
  venue.Play(Red0, 0).ShotCount = 3;
  keeper->Keep();
  session.Game().Players(Red0).ShotCount += 3;
  keeper->Keep();
  EXPECT_EQ(FileNames(), "2013-05-21/1430-000001-1.game.xml 2013-05-21/1430-000001.game.xml");
}

TEST_F(Keeper, KeepsWhatCameInBeforeItIsClearedInTheMiddleOfAPull) {
  keeper->BeginPull(GameSource::Cable);
  Read();
  session.ClearPlayerData();
  EXPECT_EQ(Query("SELECT DamageDealt FROM GamePlayers WHERE PlayerIndex = 40"), "100");
  EXPECT_EQ(keeper->State().KeptAt, "") << "there is no game now";
  // The other guns are a game of their own.
  venue.Play(Red0, 0).ShotCount = 3;
  session.CalculateScores();
  keeper->Keep();
  EXPECT_EQ(Games(), "2");
}

TEST_F(Keeper, ShowsNoBoxForAMemberWhoIsGoneInTheMiddleOfAPull) {
  keeper->BeginPull(GameSource::Cable);
  Read();
  session.Game().Players(Red0).MemberIndex = 99;
  keeper->Keep();
  EXPECT_TRUE(venue.Boxes.Boxes.empty());
  EXPECT_EQ(Games(), "1");
  EXPECT_TRUE(session.List(BoardList::Players).RowCount() == 0) << "the board waits for the end of the pull";
}

TEST_F(Keeper, KeepsAGameWhoseScoresCannotBeCalculated) {
  keeper->BeginPull(GameSource::Cable);
  Read();
  session.Game().Players(Red0).BonusPoints = 2147483647;
  session.Game().Players(Red0).HitByPlayer(Blue7) = 2147483647;
  session.Factors().Damage = 1000;
  keeper->Keep();
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(keeper->State().Failure, "");
}

TEST_F(Keeper, KeepsTheGameBeforeALoadReplacesIt) {
  Pull();
  session.Game().Players(Red0).BonusPoints = 5;
  Game other(venue.Strings);
  other.Players(Blue7).Active = true;
  Load(WriteGameFile(other, "None"));
  EXPECT_EQ(Games(), "2");
  EXPECT_EQ(Query("SELECT Players FROM Games WHERE GameID = 2"), "1");
}

TEST_F(Keeper, TellsWhyAGameIsNotKeptAndTriesAgain) {
  disk.Space = GameKeeper::LeastFreeSpace - 1;
  Pull();
  EXPECT_THAT(keeper->State().Failure, HasSubstr("32 MB"));
  EXPECT_EQ(keeper->State().KeptAt, "");
  EXPECT_FALSE(ArchiveExists());
  disk.Space = GameKeeper::LeastFreeSpace;
  keeper->Keep();
  EXPECT_EQ(keeper->State().Failure, "");
  EXPECT_EQ(keeper->State().KeptAt, "14:30");
  EXPECT_TRUE(venue.Boxes.Boxes.empty());
}

TEST_F(Keeper, TellsThatTheArchiveIsLockedAndKeepsTheGameLater) {
  Pull();
  {
    OtherConnection other(ArchivePath());
    other.Execute("BEGIN EXCLUSIVE");
    session.Game().Players(Red0).BonusPoints = 5;
    keeper->Keep();
    EXPECT_THAT(keeper->State().Failure, HasSubstr("games.mdb"));
    other.Execute("ROLLBACK");
  }
  keeper->Keep();
  EXPECT_EQ(keeper->State().Failure, "");
}

TEST_F(Keeper, LeavesADamagedArchiveAsItIsAndBeginsAnotherOne) {
  const std::string garbage(5000, 'x');
  WriteFile(ArchivePath(), garbage);
  Pull();
  EXPECT_EQ(ReadFile(ArchivePath()), garbage);
  EXPECT_EQ(keeper->State().Unusable, ArchivePath());
  EXPECT_EQ(OtherConnection(venue.Folder / "games-new.mdb").Query("SELECT count(*) FROM Games"), "1");
}

TEST_F(Keeper, CutsANumberThatBelongsToSomebodyElseNow) {
  Pull();
  session.Game().Players(Red0).MemberIndex = 7;
  keeper->Keep();
  keeper->End();
  ExecuteSql(venue.MembersFile(),
             "UPDATE Members SET DallasID = 'CD00000000000002', NickName = 'Owl', FirstName = 'Ann'");
  Start();
  CheckMembers();
  EXPECT_EQ(keeper->State().CutGames, 1);
  EXPECT_EQ(Query("SELECT MemberID FROM GamePlayers WHERE PlayerIndex = 1"), "0");
}

TEST_F(Keeper, ChecksTheMembersLaterIfTheArchiveIsLocked) {
  Pull();
  session.Game().Players(Red0).MemberIndex = 7;
  keeper->Keep();
  ExecuteSql(venue.MembersFile(), "UPDATE Members SET DallasID = NULL, FirstName = 'Di'");
  session.ClearPlayerData();
  Start();
  {
    OtherConnection other(ArchivePath());
    other.Execute("BEGIN EXCLUSIVE");
    keeper->CheckMembers();
    EXPECT_NE(keeper->State().Failure, "");
    other.Execute("ROLLBACK");
  }
  keeper->NoteMembers();
  while (keeper->CutAPart()) {
  }
  EXPECT_EQ(keeper->State().CutGames, 1);
  EXPECT_EQ(Query("SELECT MemberID FROM GamePlayers WHERE PlayerIndex = 1"), "0");
}

TEST_F(Keeper, KnowsAMemberWhoGotAnotherButtonAndThenAnotherName) {
  Pull();
  session.Game().Players(Red0).MemberIndex = 7;
  keeper->Keep();
  for (const char* change : {"DallasID = 'CD00000000000002'", "FirstName = 'Ann'"}) {
    ExecuteSql(venue.MembersFile(), std::string("UPDATE Members SET ") + change);
    keeper->NoteMembers();
  }
  CheckMembers();
  EXPECT_EQ(keeper->State().CutGames, 0);
  EXPECT_EQ(Query("SELECT MemberID FROM GamePlayers WHERE PlayerIndex = 1"), "7");
}

TEST_F(Keeper, KeepsNothingAfterItsEnd) {
  keeper->End();
  Pull();
  session.ClearPlayerData();
  EXPECT_FALSE(ArchiveExists());
}

}  // namespace
