#include <gmock/gmock.h>

#include <limits>

#include "tests/core/game/HeardSession.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST_F(Sessions, OpenWithTheMissionsAndWithoutAGame) {
  AddMissions();
  subscription = session.Listen([this](Change change) { told.push_back(change); });
  ASSERT_TRUE(venue.Open());
  EXPECT_THAT(told, ElementsAre(Change::Missions, Change::Mission, Change::MissionRow));
  EXPECT_EQ(session.Missions().Items().size(), 5U);
  EXPECT_EQ(session.Missions().Text(), "None");
  EXPECT_FALSE(session.MissionIsActive());
  EXPECT_EQ(TextOf(session.RsScenarios(), "MissionName"), "Bridge");
  EXPECT_EQ(session.List(BoardList::Players).RowCount(), 0);
  EXPECT_EQ(session.List(BoardList::Teams).RowCount(), 0);
}

TEST_F(Sessions, DoNotOpenWhenTheOperatorEndsTheProgramOverABadDatabase) {
  for (const std::string& file : {venue.MembersFile(), venue.ScenariosFile()}) {
    WriteFile(file, "no database");
    venue.Boxes.Answers = {BoxAnswer::Cancel};
    EXPECT_FALSE(venue.Open()) << file;
  }
  EXPECT_EQ(venue.Boxes.Boxes.size(), 2U);
}

TEST_F(Sessions, TellOfEmptyListsThenOfFullOnesThenOfTheScores) {
  Start();
  venue.Play(Red0, 5);
  venue.Play(Blue7, 9);
  std::vector<int> rows;
  const Subscription counting = session.Listen([&](Change change) {
    if (change == Change::PlayerRows) {
      rows.push_back(session.List(BoardList::Players).RowCount());
    }
  });
  session.CalculateScores();
  EXPECT_THAT(told, ElementsAre(Change::PlayerRows, Change::TeamRows, Change::PlayerRows, Change::TeamRows,
                                Change::Scores));
  EXPECT_THAT(rows, ElementsAre(0, 2));
  EXPECT_THAT(Players(), ElementsAre("Blue  7", "Red  0"));
  EXPECT_THAT(venue.Column(BoardList::Teams, BoardColumn::Soldiering), ElementsAre(" 9", " 5", " 0"));
}

TEST_F(Sessions, ScoreByTheirOwnFactors) {
  Start();
  venue.Play(Red0, 5).HealCount = 3;
  session.Factors().Heal = 100;
  session.CalculateScores();
  EXPECT_EQ(session.Game().Players(Red0).Soldiering, 305);
}

TEST_F(Sessions, CalculateOnlyAGameThatIsPresentWhereThatIsAsked) {
  Start();
  session.CalculateScoresWhenPresent();
  EXPECT_THAT(told, IsEmpty());
  venue.Play(Red0, 5);
  session.CalculateScoresWhenPresent();
  EXPECT_EQ(told.back(), Change::Scores);
}

TEST_F(Sessions, HaveEmptyListsAfterAnOverflowAlsoWhenAHeaderIsClicked) {
  Start();
  venue.Play(Red0, 5);
  venue.Play(2, std::numeric_limits<std::int32_t>::max());
  venue.Play(Blue7, 9);
  EXPECT_EQ(NumberThrownBy([this] { session.CalculateScores(); }), 6);
  EXPECT_THAT(told, ElementsAre(Change::PlayerRows, Change::TeamRows));
  EXPECT_THAT(Players(), IsEmpty());
  EXPECT_EQ(session.List(BoardList::Teams).RowCount(), 0);
  session.SortByHeader(3);
  EXPECT_THAT(Players(), IsEmpty());
  session.Game().Players(2).BonusPoints = 1;
  session.CalculateScores();
  EXPECT_THAT(Players(), ElementsAre("Blue  7", "Red  0", "Red  1"));
}

TEST_F(Sessions, LeaveBothDatabasesToOtherProgramsWhileABoxIsOpen) {
  AddMissions();
  AddMember();
  Start();
  session.SelectMission(3);
  venue.Play(Red0, 5).MemberIndex = 7;
  venue.Play(2, 6).MemberIndex = 99;
  venue.Play(Blue7, 9).MemberIndex = 98;
  venue.Boxes.WhileOpen = [this](const FakeMessageBoxes::Box&) {
    EXPECT_EQ(OtherConnection(venue.MembersFile()).Try("UPDATE Members SET City = 'Bern'"), SQLITE_OK);
    EXPECT_EQ(OtherConnection(venue.ScenariosFile()).Try("UPDATE Table1 SET TeamRatio = '1'"), SQLITE_OK);
  };
  session.CalculateScores();
  EXPECT_EQ(venue.Boxes.Boxes.size(), 2U);
  ExecuteSql(venue.ScenariosFile(), "DELETE FROM Table1 WHERE ID = 5");
  session.CalculateScores();
  EXPECT_EQ(venue.Boxes.Boxes.size(), 2U + 2U + 3U);
}

