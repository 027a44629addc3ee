#include "charts/HitBars.h"

#include <gtest/gtest.h>

#include <QImage>

namespace {

/// Bars drawn by themselves; each line is as high as a line of text and four pixels.
class DrawnBars : public testing::Test {
 protected:
  void Draw(std::vector<HitBars::Bar> shown, int lines) {
    bars.resize(400, lines * Pitch());
    bars.SetBars(std::move(shown));
    image = bars.grab().toImage();
  }

  /// Pixels of this colour in the middle of a line.
  int Length(int line, const QColor& colour) const {
    int length = 0;
    for (int x = 0; x < image.width(); ++x) {
      length += image.pixelColor(x, line * Pitch() + Pitch() / 2) == colour ? 1 : 0;
    }
    return length;
  }

  int Pitch() const { return bars.fontMetrics().height() + 4; }

  HitBars bars;
  QImage image;
};

TEST_F(DrawnBars, StandInTheOrderOfTheirAmountsAndAreAsLong) {
  Draw({{QStringLiteral("Red  1"), 100, Qt::red},
        {QStringLiteral("Blue  1"), 400, Qt::blue},
        {QStringLiteral("Yellow  1"), 200, Qt::darkYellow}},
       3);
  const int longest = Length(0, Qt::blue);
  EXPECT_GT(longest, 150);
  EXPECT_NEAR(Length(1, Qt::darkYellow), longest / 2, 3);
  EXPECT_NEAR(Length(2, Qt::red), longest / 4, 3);
}

TEST_F(DrawnBars, OfEqualAmountsKeepTheirOrder) {
  Draw({{QStringLiteral("Red  1"), 5, Qt::red}, {QStringLiteral("Red  2"), 5, Qt::blue}}, 2);
  EXPECT_GT(Length(0, Qt::red), 0);
  EXPECT_GT(Length(1, Qt::blue), 0);
}

TEST_F(DrawnBars, OfTheSmallestAmountsAreLeftOutWhereTheRoomEnds) {
  constexpr int lines = 5;  // the fewest for which there is room
  std::vector<HitBars::Bar> shown = {{QStringLiteral("Red  0"), 1, Qt::red}};
  for (int amount = 2; amount <= lines + 1; ++amount) {
    shown.push_back({QStringLiteral("Blue  %1").arg(amount), amount, Qt::blue});
  }
  Draw(shown, lines);
  EXPECT_GT(Length(lines - 1, Qt::blue), 0);
  for (int y = 0; y < image.height(); ++y) {
    for (int x = 0; x < image.width(); ++x) {
      ASSERT_NE(image.pixelColor(x, y), QColor(Qt::red));
    }
  }
}

}  // namespace
