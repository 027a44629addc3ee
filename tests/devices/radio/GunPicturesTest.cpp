#include "devices/radio/GunPictures.h"

#include <gtest/gtest.h>

#include <QImage>
#include <set>

namespace {

/// Columns of the picture that have a strongly coloured point half-way down.
int FilledColumns(std::uint8_t percent) {
  const QImage image = BatteryPicture(percent).toImage();
  int columns = 0;
  for (int x = 0; x < image.width(); ++x) {
    const QColor colour = image.pixelColor(x, image.height() / 2);
    columns += colour.alpha() > 200 && colour.saturation() > 120 ? 1 : 0;
  }
  return columns;
}

QColor FillOf(std::uint8_t percent) {
  const QImage image = BatteryPicture(percent).toImage();
  return image.pixelColor(image.width() / 8, image.height() / 2);
}

TEST(BatteryPictures, AreAsFullAsTheBattery) {
  const int full = FilledColumns(100);
  EXPECT_GT(full, 40);
  EXPECT_NEAR(FilledColumns(50), full / 2, 2);
  EXPECT_LT(FilledColumns(0), 2);
  EXPECT_EQ(FilledColumns(255), full);
}

TEST(BatteryPictures, TurnAmberAndThenRed) {
  EXPECT_EQ(FillOf(100), FillOf(41));
  EXPECT_NE(FillOf(41), FillOf(40));
  EXPECT_EQ(FillOf(40), FillOf(21));
  EXPECT_NE(FillOf(21), FillOf(20));
  EXPECT_GT(FillOf(20).red(), 2 * FillOf(20).green());
}

TEST(StatusPictures, DifferInFormToo) {
  std::set<QString> forms;
  for (const ScoreStatus status :
       {ScoreStatus::Pending, ScoreStatus::InProgress, ScoreStatus::Failed, ScoreStatus::Ok}) {
    const QImage image = StatusPicture(status).toImage();
    QString form;
    for (int y = 0; y < image.height(); y += 2) {
      for (int x = 0; x < image.width(); x += 2) {
        const QColor colour = image.pixelColor(x, y);
        form += colour.alpha() < 128 ? u'.' : colour.lightness() > 200 ? u'o' : u'x';
      }
    }
    forms.insert(form);
  }
  EXPECT_EQ(forms.size(), 4U);
}

TEST(StatusTints, MarkAllRowsButPendingOnes) {
  const QColor base(Qt::white);
  EXPECT_EQ(StatusTint(ScoreStatus::Pending, base), base);
  EXPECT_GT(StatusTint(ScoreStatus::Failed, base).red(), StatusTint(ScoreStatus::Failed, base).green() + 10);
  EXPECT_GT(StatusTint(ScoreStatus::Ok, base).green(), StatusTint(ScoreStatus::Ok, base).red() + 10);
  EXPECT_GT(StatusTint(ScoreStatus::InProgress, base).blue(),
            StatusTint(ScoreStatus::InProgress, base).red() + 10);
}

}  // namespace
