#include "charts/ScoreChart.h"

#include <gmock/gmock.h>

#include <QImage>
#include <set>

#include "charts/PartLook.h"
#include "tests/charts/ChartGames.h"
#include "tests/charts/Pointer.h"
#include "tests/support/Controls.h"

namespace {

using testing::ElementsAre;

/// A player with these parts, in whole points.
PlayerParts PlayerWith(const std::string& name, const std::vector<std::pair<ScorePart, int>>& parts) {
  PlayerParts player{.Player = {1, name}, .Team = 1};
  for (const auto& [part, points] : parts) {
    player.Hundredths[static_cast<std::size_t>(part)] = points * std::int64_t{100};
    player.Soldiering += points;
  }
  return player;
}

class ShownBars : public testing::Test {
 protected:
  ShownBars() {
    bars.SetUp(strings);
    bars.resize(700, 200);
    bars.SetPlayers({PlayerWith("Red  1", {{ScorePart::Damage, 300}, {ScorePart::Accuracy, 50}}),
                     PlayerWith("Red  2", {{ScorePart::Damage, 100},
                                           {ScorePart::OwnTeam, -60},
                                           {ScorePart::Accuracy, 20},
                                           {ScorePart::Deaths, -10}}),
                     PlayerWith("Red  3", {{ScorePart::OwnTeam, -100}})});
    QObject::connect(&bars, &ScoreChart::Told, &bars,
                     [this](const QString& text, bool /*chosen*/) { told.push_back(text.toStdString()); });
  }

  const StringTable strings{Language::English};
  ScoreChart bars;
  std::vector<std::string> told;
};

TEST_F(ShownBars, AreAsLongAsTheirPoints) {
  const double unit = bars.AreaOf(0, ScorePart::Damage).width() / 300;
  EXPECT_GT(unit, 0.5);
  EXPECT_NEAR(bars.AreaOf(0, ScorePart::Accuracy).width(), 50 * unit, 1e-6);
  EXPECT_NEAR(bars.AreaOf(1, ScorePart::Damage).width(), 100 * unit, 1e-6);
  EXPECT_NEAR(bars.AreaOf(2, ScorePart::OwnTeam).width(), 100 * unit, 1e-6);
  EXPECT_TRUE(bars.AreaOf(2, ScorePart::Damage).isEmpty());
}

TEST_F(ShownBars, StackWhatGivesToTheRightOfZeroAndWhatTakesToTheLeft) {
  const double zero = bars.AreaOf(0, ScorePart::Damage).left();
  EXPECT_NEAR(bars.AreaOf(0, ScorePart::Accuracy).left(), bars.AreaOf(0, ScorePart::Damage).right(), 1e-6);
  EXPECT_NEAR(bars.AreaOf(1, ScorePart::Damage).left(), zero, 1e-6);
  EXPECT_NEAR(bars.AreaOf(1, ScorePart::Accuracy).left(), bars.AreaOf(1, ScorePart::Damage).right(), 1e-6);
  EXPECT_NEAR(bars.AreaOf(1, ScorePart::OwnTeam).right(), zero, 1e-6);
  EXPECT_NEAR(bars.AreaOf(1, ScorePart::Deaths).right(), bars.AreaOf(1, ScorePart::OwnTeam).left(), 1e-6);
  EXPECT_LE(bars.AreaOf(0, ScorePart::Accuracy).right(), bars.width());
}

TEST_F(ShownBars, TellTheWholeSumByKeys) {
  QTest::keyClick(&bars, Qt::Key_Down);
  QTest::keyClick(&bars, Qt::Key_End);
  QTest::keyClick(&bars, Qt::Key_Home);
  EXPECT_THAT(told,
              ElementsAre("Red  2: Soldiering 50 = Damage 100, Hits on own team -60, Accuracy 20, K.I.A. -10",
                          "Red  3: Soldiering -100 = Hits on own team -100",
                          "Red  1: Soldiering 350 = Damage 300, Accuracy 50"));
}

TEST_F(ShownBars, TellThePlayerAndThePartUnderThePointer) {
  MovePointer(bars, bars.AreaOf(1, ScorePart::OwnTeam).center().toPoint());
  EXPECT_EQ(told.back(), "Red  2: Soldiering 50 = Damage 100, Hits on own team -60, Accuracy 20, K.I.A. -10");
  EXPECT_EQ(bars.toolTip(), QStringLiteral("Hits on own team -60"));
  MovePointer(bars, bars.RowOf(2).topLeft() + QPoint(3, 3));
  EXPECT_EQ(bars.toolTip(), QString());
  EXPECT_EQ(bars.Place(), 2);
}

TEST_F(ShownBars, HaveRoomForAllPlayers) {
  EXPECT_GE(bars.minimumHeight(), bars.RowOf(2).bottom());
}

TEST_F(ShownBars, PaintEachPartInItsPlace) {
  const QImage image = bars.grab().toImage();
  const QPointF damage = bars.AreaOf(0, ScorePart::Damage).center();
  const QPointF beside = bars.AreaOf(2, ScorePart::OwnTeam).center();
  EXPECT_NE(image.pixelColor(damage.toPoint()), image.pixelColor(beside.toPoint()));
  EXPECT_NE(image.pixelColor(damage.toPoint()), bars.palette().color(QPalette::Window));
}

TEST(PartLook, NoTwoPartsLookAlikeInGrey) {
  std::set<QByteArray> looks;
  for (int part = 0; part < ScorePartCount; ++part) {
    QImage swatch(24, 24, QImage::Format_RGB32);
    swatch.fill(Qt::white);
    QPainter painter(&swatch);
    FillWithPart(painter, QRectF(0, 0, 23, 23), static_cast<ScorePart>(part));
    painter.end();
    const QImage grey = swatch.convertToFormat(QImage::Format_Grayscale8);
    EXPECT_TRUE(
        looks.insert(QByteArray(reinterpret_cast<const char*>(grey.constBits()), grey.sizeInBytes())).second)
        << part;
  }
}

TEST(PartLook, PatternsTellPartsApartWithoutAnyTone) {
  // Each part's darker and lighter pixels, as a mask: all but the two plain ones differ.
  std::set<QByteArray> masks;
  for (int part = 0; part < ScorePartCount; ++part) {
    QImage swatch(24, 24, QImage::Format_RGB32);
    swatch.fill(Qt::white);
    QPainter painter(&swatch);
    FillWithPart(painter, QRectF(0, 0, 23, 23), static_cast<ScorePart>(part));
    painter.end();
    QByteArray mask;
    for (int y = 2; y < 20; ++y) {
      for (int x = 2; x < 20; ++x) {
        mask.append(swatch.pixel(x, y) == swatch.pixel(2, 2) ? '0' : '1');
      }
    }
    masks.insert(mask);
  }
  EXPECT_EQ(masks.size(), static_cast<std::size_t>(ScorePartCount - 1));
}

TEST(PartKeyOf, GrowsInHeightWhereItIsNarrow) {
  const StringTable strings(Language::English);
  std::vector<ScorePart> parts;
  for (int part = 0; part < ScorePartCount; ++part) {
    parts.push_back(static_cast<ScorePart>(part));
  }
  const PartKey key(parts, strings, QFont());
  EXPECT_GT(key.HeightFor(300), key.HeightFor(900));
  PartLegend legend;
  legend.SetParts(parts, strings);
  EXPECT_GE(legend.heightForWidth(300), key.HeightFor(300));
}

}  // namespace
