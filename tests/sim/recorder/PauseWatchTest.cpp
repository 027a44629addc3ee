#include "sim/recorder/PauseWatch.h"

#include <gtest/gtest.h>

#include <vector>

namespace sim {
namespace {

using std::chrono::milliseconds;

// The number of faults that pauses of these lengths reveal.
int FaultsOf(RecorderPause pause, const std::vector<int>& lengths) {
  PauseWatch watch;
  int faults = 0;
  for (const int length : lengths) {
    faults += watch.See(pause, milliseconds(length)) ? 1 : 0;
  }
  return faults;
}

TEST(PauseWatch, TellsAHostThatLeavesPausesOutOnce) {
  EXPECT_EQ(FaultsOf(RecorderPause::InCommand, {0, 0, 0, 0, 0, 0}), 1);
  EXPECT_EQ(FaultsOf(RecorderPause::InCommand, {0, 0}), 0);
  EXPECT_EQ(FaultsOf(RecorderPause::InCommand, {0, 0, 0}), 1);
}

TEST(PauseWatch, ForgivesShortPausesAmongGoodOnes) {
  EXPECT_EQ(FaultsOf(RecorderPause::BeforePage, {0, 20, 0, 20, 0, 20}), 1);
  EXPECT_EQ(FaultsOf(RecorderPause::BeforePage, {20, 0, 20, 0, 20, 0}), 0);
  EXPECT_EQ(FaultsOf(RecorderPause::BeforePage, {20, 20, 20, 30, 5000}), 0);
  EXPECT_EQ(FaultsOf(RecorderPause::BeforePage, {0, 0, 20, 20}), 0);
}

TEST(PauseWatch, TakesThreeQuartersForEnough) {
  for (const RecorderPause pause :
       {RecorderPause::InCommand, RecorderPause::BeforePageCount, RecorderPause::InPageCount,
        RecorderPause::BeforePage, RecorderPause::InData, RecorderPause::BeforeCheckByte,
        RecorderPause::BetweenSounds}) {
    const auto enough = PauseWatch::Due(pause) * 3 / 4;
    PauseWatch watch;
    for (int i = 0; i < 9; ++i) {
      EXPECT_FALSE(watch.See(pause, enough));
    }
    PauseWatch other;
    other.See(pause, enough - milliseconds(1));
    other.See(pause, enough - milliseconds(1));
    EXPECT_TRUE(other.See(pause, enough - milliseconds(1)));
  }
}

TEST(PauseWatch, KeepsTheKindsOfPausesApart) {
  PauseWatch watch;
  watch.See(RecorderPause::BeforeCheckByte, milliseconds(0));
  watch.See(RecorderPause::BeforeCheckByte, milliseconds(0));
  EXPECT_FALSE(watch.See(RecorderPause::InData, milliseconds(0)));
  EXPECT_EQ(watch.See(RecorderPause::BeforeCheckByte, milliseconds(0)),
            "leaves less than 20 ms before the check byte");
}

TEST(PauseWatch, KnowsWhatIsDue) {
  EXPECT_EQ(PauseWatch::Due(RecorderPause::InCommand), milliseconds(10));
  EXPECT_EQ(PauseWatch::Due(RecorderPause::BeforePageCount), milliseconds(20));
  EXPECT_EQ(PauseWatch::Due(RecorderPause::InPageCount), milliseconds(20));
  EXPECT_EQ(PauseWatch::Due(RecorderPause::BeforePage), milliseconds(20));
  EXPECT_EQ(PauseWatch::Due(RecorderPause::InData), milliseconds(255));
  EXPECT_EQ(PauseWatch::Due(RecorderPause::BeforeCheckByte), milliseconds(20));
  EXPECT_EQ(PauseWatch::Due(RecorderPause::BetweenSounds), milliseconds(1000));
}

}  // namespace
}  // namespace sim
