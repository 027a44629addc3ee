#include "core/Game.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/platform/linux/Thrown.h"

namespace {

TEST(Game, BeginsWithTheThreeTeamsOnTheThreeObjectiveSets) {
  const StringTable strings(Language::English);
  const Game game(strings);
  const char* names[] = {"Red", "Blue", "Yellow"};
  for (int team = 1; team <= TeamCount; ++team) {
    EXPECT_EQ(game.TeamNames(team), names[team - 1]);
    EXPECT_EQ(game.ObjectiveTeams(team).Name, names[team - 1]);
    EXPECT_FALSE(game.ObjectiveTeams(team).PrimaryAchieved || game.ObjectiveTeams(team).SecondaryAchieved);
  }
  EXPECT_FALSE(game.DataPresent);
  EXPECT_TRUE(game.GameDate.empty());
}

TEST(Game, NamesAPlayerWithTwoBlanksBeforeTheNumber) {
  const StringTable strings(Language::English);
  const Game game(strings);
  EXPECT_EQ(game.DisplayName(40), "Blue  7");
  EXPECT_EQ(game.DisplayName(105), "Red  40");
  EXPECT_EQ(game.DisplayName(224), "Blue  95");
}

TEST(ClearedGame, KeepsOnlyAbsoluteDamageAndAccuracyOfAPlayer) {
  const StringTable strings(Language::English);
  Game game(strings);
  Player& player = game.Players(5);
  player.HitByPlayer(7) = 3;
  player.ShotCount = player.Soldiering = player.BonusPoints = player.MemberIndex = 9;
  player.AbsoluteDamage = 11;
  player.Accuracy = 0.5F;
  player.Active = player.Committed = true;
  player.Rank = 4;
  player.DallasID = "AA00000000000001";
  game.GameDate = "today";
  game.DataPresent = true;
  game.Clear();
  EXPECT_EQ(player.HitByPlayer(7) + player.ShotCount + player.Soldiering + player.BonusPoints + player.MemberIndex, 0);
  EXPECT_FALSE(player.Active || player.Committed);
  EXPECT_EQ(player.Rank, 0);
  EXPECT_EQ(player.DallasID, "0000000000000000");
  EXPECT_EQ(player.AbsoluteDamage, 11);
  EXPECT_EQ(player.Accuracy, 0.5F);
  EXPECT_TRUE(game.GameDate.empty());
  EXPECT_FALSE(game.DataPresent);
}

TEST(ClearedGame, KeepsTheResultsOfTheObjectives) {
  const StringTable strings(Language::English);
  Game game(strings);
  game.ObjectiveTeams(2).Name = "Red";
  game.ObjectiveTeams(2).PrimaryAchieved = true;
  game.Clear();
  EXPECT_EQ(game.ObjectiveTeams(2).Name, "Red");
  EXPECT_TRUE(game.ObjectiveTeams(2).PrimaryAchieved);
}

TEST(OneBased, RefusesIndexesOutsideWith9) {
  OneBased<int, 3> table;
  table(1) = 10;
  table(3) = 30;
  EXPECT_EQ(*table.begin(), 10);
  EXPECT_EQ(NumberThrownBy([&table] { table(0) = 1; }), 9);
  EXPECT_EQ(NumberThrownBy([&table] { table(4) = 1; }), 9);
}

}  // namespace