class CommandsInABox : public Sessions {
 protected:
  /// Red 0 and Blue 7 play; the member of Red 1 is gone, which a calculation reports in a box.
  void SetUp() override {
    AddMissions();
    Start();
    venue.Play(Red0, 5);
    venue.Play(2, 6).MemberIndex = 99;
    venue.Play(Blue7, 9);
  }

  /// Runs `command` in the first box that opens.
  void InTheBox(const std::function<void()>& command) {
    venue.Boxes.WhileOpen = [this, command](const FakeMessageBoxes::Box&) {
      venue.Boxes.WhileOpen = nullptr;
      command();
    };
  }
};

TEST_F(CommandsInABox, MayCalculateAnewAndListEachPlayerOnce) {
  InTheBox([this] {
    EXPECT_THAT(Players(), IsEmpty());
    session.Game().Players(Red0).BonusPoints = 70;
    session.CalculateScores();
  });
  session.CalculateScores();
  EXPECT_THAT(Players(), ElementsAre("Red  0", "Blue  7", "Red  1"));
  EXPECT_THAT(venue.Column(BoardList::Players, BoardColumn::Soldiering), ElementsAre(" 70", " 9", " 6"));
  EXPECT_THAT(venue.Column(BoardList::Teams, BoardColumn::Soldiering), ElementsAre(" 76", " 9", " 0"));
  EXPECT_EQ(session.Game().TeamTotals(1), 76);
  EXPECT_THAT(told, ElementsAre(Change::PlayerRows, Change::TeamRows, Change::PlayerRows, Change::TeamRows,
                                Change::PlayerRows, Change::TeamRows, Change::Scores));
}

TEST_F(CommandsInABox, MayClearTheGame) {
  session.Game().Players(2).Accuracy = 0.5F;
  InTheBox([this] { session.ClearPlayerData(); });
  session.CalculateScores();
  EXPECT_THAT(Players(), IsEmpty());
  EXPECT_EQ(session.List(BoardList::Teams).RowCount(), 0);
  EXPECT_EQ(session.Game().Players(2).Soldiering, 0);
  EXPECT_EQ(told.back(), Change::Cleared);
}

TEST_F(CommandsInABox, MayDoSoInTheBoxAboutAMissionToo) {
  session.Game().Players(2).MemberIndex = 0;
  session.SelectMission(3);
  ExecuteSql(venue.ScenariosFile(), "DELETE FROM Table1 WHERE ID = 5");
  InTheBox([this] { session.SelectMission(MissionList::None); });
  session.CalculateScores();
  EXPECT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(Players(), ElementsAre("Blue  7", "Red  1", "Red  0"));
  EXPECT_EQ(session.Game().TeamTotals(1), 11);
}

TEST_F(CommandsInABox, MaySortTheListThatIsStillEmpty) {
  InTheBox([this] { session.SortByHeader(1); });
  session.CalculateScores();
  EXPECT_THAT(Players(), ElementsAre("Red  0", "Red  1", "Blue  7"));
}

TEST_F(Sessions, SortThePlayersAlone) {
  Start();
  venue.Play(Red0, 5);
  venue.Play(Blue7, 9);
  session.CalculateScores();
  told.clear();
  session.SortByHeader(2);
  EXPECT_THAT(told, ElementsAre(Change::PlayerRows));
  EXPECT_THAT(Players(), ElementsAre("Red  0", "Blue  7"));
}

TEST_F(Sessions, ForgetTheGameButNotTheMission) {
  AddMissions();
  Start();
  session.SelectMission(3);
  venue.Play(Red0, 5);
  session.CalculateScores();
  told.clear();
  session.ClearPlayerData();
  EXPECT_THAT(told, ElementsAre(Change::PlayerRows, Change::TeamRows, Change::Cleared));
  EXPECT_FALSE(session.Game().DataPresent);
  EXPECT_FALSE(session.Game().Players(Red0).Active);
  EXPECT_EQ(session.List(BoardList::Teams).RowCount(), 0);
  EXPECT_EQ(session.Missions().Text(), "Keep");
}

TEST_F(Sessions, LoadAGameInTheLastMissionOfItsName) {
  AddMissions();
  Start();
  venue.Play(Blue7, 9);
  session.LoadGame([](Game& game, const Session::MissionChoice& chooseMission) {
    EXPECT_FALSE(game.Players(Blue7).Active);
    chooseMission("Bridge");
    game.Players(Red0).Active = true;
    return true;
  });
  EXPECT_TRUE(session.Game().DataPresent);
  EXPECT_EQ(session.MissionDescription(), "Blow it up");
  EXPECT_THAT(Players(), ElementsAre("Red  0"));
  EXPECT_THAT(told, ElementsAre(Change::PlayerRows, Change::TeamRows, Change::Cleared, Change::Mission,
                                Change::MissionRow, Change::Mission, Change::MissionRow, Change::Loaded,
                                Change::PlayerRows, Change::TeamRows, Change::PlayerRows, Change::TeamRows,
                                Change::Scores));
}

