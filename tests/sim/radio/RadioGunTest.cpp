#include "sim/radio/RadioGun.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

#include "sim/game/GameMaker.h"
#include "sim/game/ScoreFrame.h"
#include "sim/radio/RadioAnswer.h"
#include "tests/support/RadioLiterals.h"

namespace sim {
namespace {

TEST(RadioGuns, StandInTheOrderOfTheirPlayerIdsWithAddressesOfTheirOwn) {
  const std::vector<RadioGun> guns = MakeRadioGuns(MakeGame(224, 1));
  ASSERT_EQ(guns.size(), 224U);
  std::set<std::uint64_t> addresses;
  for (std::size_t i = 0; i < guns.size(); ++i) {
    EXPECT_EQ(guns[i].PlayerId, 32 + i);
    EXPECT_LE(guns[i].Battery, 100);
    EXPECT_GE(guns[i].Battery, 10);
    addresses.insert(guns[i].Address);
  }
  EXPECT_EQ(addresses.size(), 224U);
}

TEST(RadioGuns, ShowEveryWeaponOfTheField) {
  std::set<int> weapons;
  for (const RadioGun& gun : MakeRadioGuns(MakeGame(224, 1))) {
    weapons.insert(gun.Weapon);
  }
  std::set<int> known{100, 101, 102, 103, 104, 105, 106, 107, 108};
  for (int code = 0; code <= 17; ++code) {
    known.insert(code);
  }
  EXPECT_EQ(weapons, known);
}

TEST(RadioGuns, HoldTheFramesThatTheBaseUnitHandsOver) {
  const std::vector<GunScores> game = MakeGame(40, 1);
  const std::vector<RadioGun> guns = MakeRadioGuns(game);
  for (const GunScores& scores : game) {
    const auto gun = std::find_if(guns.begin(), guns.end(), [&](const RadioGun& candidate) {
      return candidate.PlayerId == scores.PlayerId;
    });
    ASSERT_NE(gun, guns.end());
    EXPECT_EQ(gun->Frame, EncodeScoreFrame(scores));
  }
}

// The start offset of a block is one byte, and blocks have 90 bytes.
TEST(RadioGuns, HaveScoresThatThreeBlocksHold) {
  for (const int players : {40, 224}) {
    for (std::uint32_t seed = 1; seed <= 5; ++seed) {
      for (const RadioGun& gun : MakeRadioGuns(MakeGame(players, seed))) {
        EXPECT_LE(gun.Frame.size() - 1, 270U);
      }
    }
  }
}

TEST(RadioGuns, TakeTheirTimeToAnswer) {
  const std::vector<GunScores> game = MakeGame(1, 1);
  EXPECT_EQ(MakeRadioGuns(game).at(0).AnswerTime, std::chrono::milliseconds(5));
  EXPECT_EQ(MakeRadioGuns(game, std::chrono::milliseconds(7)).at(0).AnswerTime, std::chrono::milliseconds(7));
}

TEST(RadioAnswer, TellsAGunsTotalInUnitsOf255) {
  RadioGun gun = TwoGuns()[0];
  const auto total = [&](std::size_t bytes) {
    gun.Frame.assign(bytes, 0);
    gun.Frame.push_back(0xAB);
    return AnswerPacket(gun, {.Command = GunCommand::Size, .PlayerId = 0x22});
  };
  EXPECT_EQ(total(254), (Bytes{4, 0x22, 0, 0, 5, 1, 254, 0, 0xAB}));
  EXPECT_EQ(total(255), (Bytes{4, 0x22, 0, 0, 5, 1, 0, 1, 0xAB}));
  EXPECT_EQ(total(256), (Bytes{4, 0x22, 0, 0, 5, 1, 1, 1, 0xAB}));
  EXPECT_EQ(total(811), (Bytes{4, 0x22, 0, 0, 5, 1, 46, 3, 0xAB}));
}

}  // namespace
}  // namespace sim
