#include <gmock/gmock.h>

#include "tests/core/game/HeardSession.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST_F(Sessions, TellOfAMissionBeforeAndAfterItsRowIsLookedFor) {
  AddMissions();
  Start();
  std::vector<int> chosen;
  const Subscription choices =
      session.Listen([&](Change) { chosen.push_back(session.Missions().ListIndex()); });
  session.SelectMission(2);
  EXPECT_THAT(told, ElementsAre(Change::Mission, Change::MissionRow));
  EXPECT_THAT(chosen, ElementsAre(2, 2));
  EXPECT_TRUE(session.MissionIsActive());
  EXPECT_EQ(session.MissionDescription(), "Hold it");
  EXPECT_EQ(IntegerOf(session.RsScenarios(), "ID"), 3);
  session.SelectMission(MissionList::FreeForAll);
  EXPECT_FALSE(session.MissionIsActive());
  EXPECT_EQ(session.MissionDescription(), "");
  EXPECT_EQ(NumberThrownBy([this] { session.SelectMission(5); }), 9);
}

TEST_F(Sessions, ScoreAGameAnewInAnotherMission) {
  AddMissions();
  Start();
  venue.Play(Red0, 5).RespawnCount = 2;
  session.SelectMission(3);
  EXPECT_EQ(told.back(), Change::Scores);
  EXPECT_EQ(session.Game().Players(Red0).Soldiering, 5 - 8);
}

TEST_F(Sessions, HaveNoActiveMissionWhoseRowIsGone) {
  AddMissions();
  Start();
  ExecuteSql(venue.ScenariosFile(), "DELETE FROM Table1 WHERE ID = 5");
  venue.Boxes.WhileOpen = [this](const FakeMessageBoxes::Box&) {
    EXPECT_THAT(told, ElementsAre(Change::Mission));
    EXPECT_EQ(session.Missions().ListIndex(), 3);
  };
  session.SelectMission(3);
  EXPECT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_FALSE(session.MissionIsActive());
  EXPECT_EQ(session.MissionDescription(), "");
}

TEST_F(Sessions, ReadTheMissionsAnewAndStandOnNone) {
  AddMissions();
  Start();
  session.SelectMission(3);
  venue.Play(Red0, 5);
  told.clear();
  session.FillMissionList();
  EXPECT_THAT(told, ElementsAre(Change::Missions, Change::Mission, Change::MissionRow, Change::PlayerRows,
                                Change::TeamRows, Change::PlayerRows, Change::TeamRows, Change::Scores));
  EXPECT_EQ(session.Missions().Text(), "None");
  EXPECT_FALSE(session.MissionIsActive());
}

TEST_F(Sessions, StandOnNoneAlsoAfterFreeForAllWhenTheMissionsAreReadAnew) {
  Start();
  session.SelectMission(MissionList::FreeForAll);
  venue.Play(Red0, 5);
  session.Game().Players(2).HitByPlayer(Red0) = 30;
  session.FillMissionList();
  EXPECT_EQ(session.Missions().Text(), "None");
  EXPECT_EQ(session.Game().Players(Red0).Soldiering, 5 - 30);
}

TEST_F(Sessions, KeepListAndMissionWhenTheMissionsCannotBeReadAnew) {
  AddMissions();
  Start();
  session.SelectMission(3);
  venue.Play(Red0, 5).RespawnCount = 2;
  session.CalculateScores();
  told.clear();
  {
    OtherConnection other(venue.ScenariosFile());
    other.Execute("DELETE FROM Table1 WHERE ID = 9; BEGIN EXCLUSIVE");
    EXPECT_EQ(NumberThrownBy([this] { session.FillMissionList(); }), 3050);
  }
  EXPECT_THAT(told, IsEmpty());
  EXPECT_EQ(session.Missions().Items().size(), 5U);
  EXPECT_EQ(session.Missions().Text(), "Keep");
  EXPECT_EQ(session.MissionDescription(), "");
  EXPECT_TRUE(session.MissionIsActive());
  session.CalculateScores();
  EXPECT_EQ(session.Game().Players(Red0).Soldiering, 5 - 8);
  session.FillMissionList();
  EXPECT_EQ(session.Missions().Items().size(), 4U);
  EXPECT_EQ(session.Missions().Text(), "None");
}

TEST_F(Sessions, TakeAChoiceBackWhenTheMissionsRowCannotBeRead) {
  AddMissions();
  Start();
  session.SelectMission(3);
  venue.Play(Red0, 5).RespawnCount = 2;
  session.CalculateScores();
  told.clear();
  std::vector<int> chosen;
  const Subscription choices =
      session.Listen([&](Change) { chosen.push_back(session.Missions().ListIndex()); });
  {
    OtherConnection other(venue.ScenariosFile());
    other.Execute("BEGIN EXCLUSIVE");
    EXPECT_EQ(NumberThrownBy([this] { session.SelectMission(2); }), 3050);
  }
  EXPECT_THAT(told, ElementsAre(Change::Mission, Change::Mission));
  EXPECT_THAT(chosen, ElementsAre(2, 3));
  EXPECT_TRUE(session.MissionIsActive());
  EXPECT_EQ(session.MissionDescription(), "");
  EXPECT_THAT(venue.Column(BoardList::Players, BoardColumn::Soldiering), ElementsAre("-3"));
  session.SelectMission(2);
  EXPECT_EQ(session.MissionDescription(), "Hold it");
  EXPECT_THAT(venue.Column(BoardList::Players, BoardColumn::Soldiering), ElementsAre(" 5"));
}

}  // namespace
