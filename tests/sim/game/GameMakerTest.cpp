#include "sim/game/GameMaker.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <map>
#include <set>
#include <stdexcept>

#include "sim/line/Crc.h"

namespace sim {
namespace {

int TeamOf(std::uint8_t playerId) {
  static const std::map<int, int> teamOfTopBits{{32, 1},  {64, 2},  {96, 3}, {128, 1},
                                                {160, 1}, {192, 2}, {224, 2}};
  return teamOfTopBits.at(playerId & 0xE0);
}

std::set<std::uint8_t> IdsOf(const std::vector<GunScores>& game) {
  std::set<std::uint8_t> ids;
  for (const GunScores& scores : game) {
    ids.insert(scores.PlayerId);
  }
  return ids;
}

std::array<int, 3> TeamSizes(const std::vector<GunScores>& game) {
  std::array<int, 3> sizes{};
  for (const GunScores& scores : game) {
    ++sizes.at(static_cast<std::size_t>(TeamOf(scores.PlayerId) - 1));
  }
  return sizes;
}

TEST(GameMaker, GivesTheSameGameForTheSameSeed) {
  EXPECT_EQ(MakeGame(40, 7), MakeGame(40, 7));
}

TEST(GameMaker, GivesAnotherGameForAnotherSeed) {
  EXPECT_NE(MakeGame(40, 7), MakeGame(40, 8));
}

// Pictures and instructions show this game, so it must not change by machine or by accident.
TEST(GameMaker, KeepsTheGameOfSeedOne) {
  const std::vector<GunScores> game = MakeGame(40, 1);
  ASSERT_EQ(game.size(), 40U);
  EXPECT_EQ(game[0].PlayerId, 98);
  EXPECT_EQ(game[0].ShotCount, 875);
  EXPECT_EQ(game[0].DeathCount, 12);
  EXPECT_EQ(game[0].PrimaryDamage, 40);
  EXPECT_EQ(game[0].ButtonId, (std::array<std::uint8_t, 8>{0x01, 0x3B, 0xB7, 0xCE, 0x62, 0x00, 0x00, 0xF0}));
  EXPECT_EQ(game[39].PlayerId, 69);
  EXPECT_EQ(game[39].ShotCount, 601);
  EXPECT_EQ(game[39].Hits.size(), 19U);
}

TEST(GameMaker, MakesAGameWithoutPlayers) {
  EXPECT_TRUE(MakeGame(0, 1).empty());
}

TEST(GameMaker, GivesEveryGunOfTheFieldToAFullGame) {
  const std::vector<GunScores> game = MakeGame(224, 1);
  EXPECT_EQ(game.size(), 224U);
  const std::set<std::uint8_t> ids = IdsOf(game);
  EXPECT_EQ(ids.size(), 224U);
  EXPECT_EQ(*ids.begin(), 32);
  EXPECT_EQ(TeamSizes(game), (std::array<int, 3>{96, 96, 32}));
}

TEST(GameMaker, RefusesMoreGunsThanThereAre) {
  EXPECT_THROW(MakeGame(225, 1), std::invalid_argument);
  EXPECT_THROW(MakeGame(-1, 1), std::invalid_argument);
}

TEST(GameMaker, GivesDistinctPlayerIdsForEveryNumberOfPlayers) {
  for (int players = 1; players <= 224; ++players) {
    const std::set<std::uint8_t> ids = IdsOf(MakeGame(players, 3));
    EXPECT_EQ(ids.size(), static_cast<std::size_t>(players));
    EXPECT_GE(*ids.begin(), 32);
  }
}

TEST(GameMaker, SplitsPlayersEvenlyAmongTheTeams) {
  EXPECT_EQ(TeamSizes(MakeGame(1, 1)), (std::array<int, 3>{1, 0, 0}));
  EXPECT_EQ(TeamSizes(MakeGame(2, 1)), (std::array<int, 3>{1, 1, 0}));
  EXPECT_EQ(TeamSizes(MakeGame(40, 1)), (std::array<int, 3>{14, 13, 13}));
  EXPECT_EQ(TeamSizes(MakeGame(150, 1)), (std::array<int, 3>{59, 59, 32}));
}

TEST(GameMaker, UsesEveryBlockOfPlayerIds) {
  std::set<int> blocks;
  for (const std::uint8_t id : IdsOf(MakeGame(60, 5))) {
    blocks.insert(id & 0xE0);
  }
  EXPECT_EQ(blocks, (std::set<int>{32, 64, 96, 128, 160, 192, 224}));
}

TEST(GameMaker, HitsComeFromPlayersOfTheGameOnceForEachShooter) {
  const std::vector<GunScores> game = MakeGame(40, 11);
  const std::set<std::uint8_t> ids = IdsOf(game);
  for (const GunScores& scores : game) {
    std::set<std::uint8_t> shooters;
    for (const Hit& hit : scores.Hits) {
      EXPECT_TRUE(ids.contains(hit.Shooter));
      EXPECT_TRUE(shooters.insert(hit.Shooter).second);
      EXPECT_GT(hit.Amount, 0);
      EXPECT_LT(hit.Amount, 32768);
    }
  }
}

TEST(GameMaker, HasSomeFriendlyFireAndRareSelfHits) {
  int foes = 0;
  int friends = 0;
  int self = 0;
  for (const GunScores& scores : MakeGame(40, 1)) {
    for (const Hit& hit : scores.Hits) {
      const bool own = TeamOf(hit.Shooter) == TeamOf(scores.PlayerId);
      ++(hit.Shooter == scores.PlayerId ? self : own ? friends : foes);
    }
  }
  EXPECT_GT(self, 0);
  EXPECT_GT(friends, self);
  EXPECT_GT(foes, 3 * friends);
}

TEST(GameMaker, GivesButtonsWithGoodCrcToTwoThirdsOfThePlayers) {
  std::set<std::array<std::uint8_t, 8>> buttons;
  int without = 0;
  for (const GunScores& scores : MakeGame(224, 1)) {
    if (scores.ButtonId == std::array<std::uint8_t, 8>{}) {
      ++without;
      continue;
    }
    EXPECT_EQ(scores.ButtonId[0], 0x01);
    EXPECT_EQ(Crc8(scores.ButtonId), 0);
    EXPECT_TRUE(buttons.insert(scores.ButtonId).second);
  }
  EXPECT_GT(without, 224 / 4);
  EXPECT_LT(without, 224 / 2);
}

TEST(GameMaker, TellsFiguresThatAgreeWithEachOther) {
  for (const GunScores& scores : MakeGame(224, 2)) {
    EXPECT_LE(scores.RespawnCount, scores.DeathCount);
    EXPECT_LE(scores.AdminKillCount, scores.DeathCount);
    EXPECT_LE(scores.ShotCount, 900);
    EXPECT_LE(scores.RemainingHealth, 100);
    EXPECT_GT(scores.PrimaryDamage, 0);
    EXPECT_GE(scores.RunCounter, 12);
    EXPECT_LT(scores.DeathCount, 32768);
  }
}

TEST(GameMaker, ALonePlayerCanOnlyHitHimself) {
  for (std::uint32_t seed = 0; seed < 50; ++seed) {
    const std::vector<GunScores> game = MakeGame(1, seed);
    ASSERT_EQ(game.size(), 1U);
    EXPECT_TRUE(std::all_of(game[0].Hits.begin(), game[0].Hits.end(),
                            [&](const Hit& hit) { return hit.Shooter == game[0].PlayerId; }));
  }
}

}  // namespace
}  // namespace sim
