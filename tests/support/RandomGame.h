#pragma once

#include <algorithm>
#include <array>
#include <numeric>
#include <random>

#include "core/game/Game.h"

/// Fills every raw field of `count` players, taken from all teams, and some hits of players who took no part.
inline void FillRandomly(Game& game, int count, unsigned seed) {
  std::mt19937 random(seed);
  const auto between = [&random](int least, int most) {
    return static_cast<std::int32_t>(least +
                                     static_cast<int>(random() % static_cast<unsigned>(most - least + 1)));
  };
  std::array<int, PlayerCount> indexes{};
  std::iota(indexes.begin(), indexes.end(), 1);
  std::shuffle(indexes.begin(), indexes.end(), random);
  for (int i = 0; i < PlayerCount; ++i) {
    Player& player = game.Players(indexes[i]);
    if (i >= count) {
      player.HitByPlayer(indexes[0]) = between(0, 3);
      continue;
    }
    player.Active = true;
    player.ShotCount = between(0, 9) == 0 ? between(-2, 0) : between(1, 2000);
    player.HealCount = between(0, 9);
    player.AmmoAddCount = between(0, 9);
    player.AdminKillCount = between(0, 3);
    player.RespawnCount = between(0, 20);
    player.RemainingHealth = between(0, 100);
    player.RemainingClips = between(0, 8);
    player.RemainingAmmo = between(0, 30);
    player.DeathCount = between(0, 20);
    player.SecondaryDamage = between(0, 100);
    player.PrimaryDamage = between(0, 8) * 5;
    player.Accuracy = static_cast<float>(between(0, 64)) / 64;
    player.RunCounter = between(0, 120);
    player.Committed = between(0, 1) == 1;
    player.BonusPoints = between(-20, 20);
    player.ExplosiveDamage = between(0, 500);
    player.RadiationDamage = between(0, 500);
    player.StunCount = between(0, 9);
    player.PowerCheatFlag = static_cast<std::uint8_t>(between(0, 255));
    for (int j = 0; j < count; ++j) {
      player.HitByPlayer(indexes[j]) = between(0, 3) == 0 ? between(1, 120) : 0;
    }
  }
}
