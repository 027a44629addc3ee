#include "core/ScreenFit.h"

#include <gtest/gtest.h>

namespace {

TEST(FitToScreen, MaximisesWithoutAWarningOnExactlyTheRecommendedSize) {
  const ScreenFit fit = FitToScreen(1024, 768);
  EXPECT_FALSE(fit.Warn);
  EXPECT_TRUE(fit.Maximised);
  EXPECT_FALSE(fit.Width || fit.Height);
}

TEST(FitToScreen, LeavesTheWindowAloneOnALargerScreen) {
  const ScreenFit fit = FitToScreen(1280, 1024);
  EXPECT_FALSE(fit.Warn || fit.Maximised || fit.Width || fit.Height);
}

TEST(FitToScreen, WarnsAndLimitsBothOnASmallScreen) {
  const ScreenFit fit = FitToScreen(800, 600);
  EXPECT_TRUE(fit.Warn);
  EXPECT_EQ(fit.Width, 800);
  EXPECT_LT(fit.Height, 600);
  EXPECT_TRUE(fit.Maximised);
}

TEST(FitToScreen, LimitsOnlyWhatIsTooSmall) {
  const ScreenFit narrow = FitToScreen(800, 1200);
  EXPECT_TRUE(narrow.Warn);
  EXPECT_EQ(narrow.Width, 800);
  EXPECT_FALSE(narrow.Height || narrow.Maximised);
  const ScreenFit low = FitToScreen(1920, 700);
  EXPECT_TRUE(low.Warn && low.Height && low.Maximised);
  EXPECT_FALSE(low.Width);
}

}  // namespace
