#include "sim/game/ScoreFrame.h"

#include <gtest/gtest.h>

#include <stdexcept>

#include "tests/support/Bytes.h"

namespace sim {
namespace {

GunScores Blue2() {
  GunScores scores;
  scores.PlayerId = 0x42;
  scores.ShotCount = 0x0123;
  scores.HealCount = 4;
  scores.AmmoAddCount = 5;
  scores.AdminKillCount = 6;
  scores.DeathCount = 7;
  scores.RespawnCount = 8;
  scores.ExplosiveDamage = 0x0102;
  scores.RadiationDamage = 10;
  scores.StunCount = 11;
  scores.ButtonId = {0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF};
  scores.RemainingHealth = 100;
  scores.RemainingClips = 3;
  scores.RemainingAmmo = 30;
  scores.SecondaryDamage = 50;
  scores.PrimaryDamage = 25;
  scores.RunCounter = 0x0110;
  scores.PowerCheatFlag = 0x80;
  return scores;
}

TEST(ScoreFrame, HoldsEveryFieldAtItsPlace) {
  GunScores scores = Blue2();
  scores.Hits = {{0x21, 300}, {0xFF, 32767}};
  EXPECT_EQ(EncodeScoreFrame(scores), (Bytes{
                                          0x34, 0x00,  // 52 bytes, low first
                                          0x29, 0x00,  // record of 41 bytes
                                          0x42,        // player
                                          0x12,        // 18 bytes of counters
                                          0x01, 0x23,  // shots, high first
                                          0x00, 0x04,  // heals
                                          0x00, 0x05,  // ammo adds
                                          0x00, 0x06,  // admin kills
                                          0x00, 0x07,  // deaths
                                          0x00, 0x08,  // respawns
                                          0x01, 0x02,  // explosive damage
                                          0x00, 0x0A,  // radiation damage
                                          0x00, 0x0B,  // stuns
                                          0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF,  // button
                                          0x00, 0x64,                                      // health left
                                          0x00, 0x03,                                      // clips left
                                          0x00, 0x1E,                                      // ammo left
                                          0x00, 0x32,                                      // secondary damage
                                          0x00, 0x19,                                      // primary damage
                                          0x01, 0x10,                                      // minutes
                                          0x80,                                            // power cheat flag
                                          0x02,                                            // two hits
                                          0x21, 0x2C, 0x01,                                // 300, low first
                                          0xFF, 0xFF, 0x7F,                                // 32767
                                          0xE1,                                            // CRC
                                      }));
}

TEST(ScoreFrame, OfAnIdleGunHasNoHitsAndNoButton) {
  EXPECT_EQ(
      EncodeScoreFrame(GunScores{}),
      (Bytes{0x2E, 0x00, 0x29, 0x00, 0x20, 0x12, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0,   0,
             0,    0,    0,    0,    0,    0,    0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0x6C}));
}

TEST(ScoreFrame, CountsExtraBytesOfBothBlocksInItsLengths) {
  const FrameExtras extras{.StatisticsBytes = 2, .RecordBytes = 3};
  EXPECT_EQ(EncodeScoreFrame(Blue2(), extras),
            (Bytes{0x33, 0x00, 0x2E, 0x00, 0x42, 0x14, 0x01, 0x23, 0x00, 0x04, 0x00, 0x05, 0x00,
                   0x06, 0x00, 0x07, 0x00, 0x08, 0x01, 0x02, 0x00, 0x0A, 0x00, 0x0B, 0xEE, 0xEE,
                   0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF, 0x00, 0x64, 0x00, 0x03, 0x00,
                   0x1E, 0x00, 0x32, 0x00, 0x19, 0x01, 0x10, 0x80, 0xEE, 0xEE, 0xEE, 0x00, 0x28}));
}

TEST(ScoreFrame, TakesAsManyHitsAsItsCountByteCanTell) {
  GunScores scores;
  scores.Hits.assign(255, Hit{32, 1});
  const Bytes frame = EncodeScoreFrame(scores);
  ASSERT_EQ(frame.size(), 46U + 3U * 255U + 1U);
  EXPECT_EQ(frame[0], 0x2B);  // 811
  EXPECT_EQ(frame[1], 0x03);
  EXPECT_EQ(frame[45], 255);
}

TEST(ScoreFrame, RefusesWhatItsLengthFieldsCannotTell) {
  GunScores tooManyHits;
  tooManyHits.Hits.assign(256, Hit{32, 1});
  EXPECT_THROW(EncodeScoreFrame(tooManyHits), std::length_error);
  EXPECT_NO_THROW(EncodeScoreFrame(GunScores{}, {.StatisticsBytes = 237}));
  EXPECT_THROW(EncodeScoreFrame(GunScores{}, {.StatisticsBytes = 238}), std::length_error);
  EXPECT_THROW(EncodeScoreFrame(GunScores{}, {.RecordBytes = 32768}), std::length_error);
}

}  // namespace
}  // namespace sim
