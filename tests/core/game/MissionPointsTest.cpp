#include "core/game/MissionPoints.h"

#include <gtest/gtest.h>

#include "platform/RuntimeError.h"
#include "tests/support/ScoredGame.h"

namespace {

class Points : public testing::Test {
 protected:
  Points() {
    venue.AddMission("'Test', 100, 10, 20.5, 2, -3, 0, 7, 2.5");
    venue.Open();
    venue.RsScenarios->MoveFirst();
    points = ReadMissionPoints(*venue.RsScenarios);
  }

  std::int32_t For(const char* team, std::int32_t score = 0) const {
    return WithObjectivePoints(score, points, results, team);
  }

  ScoredGame venue;
  MissionPoints points;
  OneBased<ObjectiveTeam, TeamCount> results;
};

TEST_F(Points, AreReadFromTheMissionsRow) {
  EXPECT_EQ(points.Primary, (std::array{100.0, 20.5, -3.0}));
  EXPECT_EQ(points.Secondary, (std::array{10.0, 2.0, 0.0}));
  EXPECT_EQ(points.RespawnPenalty, 7);
  EXPECT_EQ(points.HealPenalty, 2.5);
}

TEST_F(Points, GoToTheTeamThatPlaysTheSet) {
  results(1) = {"Red", true, false};
  results(2) = {"Blue", false, true};
  results(3) = {"Yellow", true, true};
  EXPECT_EQ(For("Red"), 100);
  EXPECT_EQ(For("Blue"), 2);
  EXPECT_EQ(For("Yellow"), -3);
}

TEST_F(Points, OfSeveralSetsGoToOneTeam) {
  results(1) = {"Red", true, true};
  results(2) = {"Red", true, false};
  EXPECT_EQ(For("Red"), 130);
  EXPECT_EQ(For("Blue"), 0);
}

TEST_F(Points, AreRoundedOneAfterTheOtherAndHalvesToEven) {
  results(2) = {"Blue", true, false};
  EXPECT_EQ(For("Blue", 0), 20);
  EXPECT_EQ(For("Blue", 1), 22);
  points.Secondary[1] = 0.5;
  results(2).SecondaryAchieved = true;
  EXPECT_EQ(For("Blue"), 20);  // not 21, the rounded sum
  points.Primary[1] = 2147483647;
  points.Secondary[1] = 1;
  EXPECT_THROW(For("Blue"), RuntimeError);
}

TEST_F(Points, AreWhatTheCalculationAdds) {
  venue.Missions->Select(2);
  venue.game.ObjectiveTeams(1) = {"Red", true, true};
  venue.game.ObjectiveTeams(2) = {"Red", false, true};
  venue.Activate(1);
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(1).Soldiering, 112);
  EXPECT_EQ(WithObjectivePoints(0, points, venue.game.ObjectiveTeams, "Red"), 112);
}

}  // namespace
