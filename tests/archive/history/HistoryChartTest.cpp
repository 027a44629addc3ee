#include "archive/history/HistoryChart.h"

#include <gmock/gmock.h>

#include <QSignalSpy>
#include <set>

#include "tests/support/Controls.h"

namespace {

class ThreeValues : public testing::Test {
 protected:
  ThreeValues() {
    chart.SetPoints(
        {{.Label = QStringLiteral("a"), .Value = 100, .Mean = 100, .Text = QStringLiteral("first")},
         {.Label = QStringLiteral("b"), .Value = -50, .Mean = 25, .Text = QStringLiteral("second")},
         {.Label = QStringLiteral("c"), .Value = 400, .Mean = 150, .Text = QStringLiteral("third")}});
    chart.resize(500, 300);
    Show(chart);
  }

  std::string LastTold() const {
    return told.empty() ? std::string() : told.back().at(0).toString().toStdString();
  }

  HistoryChart chart;
  QSignalSpy told{&chart, &HistoryChart::Told};
};

TEST_F(ThreeValues, LieInTheOrderOfTimeAndByHeight) {
  EXPECT_LT(chart.SpotOf(0).x(), chart.SpotOf(1).x());
  EXPECT_LT(chart.SpotOf(1).x(), chart.SpotOf(2).x());
  EXPECT_GT(chart.SpotOf(1).y(), chart.SpotOf(0).y());
  EXPECT_GT(chart.SpotOf(0).y(), chart.SpotOf(2).y());
}

TEST_F(ThreeValues, AreBarsUpOrDownToZero) {
  EXPECT_DOUBLE_EQ(chart.BarOf(0).bottom(), chart.BarOf(1).top());
  EXPECT_NEAR(chart.BarOf(2).height(), 4 * chart.BarOf(0).height(), 0.01);
  EXPECT_NEAR(chart.BarOf(1).height(), chart.BarOf(0).height() / 2, 0.01);
}

TEST_F(ThreeValues, LieWithinTheChart) {
  for (int place = 0; place < 3; ++place) {
    EXPECT_TRUE(QRectF(chart.rect()).contains(chart.SpotOf(place))) << place;
  }
}

TEST_F(ThreeValues, AreToldByKeys) {
  chart.setFocus(Qt::OtherFocusReason);
  Type(chart, Qt::Key_Home);
  EXPECT_EQ(LastTold(), "first");
  EXPECT_TRUE(told.back().at(1).toBool());
  Type(chart, Qt::Key_Right);
  EXPECT_EQ(LastTold(), "second");
  Type(chart, Qt::Key_End);
  EXPECT_EQ(LastTold(), "third");
  Type(chart, Qt::Key_Right);
  EXPECT_EQ(LastTold(), "third");
  Type(chart, Qt::Key_PageUp);
  EXPECT_EQ(chart.Place(), 0);
}

TEST_F(ThreeValues, AreToldToThePointer) {
  QTest::mouseMove(&chart, chart.SpotOf(1).toPoint());
  EXPECT_EQ(LastTold(), "second");
  EXPECT_FALSE(told.back().at(1).toBool());
  QTest::mouseClick(&chart, Qt::LeftButton, {}, chart.SpotOf(2).toPoint());
  EXPECT_EQ(LastTold(), "third");
  EXPECT_TRUE(told.back().at(1).toBool());
}

TEST_F(ThreeValues, ArePaintedAsDotsAndAsBars) {
  const QImage dots = chart.grab().toImage();
  chart.SetUp(HistoryChart::Kind::Bars, QStringLiteral("bars"), QStringLiteral("keys"));
  const QImage bars = chart.grab().toImage();
  const QPoint inside = chart.BarOf(2).center().toPoint();
  const QColor ground = chart.palette().color(QPalette::Base);
  EXPECT_NE(bars.pixelColor(inside), ground);
  EXPECT_NE(dots.pixelColor(chart.SpotOf(2).toPoint()), ground);
}

TEST(HistoryChart, OfNothingTellsNothing) {
  HistoryChart chart;
  chart.SetPoints({});
  Show(chart);
  const QSignalSpy told(&chart, &HistoryChart::Told);
  Type(chart, Qt::Key_End);
  QTest::mouseClick(&chart, Qt::LeftButton);
  EXPECT_EQ(told.count(), 0);
  EXPECT_EQ(chart.Place(), std::nullopt);
}

TEST(HistoryChart, HasRoomForManyValuesAndForOne) {
  for (const int count : {1, 700}) {
    HistoryChart chart;
    std::vector<HistoryPoint> points(static_cast<std::size_t>(count),
                                     HistoryPoint{.Label = QStringLiteral("2026-11-21"), .Value = 5});
    chart.SetPoints(std::move(points));
    chart.resize(400, 200);
    Show(chart);
    EXPECT_TRUE(QRectF(chart.rect()).contains(chart.SpotOf(count - 1)));
    EXPECT_GT(chart.BarOf(0).height(), 50);
  }
}

}  // namespace
