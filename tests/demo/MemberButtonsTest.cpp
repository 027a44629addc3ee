#include "demo/MemberButtons.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <set>

#include "core/game/DallasId.h"
#include "sim/game/GameMaker.h"
#include "sim/line/Crc.h"

namespace {

using testing::Contains;
using testing::Not;

sim::GunScores Gun(std::uint8_t playerId, const std::array<std::uint8_t, 8>& button,
                   const std::vector<sim::Hit>& hits) {
  sim::GunScores gun;
  gun.PlayerId = playerId;
  gun.ButtonId = button;
  gun.Hits = hits;
  return gun;
}

std::vector<std::string> ButtonsIn(const std::vector<sim::GunScores>& game) {
  std::vector<std::string> buttons;
  for (const sim::GunScores& gun : game) {
    buttons.push_back(DallasIdOf(gun.ButtonId));
  }
  return buttons;
}

TEST(MemberButtons, GoToTheGunsThatDealtTheMostDamage) {
  const std::vector<sim::GunScores> game = {
      Gun(32, {1, 2, 3, 4, 32, 0, 0, 9}, {{64, 500}, {33, 50}}),
      Gun(33, {}, {{64, 500}, {32, 900}}),
      Gun(64, {1, 2, 3, 4, 64, 0, 0, 9}, {}),
      Gun(96, {1, 2, 3, 4, 96, 0, 0, 9}, {{33, 5000}}),
  };
  const std::vector<std::string> buttons = MemberButtons(game, 5);
  ASSERT_EQ(buttons.size(), 5U);
  EXPECT_EQ(buttons[0], "0900004004030201");  // 1000 points
  EXPECT_EQ(buttons[1], "0900002004030201");  // 900
  EXPECT_EQ(buttons[2], "0900006004030201");  // none
}

TEST(MemberButtons, OfAtLeastTwoMembersAreInNoGun) {
  const std::vector<sim::GunScores> game = sim::MakeGame(40, 1);
  const std::vector<std::string> buttons = MemberButtons(game, 12);
  ASSERT_EQ(buttons.size(), 12U);
  for (std::size_t member = 0; member < 10; ++member) {
    EXPECT_THAT(ButtonsIn(game), Contains(buttons[member])) << member;
  }
  EXPECT_THAT(ButtonsIn(game), Not(Contains(buttons[10])));
  EXPECT_THAT(ButtonsIn(game), Not(Contains(buttons[11])));
}

TEST(MemberButtons, AreDifferentAndGenuineInEveryGame) {
  for (const int players : {0, 3, 12, 224}) {
    const std::vector<std::string> buttons = MemberButtons(sim::MakeGame(players, 7), 12);
    EXPECT_EQ(std::set<std::string>(buttons.begin(), buttons.end()).size(), 12U) << players;
    for (const std::string& button : buttons) {
      std::array<std::uint8_t, 8> id{};
      for (std::size_t i = 0; i < id.size(); ++i) {
        id[id.size() - 1 - i] = static_cast<std::uint8_t>(std::stoi(button.substr(2 * i, 2), nullptr, 16));
      }
      EXPECT_EQ(id[0], 1) << button;
      EXPECT_EQ(sim::Crc8(id), 0) << button;
    }
  }
}

}  // namespace
