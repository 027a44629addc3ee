#include "ui/TeamColours.h"

#include <gtest/gtest.h>

namespace {

TEST(TeamBadge, IsSeenOnASelectedRowOfItsOwnColour) {
  for (const int team : {1, 2, 3}) {
    const auto colourAt = [team](QIcon::Mode mode, int x) {
      return TeamBadge(team).pixmap(QSize(64, 64), 1, mode).toImage().pixelColor(x, 32);
    };
    constexpr int ring = 6;
    constexpr int middle = 32;
    EXPECT_EQ(colourAt(QIcon::Normal, middle), TeamColour(team));
    EXPECT_EQ(colourAt(QIcon::Selected, middle), TeamColour(team));
    EXPECT_GT(colourAt(QIcon::Selected, ring).lightness(), 240);
    EXPECT_LT(colourAt(QIcon::Normal, ring).lightness(), 140);
  }
}

}  // namespace
