#include "core/game/CommitGame.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>

#include "tests/fakes/FakeClock.h"
#include "tests/support/FileSizeLimit.h"
#include "tests/support/ScoredGame.h"
#include "tests/support/TestDatabase.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

const std::string AllFigures =
    "TotalGamesPlayed || '|' || coalesce(LastPlayedDate, '') || '|' || TotalDamage || '|' || AverageDamage "
    "|| "
    "'|' || TotalSoldiering || '|' || AverageSoldiering || '|' || PriZeroAccuracyCount || '|' || "
    "TotalPrimaryAccuracy || '|' || AveragePrimAccuracy || '|' || AverageSecAccuracy";

const std::string Untouched = "0||0.0|0.0|0.0|0.0|0|0.0|0.0|0.0";

class Commit : public testing::Test {
 protected:
  /// Adds members with the numbers 1 to `count`.
  void AddMembers(int count) {
    std::string rows;
    for (int member = 1; member <= count; ++member) {
      rows += (rows.empty() ? "(" : ", (") + std::to_string(member) + ", 'First', 'Last')";
    }
    Sql("INSERT INTO Members (ContactID, FirstName, LastName) VALUES " + rows);
  }

  void Sql(const std::string& sql) { ExecuteSql(venue.MembersFile(), sql); }

  /// Puts an active player with these figures into the game.
  Player& Play(int index, std::int32_t member, std::int32_t damage = 10, std::int32_t soldiering = 20,
               float accuracy = 0.5F) {
    Player& player = venue.Activate(index);
    player.MemberIndex = member;
    player.TotalDamage = damage;
    player.Soldiering = soldiering;
    player.Accuracy = accuracy;
    return player;
  }

  CommitResult Run() {
    if (!venue.RsMembers) {
      venue.Open();
    }
    return CommitPlayers(venue.game, venue.DbMembers(), *venue.RsMembers, *venue.Members, clock);
  }

  std::string Figure(const std::string& expression, int member = 1) {
    return OtherConnection(venue.MembersFile())
        .Query("SELECT " + expression + " FROM Members WHERE ContactID = " + std::to_string(member));
  }

  std::vector<int> CommittedPlayers() {
    std::vector<int> players;
    for (int index = 1; index <= PlayerCount; ++index) {
      if (venue.game.Players(index).Committed) {
        players.push_back(index);
      }
    }
    return players;
  }

  const FakeMessageBoxes::Box gone{"Could not locate specified Member in database!", "Member Error",
                                   BoxIcon::Exclamation, BoxButtons::Ok};
  ScoredGame venue;
  FakeClock clock;
};

TEST_F(Commit, SetsEveryColumnFromTheGame) {
  AddMembers(1);
  Play(1, 1, 289, -7, 0.3456F).Committed = false;
  EXPECT_EQ(Run(), CommitResult::Committed);
  EXPECT_EQ(Figure(AllFigures),
            "1|2013-05-21 14:30:05|289.0|289.0|-7.0|-7.0|0|0.345600008964539|0.345600008964539|0.0");
  EXPECT_THAT(CommittedPlayers(), ElementsAre(1));
}

TEST_F(Commit, AddsToTheGamesBefore) {
  AddMembers(1);
  Sql("UPDATE Members SET TotalGamesPlayed = 2, TotalDamage = 20, TotalSoldiering = 11, PriZeroAccuracyCount "
      "= 1, "
      "TotalPrimaryAccuracy = 0.25, AverageSecAccuracy = 0.75");
  Play(224, 1, 15, 4, 0.5F);
  EXPECT_EQ(Run(), CommitResult::Committed);
  EXPECT_EQ(Figure(AllFigures), "3|2013-05-21 14:30:05|35.0|11.67|15.0|5.0|1|0.75|0.375|0.0");
}

TEST_F(Commit, AveragesTenAndFifteenTo12Point5) {
  AddMembers(1);
  Play(1, 1, 10);
  Run();
  venue.game.Players(1).Committed = false;
  venue.game.Players(1).TotalDamage = 15;
  Run();
  EXPECT_EQ(Figure("AverageDamage"), "12.5");
}

