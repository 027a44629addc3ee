#pragma once

#include <cstdint>

#include "core/game/Game.h"
#include "core/game/SoldieringFactors.h"

/// What each quantity of a player adds to the soldiering score, before it is rounded.
struct SoldieringTerms {
  long double Heal = 0;
  long double Damage = 0;
  long double Death = 0;
  long double Ammo = 0;
  long double Accuracy = 0;
  std::int32_t Bonus = 0;

  /// In the order in which scores are added up.
  long double Sum() const { return Heal + Damage + Death + Ammo + Accuracy + Bonus; }
};

/// Uses the player's `TotalDamage` and `Accuracy` as they were calculated last.
SoldieringTerms SoldieringTermsOf(const Player& player, const SoldieringFactors& factors);
