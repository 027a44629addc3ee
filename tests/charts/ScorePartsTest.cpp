#include "charts/ScoreParts.h"

#include <gmock/gmock.h>

#include <cmath>
#include <numeric>

#include "tests/charts/ChartGames.h"
#include "tests/support/RandomGame.h"
#include "tests/support/ScoredGame.h"

namespace {

using testing::ElementsAre;

/// The chart of a game that has been scored, with what its scores were made from.
ChartGame ChartOf(ScoredGame& venue) {
  ChartGame chart = ChartOf(venue.game);
  chart.Factors = venue.Factors;
  chart.FreeForAll = venue.Missions->ListIndex() == MissionList::FreeForAll;
  if (venue.Missions->ListIndex() > MissionList::FreeForAll) {
    venue.Missions->ActivateCurrentMissionRecord();
    chart.PointsOfMission = ReadMissionPoints(venue.Missions->Row());
  }
  return chart;
}

std::int64_t SumOf(const PlayerParts& player) {
  return std::accumulate(player.Hundredths.begin(), player.Hundredths.end(), std::int64_t{});
}

/// The parts as they are read, by their order.
std::vector<std::string> TextsOf(const PlayerParts& player) {
  std::vector<std::string> texts;
  for (const std::int64_t part : player.Hundredths) {
    texts.push_back(PointsText(part));
  }
  return texts;
}

TEST(ScoreParts, TellWhatEachFactorGave) {
  ScoredGame venue;
  venue.Factors = {2, -3, -4, -5, 0.5, -1.5};
  Player& player = venue.Activate(Red0);
  player.HealCount = 1;
  player.DeathCount = 3;
  player.AmmoAddCount = 2;
  player.PrimaryDamage = 10;
  player.ShotCount = 60;
  player.BonusPoints = -6;
  venue.game.Players(Blue0).HitByPlayer(Red0) = 250;
  venue.game.Players(Red1).HitByPlayer(Red0) = 30;
  venue.game.Players(Red0).HitByPlayer(Red0) = 20;
  venue.CalculateScores();
  const std::vector<PlayerParts> parts = ScorePartsOf(ChartOf(venue));
  ASSERT_EQ(parts.size(), 1U);
  EXPECT_THAT(TextsOf(parts[0]),
              ElementsAre("500", "-150", "25", "-9", "-4", "-10", "-6", "0", "0", "0", "0", "0"));
  EXPECT_EQ(player.Soldiering, 346);
  EXPECT_EQ(SumOf(parts[0]), 34600);
  EXPECT_THAT(PartsInUse(parts),
              ElementsAre(ScorePart::Damage, ScorePart::OwnTeam, ScorePart::Accuracy, ScorePart::Deaths,
                          ScorePart::Heals, ScorePart::AmmoAdds, ScorePart::Bonus));
}

TEST(ScoreParts, TellWhatTheMissionGaveAndTook) {
  ScoredGame venue;
  venue.AddMission("'Bridge', 100, 20.5, 7, 8, 1000, 2000, 3, 2.5");
  venue.game.ObjectiveTeams(1) = {"Red", true, true};
  venue.game.ObjectiveTeams(2) = {"Red", false, true};
  venue.game.ObjectiveTeams(3) = {"Blue", true, true};
  Player& player = venue.Activate(Red0);
  player.RespawnCount = 4;
  player.HealCount = 3;
  venue.Open();
  venue.Missions->Select(2);
  venue.CalculateScores();
  const std::vector<PlayerParts> parts = ScorePartsOf(ChartOf(venue));
  // 0 - 3 = -3, + 100 = 97, + 20.5 = 117.5 -> 118, + 8 = 126, - 12 = 114, - 7.5 = 106.5 -> 106
  EXPECT_EQ(player.Soldiering, 106);
  EXPECT_THAT(TextsOf(parts[0]),
              ElementsAre("0", "0", "0", "0", "-3", "0", "0", "128.5", "-12", "-7.5", "0", "0"));
}

TEST(ScoreParts, CallWhatRoundingAddsOrTakesByItsName) {
  ScoredGame venue;
  venue.Factors.FriendlyFire = 0.5;
  venue.Factors.Damage = 1;
  venue.Activate(Red0);
  venue.Activate(Blue0);
  // Half a point twice is rounded away twice.
  venue.game.Players(Red1).HitByPlayer(Red0) = 1;
  venue.game.Players(3).HitByPlayer(Red0) = 1;
  // A third of the shots, 33.33 points.
  venue.game.Players(Blue0).PrimaryDamage = 1;
  venue.game.Players(Blue0).ShotCount = 3;
  venue.game.Players(Red0).HitByPlayer(Blue0) = 1;
  venue.CalculateScores();
  const std::vector<PlayerParts> parts = ScorePartsOf(ChartOf(venue));
  ASSERT_EQ(parts.size(), 2U);
  EXPECT_EQ(parts[0].Player.Index, Blue0);
  EXPECT_EQ(parts[0].Soldiering, 34);
  EXPECT_EQ(PointsText(parts[0].Of(ScorePart::Accuracy)), "33.33");
  EXPECT_EQ(PointsText(parts[0].Of(ScorePart::Rounding)), "-0.33");
  EXPECT_EQ(parts[1].Soldiering, 0);
  EXPECT_EQ(PointsText(parts[1].Of(ScorePart::OwnTeam)), "1");
  EXPECT_EQ(PointsText(parts[1].Of(ScorePart::Rounding)), "-1");
}

TEST(ScoreParts, CountHitsOnOnesOwnTeamAsAnyOtherInAFreeForAll) {
  ScoredGame venue;
  venue.Activate(Red0);
  venue.game.Players(Red1).HitByPlayer(Red0) = 30;
  venue.Open();
  venue.Missions->Select(MissionList::FreeForAll);
  venue.CalculateScores();
  const std::vector<PlayerParts> parts = ScorePartsOf(ChartOf(venue));
  EXPECT_EQ(PointsText(parts[0].Of(ScorePart::Damage)), "30");
  EXPECT_EQ(parts[0].Of(ScorePart::OwnTeam), 0);
}

TEST(ScoreParts, AddUpToTheBoardInRandomGamesWithNothingUnexplained) {
  for (const double friendlyFire : {-1.0, 0.5, 0.1, -0.37, 2.5e-7, 0.0, 3.0}) {
    for (const int count : {3, 40, 224}) {
      for (const int mode : {0, 1, 2}) {
        SCOPED_TRACE(testing::Message() << count << " players, mode " << mode << ", factor " << friendlyFire);
        ScoredGame venue;
        venue.AddMission("'Bridge', 100.5, -20.25, 7.75, 8, 0.5, 2000, 1.5, -2.5");
        FillRandomly(venue.game, count, 11U * static_cast<unsigned>(count + mode));
        venue.game.ObjectiveTeams(1) = {"Blue", true, true};
        venue.game.ObjectiveTeams(2) = {"Red", true, false};
        venue.game.ObjectiveTeams(3) = {"Blue", true, false};
        venue.Factors = {1.25, -2, -0.55, 0.75, 1.5, friendlyFire};
        venue.Open();
        venue.Missions->Select(mode);
        venue.CalculateScores();
        const std::vector<PlayerParts> parts = ScorePartsOf(ChartOf(venue));
        ASSERT_EQ(parts.size(), static_cast<std::size_t>(count));
        for (const PlayerParts& player : parts) {
          ASSERT_EQ(player.Soldiering, venue.game.Players(player.Player.Index).Soldiering);
          ASSERT_EQ(SumOf(player), player.Soldiering * std::int64_t{100});
          ASSERT_EQ(player.Of(ScorePart::Other), 0) << player.Player.Name;
        }
      }
    }
  }
}

TEST(ScoreParts, RoundingStaysWithinWhatItsStepsCanGive) {
  ScoredGame venue;
  FillRandomly(venue.game, 40, 5);
  venue.Factors = {1, -2.25, -0.5, 0.75, 1.5, -1};
  venue.CalculateScores();
  for (const PlayerParts& player : ScorePartsOf(ChartOf(venue))) {
    // One step of at most half a point, and half a hundredth for each part that is shown.
    EXPECT_LE(std::abs(player.Of(ScorePart::Rounding)), 55) << player.Player.Name;
  }
}

TEST(ScoreParts, StandHighestFirstAndEqualOnesByRecord) {
  ScoredGame venue;
  for (const auto& [index, points] : {std::pair{Yellow0, 5}, {Blue0, 5}, {Red0, -3}, {Red1, 9}}) {
    venue.Activate(index).BonusPoints = points;
  }
  venue.CalculateScores();
  std::vector<int> order;
  for (const PlayerParts& player : ScorePartsOf(ChartOf(venue))) {
    order.push_back(player.Player.Index);
  }
  EXPECT_THAT(order, ElementsAre(Red1, Blue0, Yellow0, Red0));
}

TEST(ScoreParts, AreOtherWhereFactorsAndMissionDoNotExplainTheScore) {
  ScoredGame venue;
  venue.Activate(Red0).DeathCount = 10;
  venue.CalculateScores();
  ChartGame chart = ChartOf(venue);
  chart.Factors.Death = -4;
  const PlayerParts parts = ScorePartsOf(chart).at(0);
  EXPECT_EQ(PointsText(parts.Of(ScorePart::Deaths)), "-40");
  EXPECT_EQ(PointsText(parts.Of(ScorePart::Other)), "30");
  EXPECT_EQ(parts.Of(ScorePart::Rounding), 0);
  EXPECT_EQ(SumOf(parts), -1000);
}

TEST(ScoreParts, OfImpossibleFactorsStillAddUp) {
  ScoredGame venue;
  venue.Activate(Red0).DeathCount = 10;
  venue.CalculateScores();
  ChartGame chart = ChartOf(venue);
  chart.Factors.Death = -1e300;
  EXPECT_EQ(SumOf(ScorePartsOf(chart).at(0)), -1000);
}

TEST(PointsText, HasOnlyTheDecimalsThatItNeeds) {
  EXPECT_EQ(PointsText(0), "0");
  EXPECT_EQ(PointsText(1200), "12");
  EXPECT_EQ(PointsText(-50), "-0.5");
  EXPECT_EQ(PointsText(-1205), "-12.05");
  EXPECT_EQ(PointsText(3333), "33.33");
}

}  // namespace
