#include <gtest/gtest.h>

#include <QAccessible>
#include <QClipboard>
#include <QHeaderView>
#include <QHelpEvent>
#include <QSignalSpy>
#include <QToolTip>

#include "board/PlayerDelegate.h"
#include "board/ScoreListHeader.h"
#include "board/ScoreListModel.h"
#include "board/ScoreListView.h"
#include "tests/support/Controls.h"
#include "tests/support/OpenSession.h"
#include "ui/TeamColours.h"

// What the operator does with the rows and headers of a score list.

namespace {

/// A board of 60 guns, more than it has room for.
class LongBoard : public testing::Test {
 protected:
  LongBoard() {
    venue.Open();
    for (int index = 1; index <= 60; ++index) {
      venue.Play(index, 1000 - index);
    }
    venue.session.CalculateScores();
    list.setModel(&model);
    list.setItemDelegateForColumn(1, new PlayerDelegate(&list));
    list.SetColumnShares(std::vector<double>(BoardColumnCount, 1.0 / BoardColumnCount));
    list.resize(1000, 400);
    Show(list);
  }

  std::string SelectedGuns() const {
    std::string guns;
    for (const QModelIndex& index : list.selectionModel()->selectedRows(1)) {
      guns += (guns.empty() ? "" : ", ") + index.data().toString().toStdString();
    }
    return guns;
  }

  bool InView(int row) const {
    return list.viewport()->rect().contains(list.visualRect(model.index(row, 1)));
  }

  QPoint CentreOf(int row, int column = 4) const {
    return list.visualRect(model.index(row, column)).center();
  }

  void GiveBonus(int index, int points) {
    venue.session.Game().Players(index).BonusPoints = points;
    venue.session.CalculateScores();
  }

