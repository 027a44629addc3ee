#include "board/ScoreListView.h"

#include <gtest/gtest.h>

#include <QHeaderView>
#include <QScrollBar>

#include "board/PlayerDelegate.h"
#include "board/ScoreListModel.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"
#include "tests/support/OnScreen.h"
#include "tests/support/OpenSession.h"

namespace {

TEST(FittingGunName, CutsTheTeamAndNeverTheNumber) {
  const QFontMetrics metrics(QApplication::font());
  const QString name = QStringLiteral("Yellow  24");
  const int whole = metrics.horizontalAdvance(name);
  EXPECT_EQ(FittingGunName(name, metrics, whole), name);
  const int least = metrics.horizontalAdvance(QStringLiteral("Y\u2026 24"));
  for (int width = whole - 1; width > least; --width) {
    const QString shown = FittingGunName(name, metrics, width);
    EXPECT_TRUE(shown.startsWith(QLatin1Char('Y')));
    EXPECT_TRUE(shown.endsWith(QStringLiteral(" 24"))) << shown.toStdString();
    EXPECT_LE(metrics.horizontalAdvance(shown), width);
  }
  EXPECT_TRUE(FittingGunName(name, metrics, 1).endsWith(QStringLiteral(" 24")));
}

TEST(GunSizeIn, IsThatOfTodayInTheLeastRowAndAsFarAsThereIsRoom) {
  const QFont font = QApplication::font();
  const QString letters = QStringLiteral("Rank");
  const int least = LeastRowOfMember(font, letters);
  EXPECT_DOUBLE_EQ(GunSizeIn(least, 1, font, letters), GunSize(1));
  EXPECT_DOUBLE_EQ(GunSizeIn(3 * least, 1.5, font, letters), GunSize(1.5));
  EXPECT_LT(GunSizeIn(least + 4, 1.4, font, letters), GunSize(1.4));
  EXPECT_GE(GunSizeIn(least, 2, font, letters), GunSize(100)) << "the smallest";
}

/// The board of a session in which Yellow 24 has played, in a list of some width.
class NarrowBoard : public testing::Test {
 protected:
  void ShowBoard(ScoreListView& view, int width) {
    view.setModel(&model);
    view.setItemDelegateForColumn(1, new PlayerDelegate(&view));
    view.SetColumnShares(std::vector<double>(BoardColumnCount, 1.0 / BoardColumnCount));
    view.resize(width, 400);
    Show(view);
  }

  /// Adds a player whose name is as long as any.
  void PlayYellow() {
    int index = 1;
    while (venue.session.Game().DisplayName(index) != "Yellow  24") {
      ++index;
    }
    venue.Play(index, 5);
    venue.session.CalculateScores();
  }

  int NeededForPlayers() const { return list.sizeHintForIndex(model.index(0, 1)).width(); }

  OpenSession venue;
  ScoreListModel model{venue.session, BoardList::Players, venue.Strings, nullptr};
  ScoreListView list;
};

TEST_F(NarrowBoard, GivesEachColumnItsShareWhereThereIsRoom) {
  venue.Open();
  ShowBoard(list, 1800);
  for (int column = 0; column < BoardColumnCount - 1; ++column) {
    EXPECT_EQ(list.columnWidth(column), list.viewport()->width() / BoardColumnCount);
  }
}

TEST_F(NarrowBoard, MakesRoomForTheGunsAtTheCostOfOtherColumns) {
  venue.Open();
  ShowBoard(list, 1000);
  PlayYellow();
  ASSERT_EQ(model.rowCount(), 1);
  EXPECT_GE(list.columnWidth(1), NeededForPlayers());
  EXPECT_FALSE(list.horizontalScrollBar()->isVisible());
  ExpectHeadersFit(list);
}

TEST_F(NarrowBoard, MakesTheCaptionsSmallerBeforeItScrolls) {
  const FontOfSize font(11);
  venue.Open();
  PlayYellow();
  ScoreListView large;
  ShowBoard(large, 1000);
  EXPECT_FALSE(large.horizontalScrollBar()->isVisible());
  ExpectHeadersFit(large);
  const double whenNarrow = large.horizontalHeader()->font().pointSizeF();
  large.resize(1800, 400);
  EXPECT_GT(large.horizontalHeader()->font().pointSizeF(), whenNarrow);
}

TEST_F(NarrowBoard, ScrollsWhereNothingElseHelps) {
  venue.Open();
  PlayYellow();
  ShowBoard(list, 500);
  EXPECT_TRUE(list.horizontalScrollBar()->isVisible());
  EXPECT_GE(list.columnWidth(1), NeededForPlayers());
  ExpectHeadersFit(list);
}

}  // namespace
