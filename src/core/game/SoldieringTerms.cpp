#include "core/game/SoldieringTerms.h"

SoldieringTerms SoldieringTermsOf(const Player& player, const SoldieringFactors& factors) {
  using Wide = long double;
  return {.Heal = player.HealCount * Wide{factors.Heal},
          .Damage = player.TotalDamage * Wide{factors.Damage},
          .Death = player.DeathCount * Wide{factors.Death},
          .Ammo = player.AmmoAddCount * Wide{factors.Ammo},
          .Accuracy = player.Accuracy * Wide{100} * Wide{factors.Accuracy},
          .Bonus = player.BonusPoints};
}
