#include "app/ScreenFit.h"

#include <gtest/gtest.h>

#include <tuple>
#include <utility>

#include "tests/support/OnScreen.h"

namespace {

TEST(FitToScreen, MaximisesWithoutAWarningOnExactlyTheRecommendedSize) {
  const ScreenFit fit = FitToScreen(1024, 768);
  EXPECT_FALSE(fit.Warn);
  EXPECT_TRUE(fit.Maximised);
  EXPECT_FALSE(fit.Width || fit.Height);
}

TEST(FitToScreen, LeavesTheWindowAloneOnALargerScreen) {
  for (const auto& [width, height] : {std::pair{1280, 1024}, {1025, 768}, {1024, 769}, {3840, 2160}}) {
    const ScreenFit fit = FitToScreen(width, height);
    EXPECT_FALSE(fit.Warn || fit.Maximised || fit.Width || fit.Height) << width << " x " << height;
  }
}

TEST(FitToScreen, WarnsAndLimitsBothOnASmallScreen) {
  const ScreenFit fit = FitToScreen(800, 600);
  EXPECT_TRUE(fit.Warn);
  EXPECT_EQ(fit.Width, 800);
  EXPECT_EQ(fit.Height, 567);  // less 500 twips at 15 to the pixel
  EXPECT_TRUE(fit.Maximised);
}

TEST(FitToScreen, LimitsTheWidthAloneOnANarrowScreen) {
  for (const auto& [width, height] : {std::pair{800, 1200}, {1023, 768}}) {
    const ScreenFit fit = FitToScreen(width, height);
    EXPECT_TRUE(fit.Warn);
    EXPECT_EQ(fit.Width, width);
    EXPECT_FALSE(fit.Height || fit.Maximised);
  }
}

TEST(FitToScreen, LimitsTheHeightAloneOnALowScreen) {
  for (const auto& [width, height, limit] : {std::tuple{1920, 700, 667}, {1024, 767, 734}}) {
    const ScreenFit fit = FitToScreen(width, height);
    EXPECT_TRUE(fit.Warn && fit.Maximised);
    EXPECT_EQ(fit.Height, limit);
    EXPECT_FALSE(fit.Width);
  }
}

TEST(FitToScreen, HoldsAlwaysOnTheRecommendedScreenAndBelow) {
  for (const auto& [width, height] : {std::pair{1024, 768}, {800, 600}, {1280, 720}, {900, 1200}}) {
    EXPECT_TRUE(AlwaysFits(width, height)) << width << " x " << height;
  }
  for (const auto& [width, height] : {std::pair{1025, 768}, {1024, 769}, {1366, 768}, {1920, 1080}}) {
    EXPECT_FALSE(AlwaysFits(width, height)) << width << " x " << height;
  }
}

TEST(FitToScreen, LetsTheWindowStartMaximisedUpToALaptopsScreen) {
  EXPECT_TRUE(StartsMaximised(1366, 768));
  EXPECT_TRUE(StartsMaximised(1366, 800));
  EXPECT_FALSE(StartsMaximised(1367, 768));
  EXPECT_FALSE(StartsMaximised(1280, 1024));
  EXPECT_FALSE(StartsMaximised(900, 780));
}

TEST(PixelsOf, AreThoseOfTheScreenAtAnyScale) {
  EXPECT_EQ(PixelsOf(ScreenNamed("too low")), QSize(1280, 720));
  EXPECT_EQ(PixelsOf(ScreenNamed("scaled by 2")), QSize(1920, 1080));
  EXPECT_EQ(PixelsOf(ScreenNamed("scaled by 1.5")), QSize(1024, 768));  // 683 x 512 in the toolkit's units
}

}  // namespace
