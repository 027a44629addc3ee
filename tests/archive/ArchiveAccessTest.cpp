#include "archive/ArchiveAccess.h"

#include <gmock/gmock.h>

#include <filesystem>

#include "core/game/Standings.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/OpenSession.h"
#include "tests/support/RandomGame.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class LookingIn : public testing::Test {
 protected:
  LookingIn() {
    std::filesystem::create_directories(venue.Folder / "program");
    WriteFile(venue.Folder / "program/games_default.mdb", MadeDatabase("games"));
    ExecuteSql(venue.MembersFile(),
               "INSERT INTO Members (ContactID, NickName) VALUES (7, 'Mole'), (8, 'Shrew')");
    EXPECT_TRUE(venue.Open());
  }

  /// The game on the board goes into the archive as the keeper would put it there.
  std::int64_t Keep() {
    const std::unique_ptr<Database> file = venue.Databases.OpenDatabase(ArchivePath());
    return GameArchive(*file, session.DbMembers(), venue.Strings).Keep(State());
  }
  GameState State() {
    return {.Game = session.Game(),
            .Mission = session.Missions().Text(),
            .Played = "2026-11-21 20:15:30",
            .Factors = session.Factors()};
  }
  void Play(unsigned seed) {
    FillRandomly(session.Game(), 40, seed);
    session.Game().DataPresent = true;
    session.Game().GameDate = "21/11/2026 20:15";
    session.CalculateScores();
  }
  std::string ArchivePath() const { return venue.Folder / "games.mdb"; }
  bool ArchiveExists() const { return std::filesystem::exists(ArchivePath()); }

  OpenSession venue;
  Session& session = venue.session;
  ArchiveAccess access{{.Session = session,
                        .Disk = venue.Disk,
                        .Engine = venue.Databases,
                        .Strings = venue.Strings,
                        .UserDataFolder = venue.Folder.Path(),
                        .ProgramFolder = venue.Folder / "program"}};
};

TEST_F(LookingIn, FindsNothingWithoutAnArchiveAndMakesNone) {
  EXPECT_THAT(access.Queries().Months(), IsEmpty());
  EXPECT_THAT(access.Queries().Games({}), IsEmpty());
  EXPECT_EQ(access.Queries().Game(1), std::nullopt);
  EXPECT_EQ(WholeNumber(access.Statements(), "SELECT count(*) FROM Games"), 0);
  EXPECT_EQ(access.Statements().Change("DELETE FROM Games", {}), 0);
  EXPECT_EQ(ThrownBy([&] { access.Statements().Insert("", {}); }).Number, 3000);
  EXPECT_EQ(ThrownBy([&] { access.Read(1); }).Number, 53);
  EXPECT_FALSE(ArchiveExists());
}

TEST_F(LookingIn, MakesAnArchiveToKeepIn) {
  Play(1);
  EXPECT_EQ(access.Archive().Keep(State()), 1);
  EXPECT_THAT(access.Queries().Games({}), ElementsAre(1));
}

TEST_F(LookingIn, SeesWhatIsKeptMeanwhile) {
  Play(1);
  access.Archive();
  EXPECT_THAT(access.Queries().Games({}), IsEmpty());
  Keep();
  EXPECT_THAT(access.Queries().Games({}), ElementsAre(1));
}

