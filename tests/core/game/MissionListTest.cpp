#include "core/game/MissionList.h"

#include <gmock/gmock.h>

#include "core/data/FieldValue.h"
#include "tests/support/RandomGame.h"
#include "tests/support/Reckoning.h"
#include "tests/support/ScoredGame.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class ListOfMissions : public testing::Test {
 protected:
  ListOfMissions() {
    ExecuteSql(venue.ScenariosFile(),
               "INSERT INTO Table1 (ID, MissionName) VALUES (3, 'Bridge'), (5, 'Keep'), (9, 'Bridge')");
    venue.Open();
  }

  std::vector<std::string> Texts() const {
    std::vector<std::string> texts;
    for (const MissionList::Item& item : venue.Missions->Items()) {
      texts.push_back(item.Text);
    }
    return texts;
  }

  ScoredGame venue;
};

TEST_F(ListOfMissions, BeginsWithTheTwoFixedEntries) {
  EXPECT_THAT(Texts(), ElementsAre("None", "Free For All", "Bridge", "Keep", "Bridge"));
  EXPECT_EQ(venue.Missions->ListIndex(), MissionList::None);
  EXPECT_EQ(venue.Missions->Text(), "None");
}

TEST_F(ListOfMissions, StandsOnNoneAfterEachFill) {
  venue.Missions->Select(3);
  venue.Missions->FillMissionList();
  EXPECT_EQ(venue.Missions->ListIndex(), MissionList::None);
  venue.Missions->Select(MissionList::FreeForAll);
  venue.Missions->FillMissionList();
  EXPECT_EQ(venue.Missions->ListIndex(), MissionList::None);
}

TEST_F(ListOfMissions, NamesTheActiveEntry) {
  venue.Missions->Select(3);
  EXPECT_EQ(venue.Missions->Text(), "Keep");
  venue.Missions->Select(MissionList::FreeForAll);
  EXPECT_EQ(venue.Missions->Text(), "Free For All");
}

TEST_F(ListOfMissions, HasNumbersForMissionsOnly) {
  std::vector<std::int32_t> ids;
  for (const MissionList::Item& item : venue.Missions->Items()) {
    ids.push_back(item.Id);
  }
  EXPECT_THAT(ids, ElementsAre(0, 0, 3, 5, 9));
}

TEST_F(ListOfMissions, LosesADeletedMissionWithTheNextFill) {
  venue.RsScenarios->FindFirst("ID= 5");
  venue.RsScenarios->Delete();
  EXPECT_EQ(venue.Missions->Items().size(), 5U);
  venue.Missions->FillMissionList();
  EXPECT_THAT(Texts(), ElementsAre("None", "Free For All", "Bridge", "Bridge"));
}

TEST_F(ListOfMissions, GainsAMissionAddedThroughItsCursorWithTheNextFill) {
  venue.RsScenarios->AddNew();
  venue.RsScenarios->SetField("MissionName", std::string("夜 & <Keep>"));
  venue.RsScenarios->Update();
  venue.Missions->FillMissionList();
  EXPECT_EQ(Texts().back(), "夜 & <Keep>");
}

TEST_F(ListOfMissions, HasNoRecordForTheFixedEntries) {
  for (const int index : {MissionList::None, MissionList::FreeForAll}) {
    venue.Missions->Select(index);
    EXPECT_FALSE(venue.Missions->ActivateCurrentMissionRecord());
  }
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(ListOfMissions, MovesTheCursorToTheRowOfTheEntry) {
  venue.Missions->Select(4);
  ASSERT_TRUE(venue.Missions->ActivateCurrentMissionRecord());
  EXPECT_EQ(TextOf(venue.Missions->Row().Fields("ID")), "9");
  venue.Missions->Select(3);
  ASSERT_TRUE(venue.Missions->ActivateCurrentMissionRecord());
  EXPECT_EQ(TextOf(venue.Missions->Row().Fields("MissionName")), "Keep");
}

TEST_F(ListOfMissions, SaysWhenTheRowIsGone) {
  venue.Missions->Select(3);
  ExecuteSql(venue.ScenariosFile(), "DELETE FROM Table1 WHERE ID = 5");
  EXPECT_FALSE(venue.Missions->ActivateCurrentMissionRecord());
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{
                                     "Could not locate selected Mission in Mission Database",
                                     "Mission Database Error", BoxIcon::Exclamation, BoxButtons::Ok}));
}

