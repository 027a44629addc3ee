#include "sim/game/Evening.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <array>

#include "sim/game/GameMaker.h"

namespace sim {
namespace {

using namespace std::chrono_literals;
using ButtonId = std::array<std::uint8_t, 8>;

std::vector<ButtonId> ButtonsOf(const std::vector<GunScores>& game) {
  std::vector<ButtonId> buttons;
  for (const GunScores& scores : game) {
    if (scores.ButtonId != ButtonId{}) {
      buttons.push_back(scores.ButtonId);
    }
  }
  std::ranges::sort(buttons);
  return buttons;
}

TEST(Evening, HasAGameEachTimeItsSecondsHavePassed) {
  const Evening evening(12, 7, 20s);
  EXPECT_EQ(evening.NumberAt(0s), 1);
  EXPECT_EQ(evening.NumberAt(19'999'999us), 1);
  EXPECT_EQ(evening.NumberAt(20s), 2);
  EXPECT_EQ(evening.NumberAt(10min), 31);
}

TEST(Evening, HasOneGameWithoutSeconds) {
  EXPECT_EQ(Evening(12, 7, 0s).NumberAt(24h), 1);
}

TEST(Evening, BeginsWithTheGameOfItsSeed) {
  EXPECT_EQ(Evening(12, 7, 20s).Game(1), MakeGame(12, 7));
}

TEST(Evening, HasOtherFiguresInEachGame) {
  const Evening evening(12, 7, 20s);
  std::vector<std::vector<GunScores>> games;
  for (int number = 1; number <= 30; ++number) {
    games.push_back(evening.Game(number));
    EXPECT_EQ(games.back().size(), 12U);
    EXPECT_EQ(std::ranges::count(games, games.back()), 1) << "game " << number;
  }
  EXPECT_EQ(evening.Game(30), games.back());
}

TEST(Evening, HasNoGameOfTheNextSeedsEvening) {
  EXPECT_NE(Evening(12, 7, 20s).Game(2), Evening(12, 8, 20s).Game(1));
  EXPECT_NE(Evening(12, 7, 20s).Game(2), Evening(12, 8, 20s).Game(2));
}

TEST(Evening, HasTheSamePeopleWithTheirButtonsInOtherGuns) {
  const Evening evening(40, 1, 20s);
  const std::vector<GunScores> first = evening.Game(1);
  ASSERT_FALSE(ButtonsOf(first).empty());
  for (int number = 2; number <= 5; ++number) {
    EXPECT_EQ(ButtonsOf(evening.Game(number)), ButtonsOf(first)) << "game " << number;
  }
}

TEST(Evening, OfNobodyHasGamesWithoutGuns) {
  EXPECT_TRUE(Evening(0, 1, 20s).Game(3).empty());
}

}  // namespace
}  // namespace sim
