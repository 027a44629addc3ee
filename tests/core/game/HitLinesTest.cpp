#include "core/game/HitLines.h"

#include <gmock/gmock.h>

#include <utility>
#include <vector>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;

TEST(SpecialDamage, IsListedInPlainDigitsWhereItIsAboveZero) {
  Player player;
  EXPECT_THAT(SpecialDamageOf(player), IsEmpty());
  player.ExplosiveDamage = 5;
  player.RadiationDamage = -1;
  player.StunCount = 12;
  EXPECT_THAT(SpecialDamageOf(player), ElementsAre("Explosive: 5", "Stuns: 12"));
  player.RadiationDamage = 7;
  EXPECT_THAT(SpecialDamageOf(player), ElementsAre("Explosive: 5", "Radiation: 7", "Stuns: 12"));
  player.ExplosiveDamage = 0;
  player.RadiationDamage = 1;
  EXPECT_THAT(SpecialDamageOf(player), ElementsAre("Radiation: 1", "Stuns: 12"));
}

/// Each hit as index and amount.
std::vector<std::pair<int, int>> Listed(const std::vector<Hit>& hits) {
  std::vector<std::pair<int, int>> listed;
  for (const Hit& hit : hits) {
    listed.emplace_back(hit.Index, hit.Amount);
  }
  return listed;
}

TEST(Hits, AreListedInTheOrderOfTheRecordsWhereTheyAreAboveZero) {
  const StringTable strings(Language::English);
  Game game(strings);
  game.Players(224).HitByPlayer(40) = 9;
  game.Players(40).HitByPlayer(40) = 1;
  game.Players(1).HitByPlayer(40) = 70;
  game.Players(2).HitByPlayer(40) = -3;
  game.Players(40).HitByPlayer(224) = 5;
  game.Players(40).HitByPlayer(1) = 6;
  EXPECT_THAT(Listed(HitsGivenBy(40, game)), ElementsAre(Pair(1, 70), Pair(40, 1), Pair(224, 9)));
  EXPECT_THAT(Listed(HitsTakenBy(40, game)), ElementsAre(Pair(1, 6), Pair(40, 1), Pair(224, 5)));
  EXPECT_THAT(HitsGivenBy(2, game), IsEmpty());
}

}  // namespace
