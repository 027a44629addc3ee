#include "charts/HitMatrix.h"

#include <gmock/gmock.h>

#include "charts/HeatScale.h"
#include "tests/charts/ChartGames.h"

namespace {

using testing::ElementsAre;

std::vector<std::string> NamesIn(const HitMatrix& matrix) {
  std::vector<std::string> names;
  for (int place = 0; place < matrix.Size(); ++place) {
    names.push_back(matrix.PlayerAt(place).Name);
  }
  return names;
}

TEST(HitMatrix, GroupsPlayersByTeamAndOrdersThemByNumber) {
  const StringTable strings(Language::English);
  const Game game(strings);
  const HitMatrix matrix(ChartOf(game, {Yellow0, Red32, Blue0, Red1, Red0}));
  EXPECT_THAT(NamesIn(matrix), ElementsAre("Red  0", "Red  1", "Red  32", "Blue  0", "Yellow  0"));
  ASSERT_EQ(matrix.Groups().size(), 3U);
  EXPECT_EQ(matrix.Groups()[0].Team, 1);
  EXPECT_EQ(matrix.Groups()[0].First, 0);
  EXPECT_EQ(matrix.Groups()[0].Count, 3);
  EXPECT_EQ(matrix.Groups()[1].First, 3);
  EXPECT_EQ(matrix.Groups()[2].Team, 3);
  EXPECT_EQ(matrix.TeamAt(4), 3);
}

TEST(HitMatrix, HasTheShooterInTheRowAndTheVictimInTheColumn) {
  const StringTable strings(Language::English);
  Game game(strings);
  game.Players(Blue0).HitByPlayer(Red0) = 120;
  game.Players(Red0).HitByPlayer(Blue0) = 30;
  game.Players(Red0).HitByPlayer(Red0) = 7;
  const HitMatrix matrix(ChartOf(game, {Red0, Blue0}));
  EXPECT_EQ(matrix.Damage(0, 1), 120);
  EXPECT_EQ(matrix.Damage(1, 0), 30);
  EXPECT_EQ(matrix.Damage(0, 0), 7);
  EXPECT_EQ(matrix.Damage(1, 1), 0);
  EXPECT_EQ(matrix.Most(), 120);
  EXPECT_TRUE(matrix.IsOwnTeam(0, 0));
  EXPECT_FALSE(matrix.IsOwnTeam(0, 1));
}

TEST(HitMatrix, LeavesOutHitsOfPlayersWhoTookNoPartAndNegativeAmounts) {
  const StringTable strings(Language::English);
  Game game(strings);
  game.Players(Red0).HitByPlayer(Yellow0) = 500;
  game.Players(Red0).HitByPlayer(Red1) = -40;
  const HitMatrix matrix(ChartOf(game, {Red0, Red1}));
  EXPECT_EQ(matrix.Most(), 0);
  EXPECT_EQ(matrix.Damage(1, 0), 0);
}

TEST(HitMatrix, KnowsNoOwnTeamInAFreeForAll) {
  const StringTable strings(Language::English);
  Game game(strings);
  game.Players(Red1).HitByPlayer(Red0) = 40;
  ChartGame chart = ChartOf(game, {Red0, Red1, Blue0});
  EXPECT_TRUE(HitMatrix(chart).HasTeams());
  EXPECT_TRUE(HitMatrix(chart).IsOwnTeam(0, 1));
  chart.FreeForAll = true;
  const HitMatrix matrix(chart);
  EXPECT_FALSE(matrix.HasTeams());
  EXPECT_FALSE(matrix.IsOwnTeam(0, 1));
  EXPECT_FALSE(matrix.IsOwnTeam(0, 0));
  EXPECT_EQ(matrix.Damage(0, 1), 40);
  EXPECT_EQ(matrix.Groups().size(), 2U);  // colours of guns order the players all the same
}

TEST(HitMatrix, WithoutPlayersIsEmpty) {
  const StringTable strings(Language::English);
  const Game game(strings);
  EXPECT_EQ(HitMatrix(ChartOf(game, {})).Size(), 0);
  EXPECT_EQ(HitMatrix().Most(), 0);
}

/// How the colour looks to those who lack one kind of cone: red (protanopes) or green (deuteranopes).
Rgb AsSeenWithout(const Rgb& colour, bool red) {
  const auto mixed = [](double value) { return static_cast<std::uint8_t>(std::clamp(value, 0.0, 255.0)); };
  if (red) {
    return {mixed(0.11 * colour.Red + 0.89 * colour.Green), mixed(0.11 * colour.Red + 0.89 * colour.Green),
            mixed(0.004 * colour.Red - 0.004 * colour.Green + colour.Blue)};
  }
  return {mixed(0.29 * colour.Red + 0.71 * colour.Green), mixed(0.29 * colour.Red + 0.71 * colour.Green),
          mixed(-0.02 * colour.Red + 0.02 * colour.Green + colour.Blue)};
}

TEST(HeatColours, FallInLightnessByEvenSteps) {
  constexpr int steps = 20;
  double before = LightnessOf(HeatColour(0));
  EXPECT_GT(before, 90);
  for (int step = 1; step <= steps; ++step) {
    const double lightness = LightnessOf(HeatColour(static_cast<double>(step) / steps));
    EXPECT_NEAR(before - lightness, 73.0 / steps, 1.2) << step;
    before = lightness;
  }
  EXPECT_LT(before, 22);
}

TEST(HeatColours, FallInLightnessForTheColourBlindToo) {
  for (const bool red : {true, false}) {
    double before = 101;
    for (int step = 0; step <= 20; ++step) {
      const double lightness = LightnessOf(AsSeenWithout(HeatColour(step / 20.0), red));
      EXPECT_LT(lightness, before) << step;
      before = lightness;
    }
  }
}

TEST(HeatColours, BeyondTheEndsAreThoseOfTheEnds) {
  EXPECT_EQ(HeatColour(-1).Red, HeatColour(0).Red);
  EXPECT_EQ(HeatColour(2).Blue, HeatColour(1).Blue);
}

}  // namespace