TEST_F(Sessions, KeepTheMissionOfAGameWhoseOwnIsUnknown) {
  AddMissions();
  Start();
  session.SelectMission(3);
  session.LoadGame([](Game&, const Session::MissionChoice& chooseMission) {
    chooseMission("Elsewhere");
    return true;
  });
  EXPECT_EQ(session.Missions().Text(), "Keep");
}

TEST_F(Sessions, StayEmptyAfterALoadThatReadNothing) {
  Start();
  venue.Play(Blue7, 9);
  session.CalculateScores();
  told.clear();
  session.LoadGame([](Game&, const Session::MissionChoice&) { return false; });
  EXPECT_THAT(told, ElementsAre(Change::PlayerRows, Change::TeamRows, Change::Cleared));
  EXPECT_EQ(session.List(BoardList::Teams).RowCount(), 0);
  EXPECT_FALSE(session.Game().DataPresent);
}

TEST_F(Sessions, PassOnWhatFailsInALoad) {
  Start();
  const auto fail = [](Game& game, const Session::MissionChoice&) -> bool {
    game.GameDate = "read so far";
    throw RuntimeError(13);
  };
  EXPECT_EQ(NumberThrownBy([&] { session.LoadGame(fail); }), 13);
  EXPECT_EQ(session.Game().GameDate, "read so far");
  EXPECT_FALSE(session.Game().DataPresent);
  EXPECT_EQ(told.back(), Change::Cleared);
}

TEST_F(Sessions, HaveTheGameAndItsMissionSaved) {
  AddMissions();
  Start();
  session.SelectMission(3);
  told.clear();
  std::string mission;
  session.SaveGame([&](const Game& game, const std::string& missionName) {
    EXPECT_EQ(&game, &session.Game());
    mission = missionName;
    return true;
  });
  EXPECT_EQ(mission, "Keep");
  EXPECT_THAT(told, ElementsAre(Change::Saved));
  told.clear();
  session.SaveGame([](const Game&, const std::string&) { return false; });
  EXPECT_THAT(told, IsEmpty());
}

TEST_F(Sessions, CommitTheGameToItsMembersOnce) {
  AddMember();
  Start();
  venue.Play(Red0, 5).DallasID = "AB00000000000001";
  session.CalculateScores();
  EXPECT_THAT(Players(), ElementsAre("Red  0: Mole"));
  EXPECT_EQ(session.CommitGame(), CommitResult::Committed);
  EXPECT_EQ(told.back(), Change::Committed);
  EXPECT_EQ(session.CommitGame(), CommitResult::SomeWereAlready);
  EXPECT_EQ(OtherConnection(venue.MembersFile()).Query("SELECT TotalGamesPlayed FROM Members"), "1");
  EXPECT_TRUE(venue.Disk.FolderExists(venue.Folder / "backups"));
  EXPECT_EQ(session.TakeBackupFailure(), "");
}

TEST_F(Sessions, TellOfACopyThatCouldNotBeMade) {
  AddMember();
  WriteFile(venue.Folder / "backups", "in the way of the folder");
  EXPECT_EQ(session.TakeBackupFailure(), "");
  Start();
  venue.Play(Red0, 5).MemberIndex = 7;
  EXPECT_EQ(session.CommitGame(), CommitResult::Committed);
  EXPECT_NE(session.TakeBackupFailure(), "");
  EXPECT_EQ(session.TakeBackupFailure(), "");
}

TEST_F(Sessions, ServeAListenerWhoEndsAndOneWhoComesInACalculation) {
  Start();
  venue.Play(Red0, 5);
  int heardByFirst = 0;
  std::vector<Change> heardBySecond;
  Subscription first;
  Subscription second;
  first = session.Listen([&](Change) {
    ++heardByFirst;
    first.End();
    second = session.Listen([&](Change change) { heardBySecond.push_back(change); });
  });
  session.CalculateScores();
  EXPECT_EQ(heardByFirst, 1);
  EXPECT_THAT(heardBySecond,
              ElementsAre(Change::TeamRows, Change::PlayerRows, Change::TeamRows, Change::Scores));
}

TEST_F(Sessions, CloseTheirDatabasesAndKeepTheGame) {
  Start();
  venue.Play(Red0, 5);
  session.CalculateScores();
  session.Close();
  session.Close();
  EXPECT_THAT(Players(), ElementsAre("Red  0"));
  session.SortByHeader(1);
  ASSERT_TRUE(venue.Open());
  session.CalculateScores();
  EXPECT_THAT(Players(), ElementsAre("Red  0"));
}

}  // namespace
