#include "charts/HitMap.h"

#include <gmock/gmock.h>

#include <QImage>
#include <QSignalSpy>

#include "charts/HeatImage.h"
#include "tests/charts/ChartGames.h"
#include "tests/charts/Pointer.h"
#include "tests/support/Contrast.h"
#include "tests/support/Controls.h"

namespace {

using testing::ElementsAre;

/// Two of Red and one of Blue: a hit on a foe, one on a team mate, one on oneself.
class ShownMap : public testing::Test {
 protected:
  ShownMap() {
    game.Players(Blue0).HitByPlayer(Red0) = 120;
    game.Players(Red1).HitByPlayer(Red0) = 40;
    game.Players(Red1).HitByPlayer(Red1) = 7;
    map.SetUp(strings);
    map.SetMatrix(HitMatrix(ChartOf(game, {Red0, Red1, Blue0})));
    map.resize(500, 460);
    QObject::connect(&map, &HitMap::Told, &map, [this](const QString& text, bool chosen) {
      told.push_back(text.toStdString());
      lastChosen = chosen;
    });
  }

  /// A point well inside of a cell, away from its corners, its number and its frame.
  static QPoint Inside(const QRect& place) { return place.topLeft() + QPoint(place.width() / 5, 6); }

  QColor ColourOf(const HitCell& cell) { return map.grab().toImage().pixelColor(Inside(map.PlaceOf(cell))); }

