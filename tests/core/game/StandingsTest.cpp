#include "core/game/Standings.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr int Red0 = 1;
constexpr int Blue7 = 40;
constexpr int Yellow0 = 65;
constexpr int Red40 = 105;

class Placing : public testing::Test {
 protected:
  Player& Activate(int index, std::int32_t soldiering) {
    Player& player = game.Players(index);
    player.Active = true;
    player.Soldiering = soldiering;
    return player;
  }

  std::vector<Standing> Rows() const {
    return Standings(game, [](std::int32_t id) { return "Member " + std::to_string(id); });
  }

  std::vector<int> Order() const {
    std::vector<int> order;
    for (const Standing& row : Rows()) {
      EXPECT_EQ(row.Place, static_cast<int>(order.size()) + 1);
      order.push_back(row.Index);
    }
    return order;
  }

  StringTable strings{Language::English};
  Game game{strings};
};

TEST_F(Placing, OfNobodyIsEmpty) {
  game.Players(Red0).Soldiering = 5;
  EXPECT_THAT(Rows(), IsEmpty());
}

TEST_F(Placing, PutsTheHighestSoldieringFirst) {
  Activate(Red0, -7);
  Activate(Blue7, 2);
  Activate(Yellow0, 0);
  Activate(Red40, 1'000'000);
  EXPECT_THAT(Order(), ElementsAre(Red40, Blue7, Yellow0, Red0));
}

TEST_F(Placing, KeepsEqualsInRecordOrderWithPlacesOfTheirOwn) {
  for (const int index : {Red40, Yellow0, Blue7, Red0}) {
    Activate(index, 3);
  }
  Activate(Blue7, 4);
  EXPECT_THAT(Order(), ElementsAre(Blue7, Red0, Yellow0, Red40));
}

TEST_F(Placing, NeitherReadsNorWritesTheBoardsRank) {
  Activate(Red0, 1).Rank = 1;
  Activate(Blue7, 2).Rank = 17;
  EXPECT_THAT(Order(), ElementsAre(Blue7, Red0));
  EXPECT_EQ(game.Players(Red0).Rank, 1);
  EXPECT_EQ(game.Players(Blue7).Rank, 17);
}

TEST_F(Placing, TakesTheFiguresOfTheRecord) {
  Player& player = Activate(Red40, 289);
  player.PrimaryDamage = 10;
  player.ShotCount = 60;
  player.Accuracy = 0.5F;
  player.TotalDamage = -240;
  player.AbsoluteDamage = 300;
  player.HealCount = 1;
  player.DeathCount = 3;
  player.AmmoAddCount = 2;
  player.MemberIndex = 12;
  player.HitByPlayer(Blue7) = 2'000'000'000;
  player.HitByPlayer(Red0) = 2'000'000'000;
  player.HitByPlayer(Red40) = 3;
  game.Players(Blue7).HitByPlayer(Red40) = 77;
  const std::vector<Standing> rows = Rows();
  ASSERT_EQ(rows.size(), 1U);
  EXPECT_EQ(rows[0].Place, 1);
  EXPECT_EQ(rows[0].Index, Red40);
  EXPECT_EQ(rows[0].Team, 1);
  EXPECT_EQ(rows[0].Number, 40);
  EXPECT_EQ(rows[0].Soldiering, 289);
  EXPECT_EQ(rows[0].Accuracy, 0.5F);
  EXPECT_EQ(rows[0].DamageDealt, -240);
  EXPECT_EQ(rows[0].DamageTaken, 4'000'000'003);
  EXPECT_EQ(rows[0].Shots, 60);
  EXPECT_EQ(rows[0].Wia, 1);
  EXPECT_EQ(rows[0].Kia, 3);
  EXPECT_EQ(rows[0].AmmoAdds, 2);
  EXPECT_EQ(rows[0].PublicName, "Member 12");
}

TEST_F(Placing, HasNoAccuracyWhereTheBoardShowsNone) {
  Player& player = Activate(Red0, 0);
  player.Accuracy = 0.25F;
  player.ShotCount = 8;
  EXPECT_EQ(Rows().at(0).Accuracy, std::nullopt);
  player.PrimaryDamage = 10;
  EXPECT_EQ(Rows().at(0).Accuracy, 0.25F);
  player.ShotCount = 0;
  EXPECT_EQ(Rows().at(0).Accuracy, std::nullopt);
}

TEST_F(Placing, NamesGuestsWhoAreNoMembers) {
  Activate(Red0, 2).MemberIndex = 3;
  Activate(Blue7, 1);
  Activate(Yellow0, 0);
  const auto rows = Standings(
      game, [](std::int32_t) { return "Mole"; }, [](int index) { return index == Blue7 ? "Eve" : ""; });
  ASSERT_EQ(rows.size(), 3U);
  EXPECT_EQ(rows[0].PublicName, "Mole");
  EXPECT_EQ(rows[1].PublicName, "Eve");
  EXPECT_EQ(rows[2].PublicName, "Yellow 0");
}

}  // namespace
