#include "core/game/ScoreFrame.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/fakes/FakeClock.h"
#include "tests/support/Frames.h"

namespace {

class Decoding : public testing::Test {
 protected:
  void Decode(const Bytes& frame) {
    std::copy_n(frame.begin(), std::min(frame.size(), buffer.size()), buffer.begin());
    AnalyseData(buffer, game, clock);
  }

  Player& Red1() { return game.Players(2); }

  /// Expects the counters of FrameOfRed1, added that many times.
  void ExpectCounters(int frames) {
    EXPECT_EQ(Red1().ShotCount, 258 * frames);
    EXPECT_EQ(Red1().HealCount, 3 * frames);
    EXPECT_EQ(Red1().AmmoAddCount, 4 * frames);
    EXPECT_EQ(Red1().AdminKillCount, 5 * frames);
    EXPECT_EQ(Red1().DeathCount, 6 * frames);
    EXPECT_EQ(Red1().RespawnCount, 7 * frames);
    EXPECT_EQ(Red1().ExplosiveDamage, 8 * frames);
    EXPECT_EQ(Red1().RadiationDamage, 9 * frames);
    EXPECT_EQ(Red1().StunCount, 10 * frames);
  }

  /// Expects the other numbers that all frames of Red 1 share.
  void ExpectRemainders() {
    EXPECT_EQ(Red1().RemainingClips, 2);
    EXPECT_EQ(Red1().RemainingAmmo, 30);
    EXPECT_EQ(Red1().SecondaryDamage, 4);
    EXPECT_EQ(Red1().PrimaryDamage, 10);
    EXPECT_EQ(Red1().RunCounter, 125);
  }

  static bool HasHits(const Player& player) {
    return std::any_of(player.HitByPlayer.begin(), player.HitByPlayer.end(),
                       [](auto hits) { return hits != 0; });
  }

  /// A frame of Red 1 that fills the buffer: all zeros, but for the number of hits, 255, at `offset`.
  static Bytes FrameWithHitsAt(std::size_t offset) {
    Bytes frame(1001, 0);
    frame[2] = static_cast<std::uint8_t>((offset - 4) % 256);
    frame[3] = static_cast<std::uint8_t>((offset - 4) / 256);
    frame[4] = 33;
    frame[5] = 18;
    frame[offset] = 255;
    return frame;
  }

  bool BufferIsEmpty() const {
    return std::all_of(buffer.begin(), buffer.end(), [](auto byte) { return byte == 0; });
  }