  const StringTable strings{Language::English};
  Game game{strings};
  HitMap map;
  std::vector<std::string> told;
  bool lastChosen = false;
};

TEST_F(ShownMap, PaintsMoreDamageDarker) {
  const QRgb paper = ColourOf({2, 0}).rgb();
  EXPECT_EQ(paper, qRgb(255, 255, 255));
  EXPECT_EQ(ColourOf({0, 2}).rgb(), HeatOf(120, 120));
  EXPECT_EQ(ColourOf({0, 1}).rgb(), HeatOf(40, 120));
  EXPECT_GT(ColourOf({0, 1}).lightness(), ColourOf({0, 2}).lightness());
  EXPECT_NE(ColourOf({1, 1}).rgb(), paper);
}

TEST_F(ShownMap, WritesTheDamageWhereItFitsSoThatItCanBeRead) {
  for (const HitCell& cell : {HitCell{0, 2}, {0, 1}, {1, 1}}) {
    const QRect place = map.PlaceOf(cell);
    const QRect middle =
        place.adjusted(place.width() / 4, place.height() / 3, -place.width() / 4, -place.height() / 3);
    EXPECT_GE(PaintedContrast(map, middle), LeastContrast) << cell.Victim;
  }
  const QRect empty = map.PlaceOf({2, 0}).adjusted(8, 8, -8, -8);
  EXPECT_EQ(PaintedContrast(map, empty), 1);
}

TEST_F(ShownMap, WritesTheNumbersThatFitThoughTheLargestDoesNot) {
  game.Players(Blue0).HitByPlayer(Red0) = 2'000'000'000;
  map.SetMatrix(HitMatrix(ChartOf(game, {Red0, Red1, Blue0})));
  map.resize(300, 280);
  const auto contrastIn = [this](const HitCell& cell) {
    const QRect place = map.PlaceOf(cell);
    return PaintedContrast(
        map, place.adjusted(place.width() / 4, place.height() / 3, -place.width() / 4, -place.height() / 3));
  };
  EXPECT_GE(contrastIn({0, 1}), LeastContrast);
  EXPECT_GE(contrastIn({1, 1}), LeastContrast);
  EXPECT_EQ(contrastIn({0, 2}), 1);
}

TEST_F(ShownMap, MarksAndTellsNoOwnTeamInAFreeForAll) {
  ChartGame chart = ChartOf(game, {Red0, Red1, Blue0});
  const QRect own = map.PlaceOf({0, 1});
  const QPoint corner = own.topRight() + QPoint(-4, 4);
  EXPECT_NE(map.grab().toImage().pixel(corner), HeatOf(40, 120));
  const int width = map.Picture({}).width();
  chart.FreeForAll = true;
  map.SetMatrix(HitMatrix(chart));
  ASSERT_EQ(map.PlaceOf({0, 1}), own);
  EXPECT_EQ(map.grab().toImage().pixel(corner), HeatOf(40, 120));
  EXPECT_EQ(map.TextOf({0, 1}), QStringLiteral("Red  0 hit Red  1: damage 40"));
  EXPECT_EQ(map.TextOf({1, 1}), QStringLiteral("Red  1 hit themselves: damage 7"));
  EXPECT_LT(map.Picture({}).width(), width);  // nothing in the key tells of own teams
}

TEST(HeatImage, MarksHitsOnTheOwnTeamByMoreThanTheirColour) {
  const StringTable strings(Language::English);
  Game game(strings);
  game.Players(Red1).HitByPlayer(Red0) = 50;
  game.Players(Blue0).HitByPlayer(Red0) = 50;
  const HitMatrix matrix(ChartOf(game, {Red0, Red1, Blue0}));
  for (const int cell : {2, 3, 5, 8, 12, 30}) {
    const QImage image = HeatImage(matrix, cell);
    ASSERT_EQ(image.size(), QSize(3 * cell, 3 * cell));
    const auto coloursIn = [&](int victim) {
      std::map<QRgb, int> colours;
      const int lined = cell >= 6 ? 1 : 0;
      for (int y = 0; y < cell - lined; ++y) {
        for (int x = 0; x < cell - lined; ++x) {
          ++colours[image.pixel(victim * cell + x, y)];
        }
      }
      return colours;
    };
    EXPECT_EQ(coloursIn(2).size(), 1U) << cell;
    const std::map<QRgb, int> own = coloursIn(1);
    ASSERT_EQ(own.size(), 2U) << cell;
    EXPECT_GT(own.at(HeatOf(50, 50)), 0);
    EXPECT_GE(Contrast(own.begin()->first, own.rbegin()->first), LeastContrast) << cell;
  }
}

TEST_F(ShownMap, TellsTheCellUnderThePointer) {
  MovePointer(map, map.PlaceOf({0, 2}).center());
  MovePointer(map, map.PlaceOf({0, 1}).center());
  MovePointer(map, map.PlaceOf({1, 1}).center());
  MovePointer(map, map.PlaceOf({2, 2}).center());
  MovePointer(map, map.PlaceOf({2, 1}).center());
  EXPECT_THAT(told,
              ElementsAre("Red  0 hit Blue  0: damage 120", "Red  0 hit Red  1 of their own team: damage 40",
                          "Red  1 hit themselves: damage 7", "Blue  0 did not hit themselves",
                          "Blue  0 did not hit Red  1"));
  EXPECT_FALSE(lastChosen);
  EXPECT_EQ(map.toolTip(), QStringLiteral("Blue  0 did not hit Red  1"));
  MovePointer(map, QPoint(2, 2));
  EXPECT_EQ(told.size(), 5U);
  EXPECT_EQ(map.toolTip(), QString());
}

TEST_F(ShownMap, TellsTheCellOfAClickAloud) {
  QTest::mouseClick(&map, Qt::LeftButton, {}, map.PlaceOf({0, 2}).center());
  EXPECT_EQ(told.back(), "Red  0 hit Blue  0: damage 120");
  EXPECT_TRUE(lastChosen);
}

TEST_F(ShownMap, GoesByKeysAndStopsAtTheEdges) {
  const auto press = [this](Qt::Key key, Qt::KeyboardModifiers modifiers = {}) {
    QTest::keyClick(&map, key, modifiers);
    return *map.Cell();
  };
  EXPECT_EQ(press(Qt::Key_Right), (HitCell{0, 1}));
  EXPECT_EQ(press(Qt::Key_Down), (HitCell{1, 1}));
  EXPECT_EQ(press(Qt::Key_End), (HitCell{1, 2}));
  EXPECT_EQ(press(Qt::Key_Right), (HitCell{1, 2}));
  EXPECT_EQ(press(Qt::Key_Home), (HitCell{1, 0}));
  EXPECT_EQ(press(Qt::Key_Left), (HitCell{1, 0}));
  EXPECT_EQ(press(Qt::Key_PageDown), (HitCell{2, 0}));
  EXPECT_EQ(press(Qt::Key_Up), (HitCell{1, 0}));
  EXPECT_EQ(press(Qt::Key_PageUp), (HitCell{0, 0}));
  EXPECT_EQ(press(Qt::Key_End, Qt::ControlModifier), (HitCell{2, 2}));
  EXPECT_EQ(press(Qt::Key_Home, Qt::ControlModifier), (HitCell{0, 0}));
  EXPECT_TRUE(lastChosen);
  EXPECT_EQ(told.size(), 11U);
}

TEST_F(ShownMap, FramesTheCellThatItTells) {
  const QImage before = map.grab().toImage();
  map.SetCell(HitCell{0, 2});
  const QImage after = map.grab().toImage();
  const QRect place = map.PlaceOf({0, 2});
  EXPECT_EQ(before.pixelColor(Inside(place)), after.pixelColor(Inside(place)));
  EXPECT_NE(before.pixelColor(place.center().x(), place.top()),
            after.pixelColor(place.center().x(), place.top()));
  EXPECT_EQ(map.PlaceOf({0, 2}).width(), place.width());
}

TEST_F(ShownMap, ForgetsTheCellOfAPlayerWhoIsGone) {
  map.SetCell(HitCell{2, 2});
  map.SetMatrix(HitMatrix(ChartOf(game, {Red0, Red1})));
  EXPECT_FALSE(map.Cell());
  map.SetCell(HitCell{1, 1});
  map.SetMatrix(HitMatrix(ChartOf(game, {Red0, Red1, Blue0})));
  EXPECT_EQ(map.Cell(), (HitCell{1, 1}));
}

TEST_F(ShownMap, WithoutPlayersTakesKeysAndThePointerInItsStride) {
  map.SetMatrix({});
  QTest::keyClick(&map, Qt::Key_Right);
  MovePointer(map, QPoint(250, 250));
  map.grab();
  EXPECT_FALSE(map.Cell());
  EXPECT_TRUE(told.empty());
}

TEST(HitMapOfAll, HasEveryPlayerOnTheSmallestScreen) {
  const StringTable strings(Language::English);
  Game game(strings);
  std::vector<int> records;
  for (int index = 1; index <= PlayerCount; ++index) {
    records.push_back(index);
    game.Players(index).HitByPlayer(index) = 10;
  }
  HitMap map;
  map.SetUp(strings);
  map.SetMatrix(HitMatrix(ChartOf(game, records)));
  map.resize(570, 545);
  EXPECT_TRUE(map.rect().contains(map.PlaceOf({PlayerCount - 1, PlayerCount - 1})));
  EXPECT_GE(map.PlaceOf({0, 0}).width(), 2);
  const QImage image = map.grab().toImage();
  const QPoint corner = map.PlaceOf({100, 100}).topLeft();
  EXPECT_EQ(image.pixel(corner), HeatOf(10, 10));
  // The picture has room for all names, so its cells are larger.
  EXPECT_GE(map.Picture(QStringLiteral("Bridge")).width(), PlayerCount * 13);
}

TEST(HitMapOfAll, SaysTheSameInChinese) {
  const StringTable strings(Language::SimplifiedChinese);
  Game game(strings);
  game.Players(Blue0).HitByPlayer(Red0) = 5;
  HitMap map;
  map.SetUp(strings);
  map.SetMatrix(HitMatrix(ChartOf(game, {Red0, Blue0})));
  EXPECT_EQ(map.TextOf({0, 1}), QStringLiteral("红队  0 击中 蓝队  0：伤害 5"));
  EXPECT_EQ(map.accessibleName(), QStringLiteral("谁击中了谁"));
}

}  // namespace