TEST_F(Commit, RoundsAveragesToTheEvenHundredth) {
  AddMembers(2);
  Sql("UPDATE Members SET TotalGamesPlayed = 7");
  Play(1, 1, 1, 3);  // 0.125 and 0.375
  Play(2, 2, 5, 7);  // 0.625 and 0.875
  Run();
  EXPECT_EQ(Figure("AverageDamage || ' ' || AverageSoldiering", 1), "0.12 0.38");
  EXPECT_EQ(Figure("AverageDamage || ' ' || AverageSoldiering", 2), "0.62 0.88");
}

TEST_F(Commit, DoesNotRoundTheAccuracy) {
  AddMembers(1);
  Sql("UPDATE Members SET TotalGamesPlayed = 2, TotalPrimaryAccuracy = 0.5");
  Play(1, 1, 0, 0, 0.5F);
  Run();
  EXPECT_EQ(Figure("AveragePrimAccuracy = 1.0 / 3"), "1");
}

TEST_F(Commit, LeavesTheAccuracyAloneWithoutAnyGameThatHadOne) {
  AddMembers(1);
  Sql("UPDATE Members SET AveragePrimAccuracy = 0.125");
  Play(1, 1, 10, 20, 0);
  Run();
  EXPECT_EQ(Figure("PriZeroAccuracyCount || ' ' || TotalGamesPlayed || ' ' || AveragePrimAccuracy"),
            "1 1 0.125");
}

TEST_F(Commit, TakesAGameWithoutAccuracyOutOfTheMean) {
  AddMembers(1);
  Sql("UPDATE Members SET TotalGamesPlayed = 1, TotalPrimaryAccuracy = 0.5, AveragePrimAccuracy = 0.5");
  Play(1, 1, 10, 20, 0);
  Run();
  EXPECT_EQ(Figure("AveragePrimAccuracy || ' ' || TotalPrimaryAccuracy"), "0.5 0.5");
}

TEST_F(Commit, CountsNullAsZero) {
  Sql("CREATE TABLE Copy AS SELECT * FROM Members; DROP TABLE Members; "
      "CREATE TABLE Members (ContactID INTEGER PRIMARY KEY, TotalGamesPlayed INTEGER, LastPlayedDate TEXT, "
      "TotalDamage REAL, AverageDamage REAL, TotalSoldiering REAL, AverageSoldiering REAL, "
      "PriZeroAccuracyCount INTEGER, TotalPrimaryAccuracy REAL, AveragePrimAccuracy REAL, AverageSecAccuracy "
      "REAL); "
      "INSERT INTO Members (ContactID) VALUES (1)");
  Play(1, 1);
  EXPECT_EQ(Run(), CommitResult::Committed);
  EXPECT_EQ(Figure("TotalGamesPlayed || ' ' || TotalDamage || ' ' || AverageSoldiering"), "1 10.0 20.0");
}

TEST_F(Commit, SkipsPlayersWithoutAMemberOrWhoDidNotPlay) {
  AddMembers(2);
  Play(1, 0);
  Play(2, 1).Active = false;
  EXPECT_EQ(Run(), CommitResult::Committed);
  EXPECT_EQ(Figure(AllFigures), Untouched);
  EXPECT_THAT(CommittedPlayers(), IsEmpty());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Commit, TouchesNoLockedFileWhenThereIsNothingToCommit) {
  AddMembers(1);
  venue.Open();
  OtherConnection other(venue.MembersFile());
  other.Execute("BEGIN IMMEDIATE");
  EXPECT_EQ(Run(), CommitResult::Committed);
}

TEST_F(Commit, CountsNobodyTwice) {
  AddMembers(2);
  Play(1, 1);
  Run();
  EXPECT_EQ(Run(), CommitResult::SomeWereAlready);
  EXPECT_EQ(Figure("TotalGamesPlayed"), "1");
  Play(2, 2);
  EXPECT_EQ(Run(), CommitResult::SomeWereAlready);
  EXPECT_EQ(Figure("TotalGamesPlayed", 2), "1");
  venue.game.Players(1).MemberIndex = 2;
  Run();
  EXPECT_EQ(Figure("TotalGamesPlayed", 2), "1");
  EXPECT_EQ(Figure("TotalGamesPlayed", 1), "1");
}

