#include "core/game/HitLines.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST(SpecialDamage, IsListedInPlainDigitsWhereItIsAboveZero) {
  Player player;
  EXPECT_THAT(SpecialDamageOf(player), IsEmpty());
  player.ExplosiveDamage = 5;
  player.RadiationDamage = -1;
  player.StunCount = 12;
  EXPECT_THAT(SpecialDamageOf(player), ElementsAre("Explosive: 5", "Stuns: 12"));
  player.RadiationDamage = 7;
  EXPECT_THAT(SpecialDamageOf(player), ElementsAre("Explosive: 5", "Radiation: 7", "Stuns: 12"));
}

}  // namespace
