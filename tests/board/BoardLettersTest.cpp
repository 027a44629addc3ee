#include "board/BoardLetters.h"

#include <gtest/gtest.h>

namespace {

constexpr int LeastRow = 33;
constexpr double LeastCapitals = 13;

TEST(RowHeight, LetsTheRowsFillTheRoom) {
  EXPECT_EQ(RowHeight(840, 12, LeastRow), 70);
  EXPECT_EQ(RowHeight(840, 20, LeastRow), 42);
}

TEST(RowHeight, IsNeverLessThanTheLeast) {
  EXPECT_EQ(RowHeight(840, 40, LeastRow), LeastRow);
  EXPECT_EQ(RowHeight(-5, 12, LeastRow), LeastRow);
}

TEST(CapitalHeight, IsTheLeastInTheLeastRow) {
  EXPECT_DOUBLE_EQ(CapitalHeight(LeastRow, LeastRow, LeastCapitals), LeastCapitals);
}

TEST(CapitalHeight, CanBeReadFromTwoMetresInTwelveRowsOfAFullScreen) {
  constexpr int rowsOf1080Pixels = 780;  // less menu, banner, bars, headers and a window's frame
  EXPECT_GE(CapitalHeight(rowsOf1080Pixels / RowsInLargeLetters, LeastRow, LeastCapitals), ReadableCapitals);
}

TEST(CapitalHeight, CanBeReadFromTwoMetresAsSoonAsTheRowHasRoomForThat) {
  constexpr int leastRow = 52;  // of 14 points
  constexpr double leastCapitals = 20;
  EXPECT_LT(CapitalHeight(60, leastRow, leastCapitals), ReadableCapitals);
  EXPECT_GE(CapitalHeight(63, leastRow, leastCapitals), ReadableCapitals);
}

TEST(CapitalHeight, GrowsWithTheRowAndLeavesRoomAboveTheLetters) {
  double before = 0;
  for (int row = LeastRow; row < 200; ++row) {
    const double capitals = CapitalHeight(row, LeastRow, LeastCapitals);
    EXPECT_GE(capitals, before);
    EXPECT_LE(capitals, row * 0.53);
    before = capitals;
  }
}

TEST(TeamsStandBeside, OnWideScreensOnly) {
  constexpr int letters = 18;
  EXPECT_TRUE(TeamsStandBeside(1920, 960, letters));
  EXPECT_TRUE(TeamsStandBeside(1366, 640, letters));
  EXPECT_TRUE(TeamsStandBeside(2560, 1480, letters));
  EXPECT_TRUE(TeamsStandBeside(1180, 590, letters)) << "where the program starts";
  EXPECT_FALSE(TeamsStandBeside(1024, 640, letters));
  EXPECT_FALSE(TeamsStandBeside(1280, 900, letters));
  EXPECT_FALSE(TeamsStandBeside(1366, 640, 24)) << "in large letters";
}

TEST(GrowthThatFits, IsTheMostWhereThatFits) {
  EXPECT_DOUBLE_EQ(GrowthThatFits([](double growth) { return 100 * growth; }, 300, 2.5), 2.5);
}

TEST(GrowthThatFits, IsTheLargestThatFits) {
  const double growth = GrowthThatFits([](double g) { return 40 + 100 * g; }, 240, 3);
  EXPECT_LE(growth, 2);
  EXPECT_GT(growth, 1.98);
}

TEST(GrowthThatFits, IsOneWhereNothingFits) {
  EXPECT_NEAR(GrowthThatFits([](double growth) { return 1000 * growth; }, 300, 3), 1, 0.01);
  EXPECT_DOUBLE_EQ(GrowthThatFits([](double growth) { return growth; }, 300, 0.5), 1);
}

TEST(Letters, HaveTheirLimits) {
  EXPECT_EQ(LargerPercent(UsualPercent), 110);
  EXPECT_EQ(SmallerPercent(UsualPercent), 90);
  EXPECT_EQ(LargerPercent(LargestPercent), LargestPercent);
  EXPECT_EQ(SmallerPercent(SmallestPercent), SmallestPercent);
}

}  // namespace