TEST_F(Commit, AddsTwoPlayersOfOneMemberOneAfterTheOther) {
  AddMembers(1);
  Play(3, 1, 10);
  Play(5, 1, 15);
  Run();
  EXPECT_EQ(Figure("TotalGamesPlayed || ' ' || TotalDamage || ' ' || AverageDamage"), "2 25.0 12.5");
}

TEST_F(Commit, LeavesThePlayerUncommittedWhenTheMemberIsGone) {
  AddMembers(4);
  venue.Open();
  Sql("DELETE FROM Members WHERE ContactID IN (2, 4)");
  for (int index = 1; index <= 4; ++index) {
    Play(index, index);
  }
  // While the box is open, other programs can write the file and see what has been committed so far.
  venue.Boxes.WhileOpen = [this](const FakeMessageBoxes::Box&) {
    EXPECT_EQ(Figure("TotalGamesPlayed"), "1");
    Sql("UPDATE Members SET City = 'Other'");
  };
  EXPECT_EQ(Run(), CommitResult::Committed);
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(gone, gone));
  EXPECT_THAT(CommittedPlayers(), ElementsAre(1, 3));
  EXPECT_EQ(Figure("TotalGamesPlayed", 3), "1");
}

TEST_F(Commit, StopsAtTheRowThatTheDatabaseRefusesAndKeepsThoseBefore) {
  AddMembers(5);
  Sql("CREATE TRIGGER Refuse BEFORE UPDATE ON Members WHEN old.ContactID = 3 BEGIN SELECT RAISE(ABORT, "
      "'no'); END");
  for (int index = 1; index <= 5; ++index) {
    Play(index, index);
  }
  EXPECT_EQ(Run(), CommitResult::Failed);
  EXPECT_THAT(CommittedPlayers(), ElementsAre(1, 2, 3));
  EXPECT_EQ(Figure("TotalGamesPlayed", 1), "1");
  EXPECT_EQ(Figure("TotalGamesPlayed", 2), "1");
  EXPECT_EQ(Figure(AllFigures, 3), Untouched);
  EXPECT_EQ(Figure(AllFigures, 4), Untouched);
  // The refused player is left out until the game is loaded again; the others can still be committed.
  Sql("DROP TRIGGER Refuse");
  EXPECT_EQ(Run(), CommitResult::SomeWereAlready);
  EXPECT_THAT(CommittedPlayers(), ElementsAre(1, 2, 3, 4, 5));
  EXPECT_EQ(Figure(AllFigures, 3), Untouched);
  EXPECT_EQ(Figure("TotalGamesPlayed", 2), "1");
  EXPECT_EQ(Figure("TotalGamesPlayed", 5), "1");
}

TEST_F(Commit, TellsOfAMissingMemberBeforeTheRowThatFails) {
  AddMembers(3);
  venue.Open();
  Sql("DELETE FROM Members WHERE ContactID = 1");
  Sql("CREATE TRIGGER Refuse BEFORE UPDATE ON Members WHEN old.ContactID = 3 BEGIN SELECT RAISE(ABORT, "
      "'no'); END");
  for (int index = 1; index <= 3; ++index) {
    Play(index, index);
  }
  EXPECT_EQ(Run(), CommitResult::Failed);
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(gone));
  EXPECT_THAT(CommittedPlayers(), ElementsAre(2, 3));
  EXPECT_EQ(Figure("TotalGamesPlayed", 2), "1");
}

