#include "core/FrameDecoder.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <limits>

#include "tests/core/Frames.h"
#include "tests/fakes/FakeClock.h"

namespace {

class Decoding : public testing::Test {
 protected:
  void Decode(const Bytes& frame) {
    std::copy(frame.begin(), frame.end(), buffer.begin());
    AnalyseData(buffer, game, clock);
  }

  Player& Red1() { return game.Players(2); }

  FakeClock clock;
  StringTable strings{Language::English};
  Game game{strings};
  ReceiveBuffer buffer{};
};

TEST(MakeWord, TakesTheHighByteFirst) { EXPECT_EQ(MakeWord(1, 2), 258); }

TEST(MakeWord, OverflowsFrom128Up) {
  EXPECT_EQ(MakeWord(127, 255), 32767);
  EXPECT_EQ(MakeWord(128, 0), std::nullopt);
}

TEST_F(Decoding, TakesEveryFieldFromItsPlace) {
  Decode(FrameOfRed1());
  EXPECT_EQ(Red1().ShotCount, 258);
  EXPECT_EQ(Red1().HealCount, 3);
  EXPECT_EQ(Red1().AmmoAddCount, 4);
  EXPECT_EQ(Red1().AdminKillCount, 5);
  EXPECT_EQ(Red1().DeathCount, 6);
  EXPECT_EQ(Red1().RespawnCount, 7);
  EXPECT_EQ(Red1().ExplosiveDamage, 8);
  EXPECT_EQ(Red1().RadiationDamage, 9);
  EXPECT_EQ(Red1().StunCount, 10);
  EXPECT_EQ(Red1().DallasID, "0807060504030201");
  EXPECT_EQ(Red1().RemainingHealth, 100);
  EXPECT_EQ(Red1().RemainingClips, 2);
  EXPECT_EQ(Red1().RemainingAmmo, 30);
  EXPECT_EQ(Red1().SecondaryDamage, 4);
  EXPECT_EQ(Red1().PrimaryDamage, 10);
  EXPECT_EQ(Red1().RunCounter, 125);
  EXPECT_EQ(Red1().PowerCheatFlag, 1);
  EXPECT_EQ(Red1().HitByPlayer(33), 260);
  EXPECT_EQ(Red1().HitByPlayer(2), 5);
  EXPECT_TRUE(Red1().Active);
}

TEST_F(Decoding, DatesTheGameAndEmptiesTheBuffer) {
  Decode(FrameOfBlue0());
  EXPECT_TRUE(game.DataPresent);
  EXPECT_EQ(game.GameDate, "21/05/2013 14:30");
  EXPECT_TRUE(std::all_of(buffer.begin(), buffer.end(), [](auto byte) { return byte == 0; }));
}

TEST_F(Decoding, OfAFrameWithoutHitsLeavesThePlayerActive) {
  Decode(FrameOfBlue0());
  EXPECT_TRUE(game.Players(33).Active);
  EXPECT_EQ(game.Players(33).DeathCount, 2);
  EXPECT_EQ(game.Players(33).DallasID, "0000000000000000");
}

TEST_F(Decoding, AddsCountersAndHitsAndReplacesTheRest) {
  Decode(FrameOfRed1());
  Bytes second = FrameOfRed1();
  second[24] = 0xAB;  // family code of the button
  second[33] = 7;     // health
  second[44] = 3;     // power cheat flag
  Decode(second);
  EXPECT_EQ(Red1().ShotCount, 516);
  EXPECT_EQ(Red1().StunCount, 20);
  EXPECT_EQ(Red1().HitByPlayer(33), 520);
  EXPECT_EQ(Red1().DallasID, "08070605040302AB");
  EXPECT_EQ(Red1().RemainingHealth, 7);
  EXPECT_EQ(Red1().PrimaryDamage, 10);
  EXPECT_EQ(Red1().PowerCheatFlag, 3);
}

TEST_F(Decoding, SkipsWhatALongerStatisticsBlockAddsAndWhatFollowsTheFlag) {
  Bytes frame = FrameOfRed1();
  frame.insert(frame.begin() + 45, {0xEE, 0xEE});        // behind the flag
  frame.insert(frame.begin() + 24, {0xDD, 0xDD, 0xDD});  // behind the counters
  frame[0] += 5;
  frame[2] += 5;
  frame[5] += 3;
  Decode(frame);
  EXPECT_EQ(Red1().StunCount, 10);
  EXPECT_EQ(Red1().DallasID, "0807060504030201");
  EXPECT_EQ(Red1().RunCounter, 125);
  EXPECT_EQ(Red1().HitByPlayer(33), 260);
}

TEST_F(Decoding, LeavesAFieldWhoseWordOverflows) {
  Red1().ShotCount = 1;
  Red1().RemainingHealth = 2;
  Red1().HitByPlayer(33) = 3;
  Bytes frame = FrameOfRed1();
  frame[6] = 0x80;   // shots
  frame[32] = 0xFF;  // health
  frame[48] = 0x80;  // high byte of the first hit
  Decode(frame);
  EXPECT_EQ(Red1().ShotCount, 1);
  EXPECT_EQ(Red1().RemainingHealth, 2);
  EXPECT_EQ(Red1().HitByPlayer(33), 3);
  EXPECT_EQ(Red1().HealCount, 3);
  EXPECT_EQ(Red1().HitByPlayer(2), 5);
}

TEST_F(Decoding, LeavesACounterThatIsFull) {
  Red1().ShotCount = std::numeric_limits<std::int32_t>::max() - 257;
  Decode(FrameOfRed1());
  EXPECT_EQ(Red1().ShotCount, std::numeric_limits<std::int32_t>::max() - 257);
  EXPECT_EQ(Red1().HealCount, 3);
}

TEST_F(Decoding, TakesARecordLengthThatOverflowsForNothing) {
  Bytes frame = FrameOfRed1();
  frame[3] = 0x80;  // the hit count is then read from the PlayerId's place: 33 entries
  Decode(frame);
  EXPECT_TRUE(Red1().Active);
  EXPECT_EQ(Red1().ShotCount, 258);
  EXPECT_NE(Red1().HitByPlayer(33), 260);
}

TEST_F(Decoding, FindsNoHitsBehindTheBuffer) {
  Bytes frame = FrameOfRed1();
  frame[2] = 0xFF;
  frame[3] = 0x7F;
  Decode(frame);
  EXPECT_TRUE(Red1().Active);
  EXPECT_EQ(Red1().HitByPlayer(33), 0);
}

TEST_F(Decoding, LeavesOutHitEntriesBehindTheBuffer) {
  Bytes frame(1001, 0);
  frame[2] = 0xE0;  // M = 992: the count stands at 996
  frame[3] = 0x03;
  frame[4] = 33;
  frame[5] = 18;
  frame[996] = 255;
  frame[997] = 64;
  frame[998] = 9;
  frame[1000] = 65;
  Decode(frame);
  EXPECT_EQ(Red1().HitByPlayer(33), 9);
  EXPECT_EQ(Red1().HitByPlayer(34), 0);
}

TEST_F(Decoding, LeavesOutShootersBelow32) {
  Bytes frame = FrameOfRed1();
  frame[46] = 31;
  Decode(frame);
  EXPECT_EQ(Red1().HitByPlayer(2), 5);
  EXPECT_EQ(Red1().HitByPlayer(33), 0);
}

TEST_F(Decoding, OfAGunBelow32ChangesNoPlayerButDatesTheGame) {
  Bytes frame = FrameOfRed1();
  frame[4] = 31;
  Decode(frame);
  EXPECT_TRUE(game.DataPresent);
  EXPECT_FALSE(game.GameDate.empty());
  EXPECT_TRUE(std::none_of(game.Players.begin(), game.Players.end(), [](const Player& p) { return p.Active; }));
}

TEST_F(Decoding, TakesTheHighestIdForTheLastRecord) {
  Bytes frame = FrameOfBlue0();
  frame[4] = 255;
  Decode(frame);
  EXPECT_TRUE(game.Players(224).Active);
}

}  // namespace