TEST_F(ListOfMissions, RefusesIndexesOutside) {
  EXPECT_EQ(NumberThrownBy([this] { venue.Missions->Select(-1); }), 9);
  EXPECT_EQ(NumberThrownBy([this] { venue.Missions->Select(5); }), 9);
}

TEST(EmptyMissionTable, LeavesTheTwoFixedEntries) {
  ScoredGame venue(Language::SimplifiedChinese);
  venue.Open();
  ASSERT_EQ(venue.Missions->Items().size(), 2U);
  EXPECT_EQ(venue.Missions->Text(), "无");
  EXPECT_EQ(venue.Missions->Items()[1].Text, "自由混战");
}

class MissionScores : public testing::Test {
 protected:
  static constexpr int Red0 = 1;
  static constexpr int Blue0 = 33;
  static constexpr int Yellow0 = 65;

  MissionScores() {
    venue.AddMission("'Other', 1, 2, 3, 4, 5, 6, 7, 8");
    venue.AddMission("'Test', 100, 10, 200, 20, 400, 40, 0, 0");
    venue.Factors = {0, 0, 0, 0, 0, -1};
    venue.Activate(Red0);
    venue.Activate(Blue0);
    venue.Activate(Yellow0);
  }

  void Score() {
    venue.Open();
    venue.Missions->Select(3);
    venue.CalculateScores();
  }

  void Set(const std::string& assignments) {
    ExecuteSql(venue.ScenariosFile(), "UPDATE Table1 SET " + assignments);
  }

  int ScoreOf(int index) { return venue.game.Players(index).Soldiering; }

  ScoredGame venue;
};

TEST_F(MissionScores, PayOnlyTheTeamThatPlaysTheSet) {
  venue.game.ObjectiveTeams(2).PrimaryAchieved = true;
  venue.Activate(224);  // blue 95
  Score();
  EXPECT_EQ(ScoreOf(Red0), 0);
  EXPECT_EQ(ScoreOf(Blue0), 200);
  EXPECT_EQ(ScoreOf(224), 200);
  EXPECT_EQ(ScoreOf(Yellow0), 0);
}

TEST_F(MissionScores, PayEachAchievedObjectiveItsOwnPoints) {
  const int expected[] = {110, 220, 440};
  for (int set = 1; set <= TeamCount; ++set) {
    venue.game.ObjectiveTeams(set).PrimaryAchieved = venue.game.ObjectiveTeams(set).SecondaryAchieved = true;
  }
  Score();
  for (int set = 1; set <= TeamCount; ++set) {
    EXPECT_EQ(ScoreOf(32 * (set - 1) + 1), expected[set - 1]);
  }
}

TEST_F(MissionScores, FollowPermutedSets) {
  venue.game.ObjectiveTeams(1).Name = "Yellow";
  venue.game.ObjectiveTeams(1).SecondaryAchieved = true;
  venue.game.ObjectiveTeams(3).Name = "Red";
  venue.game.ObjectiveTeams(3).PrimaryAchieved = true;
  Score();
  EXPECT_EQ(ScoreOf(Red0), 400);
  EXPECT_EQ(ScoreOf(Yellow0), 10);
}

TEST_F(MissionScores, PayBothSetsOfOneTeam) {
  venue.game.ObjectiveTeams(2).Name = "Red";
  venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
  venue.game.ObjectiveTeams(2).PrimaryAchieved = true;
  Score();
  EXPECT_EQ(ScoreOf(Red0), 300);
  EXPECT_EQ(ScoreOf(Blue0), 0);
}