  OpenSession venue;
  ScoreListModel model{venue.session, BoardList::Players, venue.Strings, nullptr};
  ScoreListView list;
};

TEST_F(LongBoard, KeepsTheSelectedGunSelectedAndInViewWhenItIsCalculatedAnew) {
  list.selectRow(3);
  ASSERT_EQ(SelectedGuns(), "Red  3");
  GiveBonus(4, 1);
  EXPECT_EQ(SelectedGuns(), "Red  3");
  EXPECT_EQ(list.currentIndex().row(), 59);
  EXPECT_TRUE(InView(59));
  venue.session.SortByHeader(2);
  EXPECT_EQ(SelectedGuns(), "Red  3");
  EXPECT_TRUE(InView(3));
}

TEST_F(LongBoard, KeepsSeveralGunsSelected) {
  list.selectRow(3);
  list.selectionModel()->select(model.index(5, 0), QItemSelectionModel::Select | QItemSelectionModel::Rows);
  GiveBonus(6, 5000);
  EXPECT_EQ(list.selectionModel()->selectedRows().size(), 2);
  EXPECT_TRUE(list.selectionModel()->isRowSelected(0));
  EXPECT_TRUE(list.selectionModel()->isRowSelected(4));
}

TEST_F(LongBoard, GoesOnByKeyFromTheGunThatWasCurrent) {
  QTest::mouseClick(list.viewport(), Qt::LeftButton, {}, CentreOf(3));
  GiveBonus(4, 5000);
  QTest::keyClick(&list, Qt::Key_Down);
  EXPECT_EQ(list.currentIndex().row(), 1);
}

TEST_F(LongBoard, SelectsNothingInTheNextGameOnceItIsForgotten) {
  list.selectRow(3);
  list.ForgetSelection();
  GiveBonus(6, 5000);
  EXPECT_EQ(SelectedGuns(), "");
}

TEST_F(LongBoard, EndsTheSelectionWithAClickOnTheEmptyPart) {
  venue.session.ClearPlayerData();
  venue.Play(1, 5);
  venue.session.CalculateScores();
  const QPoint empty(40, list.viewport()->height() - 10);
  for (const Qt::MouseButton button : {Qt::LeftButton, Qt::RightButton}) {
    list.selectRow(0);
    QTest::mousePress(list.viewport(), button, {}, empty);
    EXPECT_FALSE(list.selectionModel()->hasSelection()) << "when the popup would open";
    QTest::mouseRelease(list.viewport(), button, {}, empty);
    GiveBonus(1, 6);
    EXPECT_FALSE(list.selectionModel()->hasSelection());
  }
}

TEST_F(LongBoard, TellsOfADoubleClickOnARowAndOfReturn) {
  const QSignalSpy chosen(&list, &ScoreListView::RowChosen);
  QTest::mouseDClick(list.viewport(), Qt::LeftButton, {}, CentreOf(2));
  EXPECT_EQ(chosen.count(), 1);
  QTest::keyClick(&list, Qt::Key_Return);
  EXPECT_EQ(chosen.count(), 2);
  QKeyEvent held(QEvent::KeyPress, Qt::Key_Return, {}, QString(), true);
  QApplication::sendEvent(&list, &held);
  QTest::mouseDClick(list.viewport(), Qt::RightButton, {}, CentreOf(2));
  EXPECT_EQ(chosen.count(), 2);
}

TEST_F(LongBoard, CopiesTheSelectedRowsAsTextWithTabs) {
  list.selectRow(1);
  QTest::keyClick(&list, Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(
      QGuiApplication::clipboard()->text(),
      QStringLiteral("Rank\tPlayer\tSoldiering\tAccuracy\tDamage\tShots Fired\tW.I.A.\tK.I.A.\tAmmo Adds\n"
                     "2\tRed  1\t 998\tError\t 0\t 0\t 0\t 0\t 0\n"));
  list.clearSelection();
  QTest::keyClick(&list, Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(QGuiApplication::clipboard()->text().count(QLatin1Char('\n')), 61);
}

TEST_F(LongBoard, KeepsTheWidthsThatTheOperatorDrags) {
  QHeaderView& header = *list.horizontalHeader();
  const QSignalSpy dragged(&list, &ScoreListView::WidthsDragged);
  const int before = list.columnWidth(2);
  const QPoint edge(header.sectionViewportPosition(3) - 1, header.height() / 2);
  const QPoint end = edge + QPoint(60, 0);
  QTest::mousePress(header.viewport(), Qt::LeftButton, {}, edge);
  QMouseEvent move(QEvent::MouseMove, end, header.viewport()->mapToGlobal(end), Qt::NoButton, Qt::LeftButton,
                   {});
  QApplication::sendEvent(header.viewport(), &move);
  QTest::mouseRelease(header.viewport(), Qt::LeftButton, {}, end);
  EXPECT_EQ(dragged.count(), 1);
  const double share = static_cast<double>(list.columnWidth(2)) / list.viewport()->width();
  EXPECT_GT(list.columnWidth(2), before + 40);
  GiveBonus(3, 4);
  list.resize(1400, 400);
  EXPECT_NEAR(static_cast<double>(list.columnWidth(2)) / list.viewport()->width(), share, 0.01);
  list.SetDraggedShares({});
  EXPECT_NEAR(list.columnWidth(2), list.columnWidth(4), 60);
}

TEST_F(LongBoard, KeepsItsColumnsInTheirOrder) {
  EXPECT_FALSE(list.horizontalHeader()->sectionsMovable());
}

TEST_F(LongBoard, TakesNoSharesThatMakeNoSense) {
  list.SetDraggedShares({0.5, 0.5});
  EXPECT_TRUE(list.DraggedShares().empty());
  list.SetDraggedShares(std::vector<double>(BoardColumnCount, 0));
  EXPECT_TRUE(list.DraggedShares().empty());
}

TEST_F(LongBoard, HasToolTipsOnlyForTextsThatAreCut) {
  const auto tipAt = [this](int column) {
    QToolTip::hideText();
    QHelpEvent event(QEvent::ToolTip, CentreOf(1, column), list.viewport()->mapToGlobal(CentreOf(1, column)));
    QApplication::sendEvent(list.viewport(), &event);
    return QToolTip::isVisible() ? QToolTip::text() : QString();
  };
  EXPECT_EQ(tipAt(1), QString());
  EXPECT_EQ(tipAt(2), QString());
  std::vector<double> narrow(BoardColumnCount, 0.15);
  narrow[1] = narrow[2] = 0.02;
  list.SetDraggedShares(narrow);
  EXPECT_EQ(tipAt(4), QString());  // before the others: a tip takes its time to go
  EXPECT_EQ(tipAt(1), QStringLiteral("Red  1"));
  EXPECT_EQ(tipAt(2), QStringLiteral(" 998"));
}

TEST_F(LongBoard, LeavesASelectedRowItsColour) {
  list.selectRow(1);
  const QRect cell = list.visualRect(model.index(1, 4));
  const QImage picture = list.viewport()->grab().toImage();
  const QColor ground = picture.pixelColor(cell.left() + 6, cell.center().y());
  EXPECT_EQ(ground, TeamTint(1, list.palette().base().color(), SelectedRowTint));
  const QColor frame = picture.pixelColor(cell.left() + 6, cell.top());
  EXPECT_EQ(frame, list.palette().color(QPalette::Text));
  const QRect other = list.visualRect(model.index(2, 4));
  EXPECT_EQ(picture.pixelColor(other.left() + 6, other.center().y()),
            TeamTint(1, list.palette().base().color()));
}

TEST_F(LongBoard, HasASignAtTheColumnThatOrdersTheRows) {
  auto& header = static_cast<ScoreListHeader&>(*list.horizontalHeader());
  const auto hasSign = [&header](int column) {
    const QRect section(header.sectionViewportPosition(column), 0, header.sectionSize(column),
                        header.height());
    const QImage picture = header.grab().toImage();
    return picture.pixelColor(header.SignPlace(column, section).center()) !=
           picture.pixelColor(section.left() + 2, header.SignPlace(column, section).center().y());
  };
  EXPECT_TRUE(hasSign(2));
  EXPECT_FALSE(hasSign(4));
  venue.session.SortByHeader(5);
  EXPECT_FALSE(hasSign(2));
  EXPECT_TRUE(hasSign(4));
  venue.session.SortByHeader(2);
  for (int column = 0; column < BoardColumnCount; ++column) {
    EXPECT_FALSE(hasSign(column));
  }
  EXPECT_EQ(header.model()->headerData(0, Qt::Horizontal, ScoreListModel::SortRole), QVariant());
  venue.session.SortByHeader(1);
  EXPECT_EQ(header.model()->headerData(0, Qt::Horizontal, ScoreListModel::SortRole).value<Qt::SortOrder>(),
            Qt::AscendingOrder);
}

TEST_F(LongBoard, ExplainsItsColumns) {
  EXPECT_EQ(model.headerData(6, Qt::Horizontal, Qt::ToolTipRole).toString(),
            QStringLiteral("W.I.A.: times healed"));
}

TEST_F(LongBoard, TellsScreenReadersWhichColumnOrdersTheRows) {
  const auto description = [this](int column) {
    const QAccessibleInterface* table = QAccessible::queryAccessibleInterface(&list);
    return table->child(1 + column)->text(QAccessible::Description).toStdString();
  };
  venue.session.SortByHeader(7);
  EXPECT_EQ(description(6), "W.I.A.: times healed \u25bc");
  EXPECT_EQ(description(7), "K.I.A.: deaths");
  venue.session.SortByHeader(1);
  EXPECT_EQ(description(0), "Rank: place by Soldiering \u25b2");
  EXPECT_EQ(description(6), "W.I.A.: times healed");
}

}  // namespace