  FakeClock clock;
  StringTable strings{Language::English};
  Game game{strings};
  ReceiveBuffer buffer{};
};

TEST(MakeWord, TakesTheHighByteFirst) {
  EXPECT_EQ(MakeWord(0, 0), 0);
  EXPECT_EQ(MakeWord(1, 2), 258);
  EXPECT_EQ(MakeWord(0, 255), 255);
}

TEST(MakeWord, OverflowsFrom128Up) {
  EXPECT_EQ(MakeWord(127, 255), 32767);
  EXPECT_EQ(MakeWord(128, 0), std::nullopt);
  EXPECT_EQ(MakeWord(255, 255), std::nullopt);
}

TEST_F(Decoding, TakesEveryFieldFromItsPlace) {
  Decode(FrameOfRed1());
  ExpectCounters(1);
  EXPECT_EQ(Red1().DallasID, "0807060504030201");
  EXPECT_EQ(Red1().RemainingHealth, 100);
  ExpectRemainders();
  EXPECT_EQ(Red1().PowerCheatFlag, 1);
  EXPECT_EQ(Red1().HitByPlayer(33), 260);
  EXPECT_EQ(Red1().HitByPlayer(2), 5);
  EXPECT_TRUE(Red1().Active);
}

TEST_F(Decoding, DatesTheGameAndEmptiesTheBuffer) {
  Decode(FrameOfBlue0());
  EXPECT_TRUE(game.DataPresent);
  EXPECT_EQ(game.GameDate, "21/05/2013 14:30");
  EXPECT_TRUE(BufferIsEmpty());
}

TEST_F(Decoding, EmptiesTheWholeBuffer) {
  buffer.fill(7);
  Decode(FrameOfBlue0());
  EXPECT_TRUE(BufferIsEmpty());
}

TEST_F(Decoding, TakesAHitThatEndsInTheLastByteOfTheBuffer) {
  Decode(LongestFrameOfRed1());
  EXPECT_EQ(Red1().HitByPlayer(2), 517);
}

TEST_F(Decoding, DatesTheGameByTheLastFrame) {
  Decode(FrameOfBlue0());
  clock.Date = "22/05/2013";
  clock.Time = "00:01";
  Decode(FrameOfRed1());
  EXPECT_EQ(game.GameDate, "22/05/2013 00:01");
}

TEST_F(Decoding, OfAFrameWithoutHitsLeavesThePlayerActive) {
  Decode(FrameOfBlue0());
  EXPECT_TRUE(game.Players(33).Active);
  EXPECT_EQ(game.Players(33).DeathCount, 2);
  EXPECT_EQ(game.Players(33).DallasID, "0000000000000000");
}

TEST_F(Decoding, AddsCountersAndHitsAndReplacesTheRest) {
  Decode(FrameOfRed1());
  Decode(SecondFrameOfRed1());
  ExpectCounters(2);
  EXPECT_EQ(Red1().HitByPlayer(33), 520);
  EXPECT_EQ(Red1().HitByPlayer(2), 10);
  EXPECT_EQ(Red1().DallasID, "08070605040302AB");
  EXPECT_EQ(Red1().RemainingHealth, 7);
  ExpectRemainders();
  EXPECT_EQ(Red1().PowerCheatFlag, 3);
}

TEST_F(Decoding, LeavesFieldsThatAFrameDoesNotHold) {
  Red1().TotalDamage = 1;
  Red1().AbsoluteDamage = 2;
  Red1().Soldiering = 3;
  Red1().Accuracy = 0.5F;
  Red1().Rank = 4;
  Red1().MemberIndex = 5;
  Red1().BonusPoints = 6;
  Red1().Committed = true;
  Decode(FrameOfRed1());
  EXPECT_EQ(Red1().TotalDamage, 1);
  EXPECT_EQ(Red1().AbsoluteDamage, 2);
  EXPECT_EQ(Red1().Soldiering, 3);
  EXPECT_EQ(Red1().Accuracy, 0.5F);
  EXPECT_EQ(Red1().Rank, 4);
  EXPECT_EQ(Red1().MemberIndex, 5);
  EXPECT_EQ(Red1().BonusPoints, 6);
  EXPECT_TRUE(Red1().Committed);
}

TEST_F(Decoding, WritesTheButtonFromItsLastByteToItsFirstInUpperCase) {
  Bytes frame = FrameOfBlue0();
  const Bytes button = {0x0C, 0xAF, 0x00, 0xFF, 0x10, 0x01, 0xB0, 0xDE};
  std::copy(button.begin(), button.end(), frame.begin() + 24);
  Decode(frame);
  EXPECT_EQ(game.Players(33).DallasID, "DEB00110FF00AF0C");
}

TEST_F(Decoding, TakesTheFlagAsAByteWithoutSign) {
  Bytes frame = FrameOfBlue0();
  frame[44] = 255;
  Decode(frame);
  EXPECT_EQ(game.Players(33).PowerCheatFlag, 255);
}

TEST_F(Decoding, AddsUpTwoHitsOfOneShooter) {
  Bytes frame = FrameOfRed1();
  frame[49] = 64;  // the second shooter
  Decode(frame);
  EXPECT_EQ(Red1().HitByPlayer(33), 265);
}

TEST_F(Decoding, Takes255Hits) {
  Bytes frame = FrameOfRed1();
  frame.resize(46);
  frame[45] = 255;
  for (int i = 0; i < 255; ++i) {
    frame.insert(frame.end(), {64, 1, 1});
  }
  Decode(frame);
  EXPECT_EQ(Red1().HitByPlayer(33), 65535);
}

TEST_F(Decoding, SkipsWhatALongerStatisticsBlockAddsAndWhatFollowsTheFlag) {
  Bytes frame = FrameOfRed1();
  frame.insert(frame.begin() + 45, {0xEE, 0xEE});        // after the flag
  frame.insert(frame.begin() + 24, {0xDD, 0xDD, 0xDD});  // after the counters
  frame[0] += 5;
  frame[2] += 5;
  frame[5] += 3;
  Decode(frame);
  EXPECT_EQ(Red1().StunCount, 10);
  EXPECT_EQ(Red1().DallasID, "0807060504030201");
  EXPECT_EQ(Red1().RunCounter, 125);
  EXPECT_EQ(Red1().HitByPlayer(33), 260);
}

TEST_F(Decoding, TakesAShorterStatisticsBlockAsItComes) {
  Bytes frame = FrameOfRed1();
  frame[5] = 0;  // the button is then read where the first four counters are
  Decode(frame);
  EXPECT_EQ(Red1().ShotCount, 258);
  EXPECT_EQ(Red1().StunCount, 10);
  EXPECT_EQ(Red1().DallasID, "0500040003000201");
  EXPECT_EQ(Red1().RemainingHealth, 6);
  EXPECT_EQ(Red1().PowerCheatFlag, 3);
  EXPECT_EQ(Red1().HitByPlayer(33), 260);
}

TEST_F(Decoding, LeavesEachFieldWhoseWordOverflows) {
  Decode(FrameOfRed1());
  Bytes frame = FrameOfRed1();
  for (std::size_t offset = 6; offset < 24; offset += 2) {
    frame[offset] = 0x80;
  }
  for (std::size_t offset = 32; offset < 44; offset += 2) {
    frame[offset] = 0xFF;
  }
  frame[48] = 0x80;  // high byte of the first hit
  frame[44] = 9;
  Decode(frame);
  ExpectCounters(1);
  EXPECT_EQ(Red1().RemainingHealth, 100);
  ExpectRemainders();
  EXPECT_EQ(Red1().PowerCheatFlag, 9);
  EXPECT_EQ(Red1().HitByPlayer(33), 260);
  EXPECT_EQ(Red1().HitByPlayer(2), 10);
}

TEST_F(Decoding, TakesWordsUpTo32767) {
  Bytes frame = FrameOfBlue0();
  frame[8] = 0x7F;
  frame[9] = 0xFF;
  frame[42] = 0x7F;
  frame[43] = 0xFF;
  Decode(frame);
  EXPECT_EQ(game.Players(33).HealCount, 32767);
  EXPECT_EQ(game.Players(33).RunCounter, 32767);
}

TEST_F(Decoding, FillsACounterToItsLimit) {
  Red1().ShotCount = 2147483389;
  Red1().HitByPlayer(33) = 2147483387;
  Decode(FrameOfRed1());
  EXPECT_EQ(Red1().ShotCount, 2147483647);
  EXPECT_EQ(Red1().HitByPlayer(33), 2147483647);
}

TEST_F(Decoding, LeavesACounterThatWouldPassItsLimit) {
  Red1().ShotCount = 2147483390;
  Red1().HitByPlayer(33) = 2147483388;
  Decode(FrameOfRed1());
  EXPECT_EQ(Red1().ShotCount, 2147483390);
  EXPECT_EQ(Red1().HitByPlayer(33), 2147483388);
  EXPECT_EQ(Red1().HealCount, 3);
  EXPECT_EQ(Red1().HitByPlayer(2), 5);
}

TEST_F(Decoding, TakesARecordLengthThatOverflowsForNothing) {
  Bytes frame = FrameOfRed1();
  frame[3] = 0x80;  // the number of hits is then the PlayerId, 33, and the entries begin at offset 5
  frame[8] = 64;    // the second entry is Blue 0, amount 3
  Decode(frame);
  EXPECT_TRUE(Red1().Active);
  EXPECT_EQ(Red1().HealCount, 16387);
  EXPECT_EQ(Red1().HitByPlayer(33), 3);
  EXPECT_EQ(Red1().HitByPlayer(2), 0);
}

TEST_F(Decoding, FindsNoHitsBehindTheBuffer) {
  const Bytes lengths[] = {{0xE5, 0x03}, {0xFF, 0x7F}};  // hit count at offset 1001 or 32771
  for (const Bytes& length : lengths) {
    Bytes frame = FrameOfRed1();
    frame[2] = length[0];
    frame[3] = length[1];
    Decode(frame);
    EXPECT_TRUE(Red1().Active);
    EXPECT_EQ(Red1().RunCounter, 125);
    EXPECT_EQ(Red1().HitByPlayer(33), 0);
    EXPECT_EQ(Red1().HitByPlayer(2), 0);
  }
}

TEST_F(Decoding, TakesAHitCountInTheBuffersLastByteForNothing) {
  Decode(FrameWithHitsAt(1000));
  EXPECT_TRUE(Red1().Active);
  EXPECT_FALSE(HasHits(Red1()));
}

TEST_F(Decoding, LeavesOutHitEntriesBehindTheBuffer) {
  Bytes frame = FrameWithHitsAt(996);
  frame[997] = 64;
  frame[998] = 9;
  frame[1000] = 65;
  Decode(frame);
  EXPECT_EQ(Red1().HitByPlayer(33), 9);
  EXPECT_EQ(Red1().HitByPlayer(34), 0);
}

TEST_F(Decoding, LeavesOutShootersBelow32) {
  for (const std::uint8_t shooter : Bytes{0, 31}) {
    game.Clear();
    Bytes frame = FrameOfRed1();
    frame[46] = shooter;
    Decode(frame);
    EXPECT_EQ(Red1().HitByPlayer(2), 5);
    Red1().HitByPlayer(2) = 0;
    EXPECT_FALSE(HasHits(Red1()));
  }
}

TEST_F(Decoding, TakesTheLowestAndTheHighestShooter) {
  Bytes frame = FrameOfRed1();
  frame[46] = 32;
  frame[49] = 255;
  Decode(frame);
  EXPECT_EQ(Red1().HitByPlayer(1), 260);
  EXPECT_EQ(Red1().HitByPlayer(224), 5);
}

TEST_F(Decoding, OfAGunBelow32ChangesNoPlayerButDatesTheGame) {
  for (const std::uint8_t gun : Bytes{0, 31}) {
    game.Clear();
    Bytes frame = FrameOfRed1();
    frame[4] = gun;
    Decode(frame);
    EXPECT_TRUE(game.DataPresent);
    EXPECT_EQ(game.GameDate, "21/05/2013 14:30");
    EXPECT_TRUE(std::none_of(game.Players.begin(), game.Players.end(),
                             [](const Player& player) { return player.Active || player.ShotCount != 0; }));
    EXPECT_TRUE(BufferIsEmpty());
  }
}

TEST_F(Decoding, TakesTheLowestAndTheHighestGun) {
  Bytes frame = FrameOfBlue0();
  frame[4] = 32;
  Decode(frame);
  frame[4] = 255;
  Decode(frame);
  EXPECT_TRUE(game.Players(1).Active);
  EXPECT_TRUE(game.Players(224).Active);
  EXPECT_FALSE(game.Players(33).Active);
}

}  // namespace