TEST_F(Commit, MarksOnlyTheFirstWhenTheFileIsLocked) {
  AddMembers(3);
  for (int index = 1; index <= 3; ++index) {
    Play(index, index);
  }
  venue.Open();
  OtherConnection other(venue.MembersFile());
  other.Execute("BEGIN IMMEDIATE");
  EXPECT_EQ(Run(), CommitResult::Failed);
  EXPECT_THAT(CommittedPlayers(), ElementsAre(1));
  other.Execute("COMMIT");
  EXPECT_EQ(Figure(AllFigures, 1), Untouched);
}

TEST_F(Commit, MarksNobodyButTheFirstWhenTheLastFlushFails) {
  AddMembers(PlayerCount);
  for (int index = 1; index <= PlayerCount; ++index) {
    Play(index, index);
  }
  venue.Open();
  {
    const FileSizeLimit full(1024);
    EXPECT_EQ(Run(), CommitResult::Failed);
  }
  EXPECT_THAT(CommittedPlayers(), ElementsAre(1));
  EXPECT_EQ(Figure("sum(TotalGamesPlayed)"), "0");
}

TEST_F(Commit, FailsOnAnImpossibleFigure) {
  AddMembers(1);
  Sql("UPDATE Members SET TotalGamesPlayed = -1");
  Play(1, 1);
  EXPECT_EQ(Run(), CommitResult::Failed);
  EXPECT_EQ(Figure("TotalGamesPlayed"), "-1");
  EXPECT_THAT(CommittedPlayers(), ElementsAre(1));
}

TEST_F(Commit, LeavesEachRowOldOrNewWhenTheProgramIsKilled) {
  AddMembers(PlayerCount);
  for (int index = 1; index <= PlayerCount; ++index) {
    Play(index, index);
  }
  Sql("CREATE TABLE Before AS SELECT ContactID AS Member, TotalGamesPlayed AS Games FROM Members");
  int killed = 0;
  for (useconds_t instant = 200; instant < 400'000; instant += instant / 32) {
    const pid_t child = fork();
    if (child == 0) {
      venue.Open();
      ualarm(instant, 0);  // kills the process at this instant
      Run();
      _exit(0);
    }
    int status = 0;
    waitpid(child, &status, 0);
    OtherConnection file(venue.MembersFile());
    EXPECT_EQ(file.Query("PRAGMA integrity_check"), "ok");
    EXPECT_EQ(file.Query("SELECT count(*) FROM Members m, Before b WHERE m.ContactID = b.Member AND "
                         "m.TotalGamesPlayed NOT IN (b.Games, b.Games + 1)"),
              "0");
    file.Execute("UPDATE Before SET Games = (SELECT TotalGamesPlayed FROM Members WHERE ContactID = Member)");
    EXPECT_EQ(file.Query("SELECT count(*) FROM Members WHERE TotalDamage <> 10 * TotalGamesPlayed OR "
                         "TotalSoldiering <> 20 * TotalGamesPlayed OR TotalPrimaryAccuracy <> 0.5 * "
                         "TotalGamesPlayed"),
              "0");
    if (!WIFSIGNALED(status)) {
      break;
    }
    ++killed;
  }
  EXPECT_GT(killed, 24);
  EXPECT_EQ(Figure("TotalGamesPlayed >= 1"), "1");
}

TEST(CommitMessage, TellsWhatHappened) {
  FakeMessageBoxes boxes;
  TellCommitResult(CommitResult::Committed, boxes);
  TellCommitResult(CommitResult::SomeWereAlready, boxes);
  boxes.Answers = {BoxAnswer::Cancel};
  TellCommitResult(CommitResult::Failed, boxes);
  EXPECT_THAT(
      boxes.Boxes,
      ElementsAre(FakeMessageBoxes::Box{"Scores have been committed to the Database", "Update Success",
                                        BoxIcon::Information, BoxButtons::Ok},
                  FakeMessageBoxes::Box{
                      "Some Scores have already been committed to the Database. Uncommited scores are "
                      "now committed.",
                      "Update Success", BoxIcon::Information, BoxButtons::Ok},
                  FakeMessageBoxes::Box{"Error occured while saving data to Database", "Database Error",
                                        BoxIcon::Exclamation, BoxButtons::OkCancel}));
}

}  // namespace
