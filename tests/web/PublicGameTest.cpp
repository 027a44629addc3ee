#include "web/PublicGame.h"

#include <gmock/gmock.h>

#include "tests/web/Games.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr std::int32_t Mole = 17;

class GameForAll : public testing::Test {
 protected:
  void SetUp() override {
    Activate(Red0, 30).MemberIndex = Mole;
    Activate(Blue7, 120);
    names.Shown = true;
    names.OfMembers = [](std::int32_t id) { return id == Mole ? "Mole" : ""; };
    names.OfGuests = [](int index) { return index == Blue7 ? "Ada" : ""; };
  }

  Player& Activate(int index, std::int32_t soldiering) {
    Player& player = game.Players(index);
    player.Active = true;
    player.Soldiering = soldiering;
    return player;
  }

  std::vector<std::string> Names() const {
    std::vector<std::string> shown;
    for (const PublicPlayer& player : PublicGameOf(game, 1, "20:15", names).Players) {
      shown.push_back(player.Name);
    }
    return shown;
  }

  StringTable strings{Language::English};
  Game game{strings};
  ShownNames names;
};

TEST_F(GameForAll, HasNamesOfMembersAndGuestsWhereTheyAreShown) {
  EXPECT_THAT(Names(), ElementsAre("Ada", "Mole"));
}

TEST_F(GameForAll, HasNoNamesUntilTheyAreSwitchedOn) {
  names.Shown = false;
  EXPECT_THAT(Names(), ElementsAre("", ""));
  EXPECT_FALSE(ShownNames().Shown);
}

TEST_F(GameForAll, LeavesOutTheNameOfAPlayerWhoIsHidden) {
  names.Hidden = [](int index) { return index == Red0; };
  EXPECT_THAT(Names(), ElementsAre("Ada", ""));
}

TEST_F(GameForAll, HasNoNameForAGunWithoutAMemberOrGuest) {
  names.OfGuests = nullptr;
  EXPECT_THAT(Names(), ElementsAre("", "Mole"));
}

TEST_F(GameForAll, HasTheFiguresOfTheStandings) {
  Player& blue = game.Players(Blue7);
  blue.ShotCount = 10;
  blue.PrimaryDamage = 5;
  blue.Accuracy = 0.5F;
  blue.TotalDamage = 44;
  blue.HealCount = 2;
  blue.DeathCount = 3;
  blue.AmmoAddCount = 4;
  const PublicGame shown = PublicGameOf(game, 12, "20:15", names);
  EXPECT_EQ(shown.Number, 12);
  EXPECT_EQ(shown.Time, "20:15");
  const PublicPlayer& first = shown.Players.front();
  EXPECT_EQ(first.Place, 1);
  EXPECT_EQ(first.Gun, Blue7);
  EXPECT_EQ(first.Soldiering, 120);
  EXPECT_EQ(first.Accuracy, 0.5F);
  EXPECT_EQ(first.DamageDealt, 44);
  EXPECT_EQ(first.Shots, 10);
  EXPECT_EQ(first.Wia, 2);
  EXPECT_EQ(first.Kia, 3);
  EXPECT_EQ(first.AmmoAdds, 4);
  EXPECT_THAT(shown.TeamTotals, ElementsAre(30, 120, 0));
}

TEST_F(GameForAll, ListsTheStrongestHitsFirst) {
  game.Players(Blue7).HitByPlayer(Red0) = 7;
  game.Players(Blue7).HitByPlayer(Yellow3) = 9;
  game.Players(Red0).HitByPlayer(Blue7) = 5;
  const PublicGame shown = PublicGameOf(game, 1, "20:15", names);
  const PublicPlayer& blue = shown.Players.front();
  ASSERT_EQ(blue.HitsTaken.size(), 2U);
  EXPECT_EQ(blue.HitsTaken[0].Gun, Yellow3);
  EXPECT_EQ(blue.HitsTaken[0].Amount, 9);
  EXPECT_EQ(blue.HitsTaken[1].Gun, Red0);
  ASSERT_EQ(blue.HitsGiven.size(), 1U);
  EXPECT_EQ(blue.HitsGiven[0].Gun, Red0);
  EXPECT_EQ(blue.DamageTaken, 16);
}

TEST_F(GameForAll, OfNobodyIsEmpty) {
  game.Clear();
  EXPECT_THAT(PublicGameOf(game, 1, "20:15", names).Players, IsEmpty());
}

TEST_F(GameForAll, CutsTheTimeOfAForeignFileLikeAName) {
  EXPECT_EQ(PublicGameOf(game, 1, "\u202E" + std::string(200, '8'), names).Time, std::string(30, '8'));
}

}  // namespace
