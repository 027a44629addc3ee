#include "core/game/HitLines.h"

#include <gmock/gmock.h>

#include "tests/support/Thrown.h"

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

TEST(PlayerText, NamesTheRecordOfItsPlayer) {
  const StringTable texts(Language::English);
  const Game game(texts);
  for (int index = 1; index <= PlayerCount; ++index) {
    EXPECT_EQ(IndexFromPlayerText(texts, game.DisplayName(index)), index);
    EXPECT_EQ(IndexFromPlayerText(texts, game.DisplayName(index) + ": A: 9"), index);
  }
  EXPECT_EQ(IndexFromPlayerText(texts, "Red  40"), 105);
}

TEST(PlayerText, FailsWhereItsNumberIsNone) {
  const StringTable texts(Language::English);
  EXPECT_EQ(NumberThrownBy([&] { IndexFromPlayerText(texts, "Red x"); }), 13);
  EXPECT_EQ(NumberThrownBy([&] { IndexFromPlayerText(texts, "Red 300"); }), 6);
}

}  // namespace
