#include <gtest/gtest.h>

#include <iterator>
#include <limits>
#include <random>
#include <string>

#include "core/game/ScoreAnalysis.h"
#include "tests/support/ScoredGame.h"
#include "tests/support/Thrown.h"

namespace {

constexpr int Red0 = 1;
constexpr int Red1 = 2;
constexpr int Blue0 = 33;
constexpr int Blue7 = 40;
constexpr int Yellow0 = 65;
constexpr int Red32 = 97;
constexpr int Blue95 = 224;
constexpr std::int32_t Most = std::numeric_limits<std::int32_t>::max();
constexpr std::int32_t Least = std::numeric_limits<std::int32_t>::min();

TEST(FriendlyFire, IsRoundedHitByHit) {
  ScoredGame venue;
  venue.Factors.FriendlyFire = 0.5;
  venue.Activate(Red0);
  venue.game.Players(Red1).HitByPlayer(Red0) = 1;
  venue.game.Players(3).HitByPlayer(Red0) = 1;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, 0);
  EXPECT_EQ(venue.game.Players(Red0).AbsoluteDamage, 2);
}

TEST(FriendlyFire, IsRoundedTogetherWithTheSumSoFarInTheOrderOfTheVictims) {
  ScoredGame venue;
  venue.Factors.FriendlyFire = 0.5;
  venue.Activate(Red0);
  venue.game.Players(Red1).HitByPlayer(Red0) = 1;   // 0.5 is 0
  venue.game.Players(Blue0).HitByPlayer(Red0) = 1;  // 1
  venue.game.Players(Red32).HitByPlayer(Red0) = 1;  // 1.5 is 2
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, 2);
}

TEST(FriendlyFire, WeighsOwnTeamHitsByItsFactor) {
  const std::pair<double, int> cases[] = {{-1, -50},   {0, 0},  {0.1, 5},   {3, 150},
                                          {2.5e-7, 0}, {1, 50}, {-0.5, -25}};
  for (const auto& [factor, expected] : cases) {
    ScoredGame venue;
    venue.Factors.FriendlyFire = factor;
    venue.Activate(Red0);
    venue.game.Players(Red1).HitByPlayer(Red0) = 50;
    venue.CalculateScores();
    EXPECT_EQ(venue.game.Players(Red0).TotalDamage, expected) << factor;
    EXPECT_EQ(venue.game.Players(Red0).AbsoluteDamage, 50) << factor;
  }
}

TEST(FriendlyFire, IsOnlyForTheOwnTeamInAllItsBlocks) {
  ScoredGame venue;
  venue.Activate(Blue95);
  for (const int victim : {Blue0, 161, 193}) {
    venue.game.Players(victim).HitByPlayer(Blue95) = 10;
  }
  for (const int victim : {Red0, Yellow0, Red32, 129}) {
    venue.game.Players(victim).HitByPlayer(Blue95) = 1;
  }
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Blue95).TotalDamage, 4 - 30);
}

TEST(FriendlyFire, CountsInFullInFreeForAllOnly) {
  const std::pair<int, int> cases[] = {{MissionList::None, -57}, {MissionList::FreeForAll, 57}, {2, -57}};
  for (const auto& [mode, expected] : cases) {
    ScoredGame venue;
    venue.AddMission("'Keep', 0, 0, 0, 0, 0, 0, 0, 0");
    venue.Activate(Red0);
    venue.game.Players(Red1).HitByPlayer(Red0) = 50;
    venue.game.Players(Red0).HitByPlayer(Red0) = 7;
    venue.Open();
    venue.Missions->Select(mode);
    venue.CalculateScores();
    EXPECT_EQ(venue.game.Players(Red0).TotalDamage, expected) << mode;
  }
}

TEST(FriendlyFire, MakesASelfHitCostPoints) {
  ScoredGame venue;
  venue.Activate(Red0).HitByPlayer(Red0) = 7;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, -7);
}

TEST(Damage, CountsHitsOnPlayersWhoAreNotActive) {
  ScoredGame venue;
  venue.Activate(Red0);
  venue.game.Players(Yellow0).HitByPlayer(Red0) = 11;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, 11);
}

TEST(Damage, OfInactivePlayersIsRewrittenToo) {
  ScoredGame venue;
  venue.game.Players(Red0).TotalDamage = 99;
  venue.game.Players(Red0).AbsoluteDamage = 99;
  venue.game.Players(Blue0).HitByPlayer(Red1) = 4;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, 0);
  EXPECT_EQ(venue.game.Players(Red0).AbsoluteDamage, 0);
  EXPECT_EQ(venue.game.Players(Red1).TotalDamage, 4);
  EXPECT_EQ(venue.Board.RowCount(), 0);
}

