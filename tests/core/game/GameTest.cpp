#include "core/game/Game.h"

#include <gtest/gtest.h>

#include "tests/support/Described.h"
#include "tests/support/RandomGame.h"
#include "tests/support/Thrown.h"

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

TEST(Game, CarriesTheTeamsInTheLanguageOfItsTexts) {
  const StringTable strings(Language::SimplifiedChinese);
  const Game game(strings);
  EXPECT_EQ(game.TeamNames(3), "黄队");
  EXPECT_EQ(game.ObjectiveTeams(1).Name, "红队");
  EXPECT_EQ(game.DisplayName(65), "黄队  0");
}

TEST(Game, HasAnEmptyRecordForEachGunAtFirst) {
  const StringTable strings(Language::English);
  const Game game(strings);
  EXPECT_EQ(game.Players.end() - game.Players.begin(), 224);
  for (const Player& player : game.Players) {
    EXPECT_EQ(Described(player), Described(Player()));
  }
  EXPECT_EQ(Player().DallasID, "0000000000000000");
}

TEST(ClearedGame, KeepsOnlyAbsoluteDamageAndAccuracyOfAPlayer) {
  const StringTable strings(Language::English);
  Game game(strings);
  FillRandomly(game, PlayerCount, 4);
  for (Player& player : game.Players) {
    player.TotalDamage = player.Soldiering = player.MemberIndex = 9;
    player.AbsoluteDamage = 11;
    player.Rank = 4;
    player.DallasID = "AA00000000000001";
    player.Accuracy = 0.5F;
  }
  game.GameDate = "today";
  game.DataPresent = true;
  game.Clear();
  Player expected;
  expected.AbsoluteDamage = 11;
  expected.Accuracy = 0.5F;
  for (const Player& player : game.Players) {
    ASSERT_EQ(Described(player), Described(expected));
  }
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
  EXPECT_EQ(*(table.end() - 1), 30);
  EXPECT_EQ(table(2), 0);
  EXPECT_EQ(NumberThrownBy([&table] { table(0) = 1; }), 9);
  EXPECT_EQ(NumberThrownBy([&table] { table(-1) = 1; }), 9);
  EXPECT_EQ(NumberThrownBy([&table] { table(4) = 1; }), 9);
}

}  // namespace