TEST_F(MissionScores, PayNobodyForASetOfAnUnknownTeam) {
  for (const char* name : {"red", "Red ", "Green", ""}) {
    venue.game.ObjectiveTeams(1).Name = name;
    venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
    Score();
    EXPECT_EQ(ScoreOf(Red0) + ScoreOf(Blue0) + ScoreOf(Yellow0), 0) << name;
  }
}

TEST_F(MissionScores, TakePenaltiesFromEverybodyRoundedOneByOne) {
  Set("RespawnPenalty = 0.5, HealPenalty = 1.5");
  venue.game.Players(Red0).RespawnCount = 1;   // -0.5 is 0
  venue.game.Players(Red0).HealCount = 1;      // -1.5 is -2
  venue.game.Players(Blue0).RespawnCount = 3;  // -1.5 is -2
  venue.game.Players(Blue0).HealCount = 1;     // -3.5 is -4
  Score();
  EXPECT_EQ(ScoreOf(Red0), -2);
  EXPECT_EQ(ScoreOf(Blue0), -4);
  EXPECT_EQ(ScoreOf(Yellow0), 0);
}

TEST_F(MissionScores, TakeTheRespawnPenaltyFirst) {
  Set("RespawnPenalty = 0.5, HealPenalty = 0.75");
  venue.game.Players(Red0).RespawnCount = 1;  // -0.5 is 0
  venue.game.Players(Red0).HealCount = 1;     // -0.75 is -1; the other way round -1, then -1.5 is -2
  Score();
  EXPECT_EQ(ScoreOf(Red0), -1);
}

TEST_F(MissionScores, RoundThePointsOfEachObjective) {
  Set("PrimaryObjectivePointsA = 0.5, SecondaryObjectivePointsA = 0.5");
  venue.game.ObjectiveTeams(1).PrimaryAchieved = venue.game.ObjectiveTeams(1).SecondaryAchieved = true;
  venue.game.Players(Blue0).BonusPoints = 1;
  venue.game.ObjectiveTeams(2).Name = "Red";
  Score();
  EXPECT_EQ(ScoreOf(Red0), 0);
}

TEST_F(MissionScores, PayTheSetsInTheirOrderPrimaryFirst) {
  Set("PrimaryObjectivePointsA = 0.5, SecondaryObjectivePointsA = 0.75, PrimaryObjectivePointsB = 0.5");
  venue.game.ObjectiveTeams(1).PrimaryAchieved = venue.game.ObjectiveTeams(1).SecondaryAchieved = true;
  venue.game.ObjectiveTeams(2).Name = "Red";
  venue.game.ObjectiveTeams(2).PrimaryAchieved = true;
  Score();
  EXPECT_EQ(ScoreOf(Red0), 2);  // 0.5 is 0, 0.75 is 1, 1.5 is 2; secondary first gives 1, 2, 2.5 is 2
  venue.game.ObjectiveTeams(2).PrimaryAchieved = false;
  Score();
  EXPECT_EQ(ScoreOf(Red0), 1);  // secondary first gives 1, then 1.5 is 2
}

// See Soldiering.IsReckonedInMoreThanDoublePrecision.
TEST_F(MissionScores, AreReckonedInMoreThanDoublePrecision) {
  Set("RespawnPenalty = 0.3, HealPenalty = 0.3, PrimaryObjectivePointsC = 0.49999999999999994");
  venue.game.Players(Red0).RespawnCount = 5;
  venue.game.Players(Blue0).HealCount = 5;
  venue.game.Players(Yellow0).BonusPoints = 1;
  venue.game.ObjectiveTeams(3).PrimaryAchieved = true;
  Score();
  EXPECT_EQ(ScoreOf(Red0), -1);
  EXPECT_EQ(ScoreOf(Blue0), -1);
  EXPECT_EQ(ScoreOf(Yellow0), 1);
}

TEST_F(MissionScores, StartFromTheRoundedSum) {
  Set("PrimaryObjectivePointsA = 0.5");
  venue.Factors.Heal = 0.5;
  venue.game.Players(Red0).HealCount = 1;
  venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
  Score();
  EXPECT_EQ(ScoreOf(Red0), 0);
}