TEST_F(LookingIn, GivesAGameWithTheFiguresOfItsTime) {
  session.Factors() = {
      .Damage = 3, .Death = -7, .Heal = 2, .Ammo = 0.5, .Accuracy = 110, .FriendlyFire = -1.5};
  Play(4);
  for (Player& player : session.Game().Players) {
    if (!player.Active) {
      player.Clear();  // what game files do not tell
    }
  }
  session.CalculateScores();
  Player& first = session.Game().Players(session.List(BoardList::Players).RowAt(0).Index);
  first.MemberIndex = 7;
  access.Archive().Keep(State());
  const Game kept = session.Game();
  session.ClearPlayerData();
  session.Factors() = {};

  const PastGame past = access.Read(1);
  EXPECT_EQ(past.GameId, 1);
  EXPECT_EQ(past.State, 0);
  EXPECT_EQ(past.Played, "2026-11-21 20:15:30");
  EXPECT_EQ(past.Mission, "None");
  EXPECT_EQ(past.Factors.FriendlyFire, -1.5);
  EXPECT_EQ(past.Factors.Accuracy, 110);
  EXPECT_EQ(past.Factors.Ammo, 0.5);
  EXPECT_EQ(past.Factors.Heal, 2);
  EXPECT_EQ(past.Factors.Death, -7);
  EXPECT_EQ(past.Factors.Damage, 3);
  EXPECT_TRUE(past.Game.DataPresent);
  EXPECT_EQ(past.Game.GameDate, kept.GameDate);
  for (int team = 1; team <= TeamCount; ++team) {
    EXPECT_EQ(past.Game.TeamTotals(team), kept.TeamTotals(team)) << team;
  }
  for (int index = 1; index <= PlayerCount; ++index) {
    EXPECT_EQ(past.Game.Players(index).AbsoluteDamage, kept.Players(index).AbsoluteDamage) << index;
    EXPECT_EQ(past.Game.Players(index).Rank, kept.Players(index).Active ? kept.Players(index).Rank : 0)
        << index;
  }
  const std::vector<Standing> before = Standings(kept, access.Names());
  const std::vector<Standing> after = Standings(past.Game, access.Names());
  ASSERT_EQ(before.size(), after.size());
  EXPECT_EQ(after.front().PublicName, "Mole");
  for (std::size_t i = 0; i < before.size(); ++i) {
    EXPECT_EQ(before[i].Index, after[i].Index);
    EXPECT_EQ(before[i].Soldiering, after[i].Soldiering);
    EXPECT_EQ(before[i].Accuracy.has_value(), after[i].Accuracy.has_value());
    EXPECT_NEAR(before[i].Accuracy.value_or(0), after[i].Accuracy.value_or(0), 1e-6);
    EXPECT_EQ(before[i].DamageDealt, after[i].DamageDealt);
    EXPECT_EQ(before[i].DamageTaken, after[i].DamageTaken);
  }
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(LookingIn, GivesEarlierStatesWithTheFiguresOfTheirTime) {
  Play(1);
  GameArchive archive = access.Archive();
  archive.Keep(State());
  const std::int32_t former = session.Game().TeamTotals(1);
  session.Game().Players(1).Active = true;
  session.Game().Players(1).BonusPoints += 1000;
  session.CalculateScores();
  archive.KeepAgain(1, State(), FormerState::KeptToo);
  EXPECT_NE(former, session.Game().TeamTotals(1));
  EXPECT_EQ(access.Read(1, 1).Game.TeamTotals(1), former);
  EXPECT_EQ(access.Read(1, 1).State, 1);
  EXPECT_EQ(access.Read(1).Game.TeamTotals(1), session.Game().TeamTotals(1));
  EXPECT_EQ(access.Queries().Game(1)->EarlierStates, 1);
  EXPECT_EQ(ThrownBy([&] { access.Read(1, 2); }).Number, 53);
}

TEST_F(LookingIn, FailsForAGameWhoseFileIsDamaged) {
  Play(1);
  access.Archive().Keep(State());
  for (const std::string& contents : {std::string("x'00'"), std::string("CAST('<Other/>' AS BLOB)")}) {
    OtherConnection(ArchivePath())
        .Execute("UPDATE sqlar SET data = " + contents + ", sz = length(" + contents + ")");
    EXPECT_EQ(ThrownBy([&] { access.Read(1); }).Number, 321) << contents;
  }
}

TEST_F(LookingIn, FailsForFiguresThatNoBoardCouldShow) {
  Play(1);
  session.Game().Players(1).Active = true;
  session.Game().Players(2).Active = true;
  session.Game().Players(1).Soldiering = 2'000'000'000;
  session.Game().Players(2).Soldiering = 2'000'000'000;
  access.Archive().Keep(State());
  EXPECT_EQ(ThrownBy([&] { access.Read(1); }).Number, 321);
}

TEST_F(LookingIn, FailsWhileTheArchiveIsLockedAndWorksAgainAfterwards) {
  Play(1);
  access.Archive().Keep(State());
  access.Close();
  {
    OtherConnection other(ArchivePath());
    other.Execute("BEGIN EXCLUSIVE");
    EXPECT_EQ(ThrownBy([&] { access.Queries().Months(); }).Number, 3050);
    other.Execute("ROLLBACK");
  }
  EXPECT_EQ(access.Queries().Months().size(), 1U);
}

TEST_F(LookingIn, TellsOfAnArchiveThatCannotBeUsed) {
  WriteFile(ArchivePath(), "no database");
  EXPECT_THAT(access.Queries().Games({}), IsEmpty());
  EXPECT_EQ(access.Unusable(), ArchivePath());
  access.Close();
  std::filesystem::remove(ArchivePath());
  EXPECT_EQ(access.Unusable(), "");
}

TEST_F(LookingIn, TakesTheFileThatHasTakenItsPlace) {
  Play(1);
  access.Archive().Keep(State());
  const std::string copy = ReadFile(ArchivePath());
  Play(2);
  access.Archive().Keep(State());
  access.Close();
  std::filesystem::remove(ArchivePath());
  WriteFile(ArchivePath(), copy);
  EXPECT_THAT(access.Queries().Games({}), ElementsAre(1));
}

TEST_F(LookingIn, FindsTheGamesThatLieInTheNewFileAlone) {
  Play(1);
  access.Archive().Keep(State());
  access.Close();
  std::filesystem::rename(ArchivePath(), venue.Folder / "games-new.mdb");
  EXPECT_EQ(access.Queries().Months().size(), 1U);
  EXPECT_FALSE(ArchiveExists());
}

class Deleting : public LookingIn {
 protected:
  Deleting() {
    for (unsigned seed = 1; seed <= 3; ++seed) {
      session.ClearPlayerData();
      Play(seed);
      access.Archive().Keep(State());
    }
  }

  std::vector<std::int64_t> Games(bool deleted) { return access.Queries().Games({.Deleted = deleted}); }
  std::string Query(const std::string& sql) const { return OtherConnection(ArchivePath()).Query(sql); }
};

TEST_F(Deleting, HidesGamesUntilTheyAreBroughtBack) {
  EXPECT_EQ(access.Archive().Delete({1, 3, 9}, "2026-12-01 10:00:00"), 2);
  EXPECT_THAT(Games(false), ElementsAre(2));
  EXPECT_THAT(Games(true), ElementsAre(3, 1));
  EXPECT_EQ(access.Queries().Months().front().Games, 1);
  EXPECT_EQ(access.Queries().Game(3)->Deleted, "2026-12-01 10:00:00");
  EXPECT_EQ(access.Read(3).Played, "2026-11-21 20:15:30");

  EXPECT_EQ(access.Archive().Delete({3}, "2026-12-05 10:00:00"), 0);
  EXPECT_EQ(access.Queries().Game(3)->Deleted, "2026-12-01 10:00:00");

  EXPECT_EQ(access.Archive().BringBack({3, 2}), 1);
  EXPECT_THAT(Games(false), ElementsAre(3, 2));
  EXPECT_EQ(access.Queries().Game(3)->Deleted, "");
}

TEST_F(Deleting, IsNotUndoneWhereTheSameGameIsThereAgain) {
  access.Archive().Delete({3}, "2026-12-01 10:00:00");
  const std::int64_t again = access.Archive().Keep(State());
  EXPECT_EQ(access.Archive().BringBack({3}), 0);
  EXPECT_EQ(access.Queries().Game(3)->Deleted, "2026-12-01 10:00:00");
  access.Archive().Delete({1, 2, again}, "2026-12-01 10:00:00");
  EXPECT_EQ(access.Archive().BringBack({3}), 1);
  EXPECT_EQ(access.Archive().BringBack({again}), 0);
}

TEST_F(Deleting, ChangesNothingOfADeletedGameAnyMore) {
  access.Archive().Delete({3}, "2026-12-01 10:00:00");
  session.Game().Players(1).Active = !session.Game().Players(1).Active;
  const std::string before = ReadFile(ArchivePath());
  EXPECT_FALSE(access.Archive().KeepAgain(3, State(), FormerState::Replaced));
  EXPECT_EQ(ReadFile(ArchivePath()), before);
}

TEST_F(Deleting, RemovesWhatWasDeletedLongAgoWithItsFiles) {
  session.Game().Players(1).Active = !session.Game().Players(1).Active;
  access.Archive().KeepAgain(3, State(), FormerState::KeptToo);
  access.Archive().Delete({3}, "2026-12-01 10:00:00");
  access.Archive().Delete({2}, "2026-12-01 10:00:01");
  EXPECT_EQ(access.Archive().RemoveDeleted("2026-12-01 10:00:00", 10), 0);
  EXPECT_EQ(access.Archive().RemoveDeleted("2026-12-01 10:00:01", 10), 1);
  EXPECT_THAT(Games(true), ElementsAre(2));
  EXPECT_EQ(Query("SELECT group_concat(name) FROM (SELECT name FROM sqlar ORDER BY name)"),
            "2026-11-21/2015-000001.game.xml,2026-11-21/2015-000002.game.xml");
  for (const std::string table : {"Games", "GamePlayers", "GameFiles"}) {
    EXPECT_EQ(Query("SELECT count(DISTINCT GameID) || '|' || max(GameID) FROM " + table), "2|2") << table;
  }
}

TEST_F(Deleting, KeepsTheMissionsOfAllGames) {
  GameState other = State();
  other.Mission = "Flag";
  session.Game().Players(1).BonusPoints += 1;
  access.Archive().Keep(other);
  EXPECT_THAT(access.Queries().Missions(), ElementsAre("Flag", "None"));
}

}  // namespace