TEST(Damage, MayReachBothEndsOfTheRange) {
  ScoredGame venue;
  venue.Factors.Damage = 0;
  venue.game.Players(Blue0).HitByPlayer(Red0) = Most - 1;
  venue.game.Players(Blue7).HitByPlayer(Red0) = 1;
  venue.game.Players(Blue0).HitByPlayer(Red1) = Least + 1;
  venue.game.Players(Blue7).HitByPlayer(Red1) = -1;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, Most);
  EXPECT_EQ(venue.game.Players(Red1).AbsoluteDamage, Least);
}

TEST(Damage, OutsideTheRangeIsAnOverflowEvenOfInactivePlayers) {
  struct Case {
    const char* What;
    double FriendlyFire;
    std::int32_t OnRed1;
    std::int32_t OnBlue0;
  };
  const Case cases[] = {{"own team, whole factor", 2, Most, 0},
                        {"own team, negative factor", -2, Most, 0},
                        {"own team, broken factor", 1.5, Most, 0},
                        {"own team, huge factor", 1e300, 1, 0},
                        {"own team, huge negative", -1e300, 1, 0},
                        {"own team, lowest by -1", -1, Least, 0},
                        {"foes upward", -1, -Most, 1},
                        {"foes downward", -1, Most, -2},
                        {"unweighted upward", 0, Most, 1},
                        {"unweighted downward", 0, Least, -1}};
  for (const Case& one : cases) {
    ScoredGame venue;
    venue.Factors.FriendlyFire = one.FriendlyFire;
    venue.game.Players(Red1).HitByPlayer(Red0) = one.OnRed1;
    venue.game.Players(Blue0).HitByPlayer(Red0) = one.OnBlue0;
    EXPECT_EQ(NumberThrownBy([&venue] { venue.CalculateScores(); }), 6) << one.What;
  }
}

TEST(Damage, OutsideTheRangeOnTheWayIsAnOverflowThoughTheSumIsNot) {
  ScoredGame venue;
  venue.game.Players(Red1).HitByPlayer(Red0) = 1;
  venue.game.Players(Blue0).HitByPlayer(Red0) = Most;
  venue.game.Players(Blue7).HitByPlayer(Red0) = -Most;
  EXPECT_EQ(NumberThrownBy([&venue] { venue.CalculateScores(); }), 6);
}

TEST(Damage, IsNotOutsideTheRangeWhileNobodyOfTheTeamIsHit) {
  ScoredGame venue;
  venue.Factors.FriendlyFire = 1e300;
  venue.Activate(Red0);
  venue.game.Players(Blue0).HitByPlayer(Red0) = 5;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, 5);
}

/// The damage of all players but `besides`, or that a figure left the range.
std::string DamageOf(ScoredGame& venue, int besides) {
  if (const int fault = NumberThrownBy([&venue] { venue.CalculateScores(); }); fault != 0) {
    return "fault " + std::to_string(fault);
  }
  std::string damage;
  for (int index = 1; index <= PlayerCount; ++index) {
    if (index != besides) {
      const Player& player = venue.game.Players(index);
      damage += std::to_string(player.TotalDamage) + '/' + std::to_string(player.AbsoluteDamage) + ' ';
    }
  }
  return damage;
}

// A single hit below 0, of a player without any other, has all hits added up one by one.
TEST(Damage, IsTheSameWhetherAddedUpAtOnceOrHitByHit) {
  std::mt19937 random(20);
  constexpr int outsider = Blue95;
  int faults = 0;
  ScoredGame venue;
  venue.Open();
  for (int game = 0; game < 300; ++game) {
    venue.game.Clear();
    const double factors[] = {-1, 0, 1, 2, -3, 1000, -70'000, 2147483647.0, 4e9};
    venue.Factors.FriendlyFire = factors[random() % std::size(factors)];
    const unsigned largest = 0x7FFFFFFFU >> random() % 31;
    for (int hit = 0; hit < 60; ++hit) {
      const int victim = 1 + static_cast<int>(random() % PlayerCount);
      const int shooter = 1 + static_cast<int>(random() % 8) * 28;
      if (shooter != outsider) {
        venue.game.Players(victim).HitByPlayer(shooter) = static_cast<std::int32_t>(random() & largest);
      }
    }
    venue.Missions->Select(static_cast<int>(random() % 2));
    const std::string atOnce = DamageOf(venue, outsider);
    venue.game.Players(Red0).HitByPlayer(outsider) = -1;
    ASSERT_EQ(atOnce, DamageOf(venue, outsider)) << "game " << game;
    faults += atOnce.starts_with("fault") ? 1 : 0;
  }
  EXPECT_GT(faults, 30);
  EXPECT_LT(faults, 270);
}

}  // namespace