TEST_F(MissionScores, OutsideTheRangeAreAnOverflow) {
  Set("PrimaryObjectivePointsA = 2147483648");
  venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
  EXPECT_EQ(NumberThrownBy([this] { Score(); }), 6);
}

TEST_F(MissionScores, WithoutAValueAreNothing) {
  ExecuteSql(venue.ScenariosFile(),
             "CREATE TABLE Foreign1 AS SELECT * FROM Table1; DROP TABLE Table1; ALTER TABLE Foreign1 RENAME "
             "TO Table1");
  Set("PrimaryObjectivePointsA = NULL, SecondaryObjectivePointsB = ' 25', RespawnPenalty = NULL");
  venue.game.ObjectiveTeams(1).PrimaryAchieved = venue.game.ObjectiveTeams(1).SecondaryAchieved = true;
  venue.game.ObjectiveTeams(2).SecondaryAchieved = true;
  venue.game.Players(Red0).RespawnCount = 5;
  Score();
  EXPECT_EQ(ScoreOf(Red0), 10);
  EXPECT_EQ(ScoreOf(Blue0), 25);
}

TEST_F(MissionScores, AreNotPaidInTheFixedModes) {
  Set("RespawnPenalty = 5");
  venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
  venue.game.Players(Red0).RespawnCount = 1;
  venue.Open();
  for (const int mode : {MissionList::None, MissionList::FreeForAll}) {
    venue.Missions->Select(mode);
    venue.CalculateScores();
    EXPECT_EQ(ScoreOf(Red0), 0);
  }
}

TEST_F(MissionScores, SeeAChangeOfTheMission) {
  venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
  Score();
  EXPECT_EQ(ScoreOf(Red0), 100);
  Set("PrimaryObjectivePointsA = 70");
  venue.CalculateScores();
  EXPECT_EQ(ScoreOf(Red0), 70);
}

TEST_F(MissionScores, LeaveTheCursorOnTheMission) {
  Score();
  EXPECT_EQ(TextOf(venue.RsScenarios->Fields("MissionName")), "Test");
}

TEST_F(MissionScores, OfAVanishedMissionAreMissingWithABoxForEachPlayer) {
  venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
  venue.Open();
  venue.Missions->Select(3);
  ExecuteSql(venue.ScenariosFile(), "DELETE FROM Table1 WHERE MissionName = 'Test'");
  venue.CalculateScores();
  EXPECT_EQ(ScoreOf(Red0), 0);
  const FakeMessageBoxes::Box box{"Could not locate selected Mission in Mission Database",
                                  "Mission Database Error", BoxIcon::Exclamation, BoxButtons::Ok};
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(box, box, box));
  EXPECT_EQ(venue.Board.RowCount(), 3);
}

TEST(RandomMissions, AgreeWithALongHandReckoning) {
  const MissionPay pay{.Primary = {100.5, 0.5, -30.25},
                       .Secondary = {10.5, 7, 2.5},
                       .RespawnPenalty = 0.5,
                       .HealPenalty = -1.25};
  for (unsigned seed = 0; seed < 16; ++seed) {
    SCOPED_TRACE(seed);
    ScoredGame venue;
    venue.AddMission("'Keep', 100.5, 10.5, 0.5, 7, -30.25, 2.5, 0.5, -1.25");
    FillRandomly(venue.game, 60, seed);
    for (int set = 1; set <= TeamCount; ++set) {
      const unsigned bits = (seed * 37 + static_cast<unsigned>(set) * 11) % 13;
      venue.game.ObjectiveTeams(set) = {venue.game.TeamNames(1 + static_cast<int>(bits % 3)), bits % 2 == 0,
                                        bits % 5 != 0};
    }
    venue.Open();
    venue.Missions->Select(2);
    ExpectReckonedScores(venue, {.Factors = venue.Factors, .Mission = &pay});
  }
}

}  // namespace
