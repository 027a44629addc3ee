#include <gmock/gmock.h>

#include <QAccessible>
#include <QLineEdit>
#include <QMenuBar>

#include "board/BonusPoints.h"
#include "board/PlayerDetails.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

// The context menu of the board.

namespace {

using testing::ElementsAre;

class Popup : public testing::Test {
 protected:
  Popup() { venue.Start(); }

  QTableView& Board() { return venue.Find<QTableView>("ScoreDisplay"); }

  QPoint CentreOf(int row) { return Board().visualRect(Board().model()->index(row, 2)).center(); }

  /// A right click at a place in the board: the mouse button, then the event that asks for the menu.
  void RightClick(const QPoint& place, const std::function<void(QMenu&)>& choose) {
    QTest::mouseClick(Board().viewport(), Qt::RightButton, {}, place);
    WithMenu(choose, [&] {
      QContextMenuEvent event(QContextMenuEvent::Mouse, place, Board().viewport()->mapToGlobal(place));
      QApplication::sendEvent(Board().viewport(), &event);
    });
  }

  /// Does `choose` with the menu open, if `open` opens it.
  void WithMenu(const std::function<void(QMenu&)>& choose, const std::function<void()>& open) {
    auto& menu = venue.Find<QMenu>("mnuPopup");
    QTimer timer;
    QObject::connect(&timer, &QTimer::timeout, &timer, [&] {
      if (menu.isVisible()) {
        timer.stop();
        choose(menu);
        menu.close();
      }
    });
    timer.start(0);
    open();
  }

  /// Gives points to the player of the row that the menu then stands for.
  void GiveBonus(const std::function<void(const std::function<void(QMenu&)>&)>& open, const char* points) {
    const WhileModal<BonusPoints> bonus([points](BonusPoints& window) {
      ::Find<QLineEdit>(window, "BonusPointsEntry").setText(QString::fromUtf8(points));
      ::Press(window, "OK");
    });
    open([this](QMenu& menu) {
      menu.setActiveAction(&venue.Find<QAction>("mnuBonusPoints"));
      QTest::keyClick(&menu, Qt::Key_Return);
    });
    EXPECT_EQ(bonus.Runs(), 1);
  }

  Venue venue;
};

TEST_F(Popup, HasItsItemsAndLines) {
  std::vector<std::string> items;
  for (const QAction* action : venue.Find<QMenu>("mnuPopup").actions()) {
    items.push_back((action->isSeparator() ? action->objectName() : action->text()).toStdString());
  }
  EXPECT_THAT(items, ElementsAre("Assign Member", "Unassign Member", "hyphen6", "Show Detailed Scores",
                                 "hyphen7", "Bonus Soldiering Points"));
}

TEST_F(Popup, DoesNotOpenWithoutASelectedRow) {
  venue.LoadGame(SmallGame());
  int opened = 0;
  Board().clearSelection();
  venue.OpenPopup(-1, [&](QMenu&) { ++opened; });
  RightClick(QPoint(30, Board().viewport()->height() - 5), [&](QMenu&) { ++opened; });
  EXPECT_EQ(opened, 0);
}

TEST_F(Popup, ActsOnTheRowUnderTheMouse) {
  venue.LoadGame(SmallGame());
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Blue  7", "Red  0"));
  GiveBonus([this](const auto& choose) { RightClick(CentreOf(1), choose); }, "100");
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  0", "Blue  7"));
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[2], " 100");
}

TEST_F(Popup, OpensByTheKeyboard) {
  venue.LoadGame(SmallGame());
  GiveBonus([this](const auto& choose) { venue.OpenPopup(0, choose); }, "-3");
  EXPECT_EQ(venue.Row("ScoreDisplay", 1)[2], "-3");
}

TEST_F(Popup, OpensByShiftAndF10) {
  venue.LoadGame(SmallGame());
  Board().selectRow(0);
  GiveBonus(
      [this](const auto& choose) {
        WithMenu(choose, [this] {
          QKeyEvent press(QEvent::KeyPress, Qt::Key_F10, Qt::ShiftModifier);
          QApplication::sendEvent(&Board(), &press);
        });
      },
      "-3");
  EXPECT_EQ(venue.Row("ScoreDisplay", 1)[2], "-3");
}

TEST_F(Popup, ActsOnTheFirstRowWhenTheBoardWasReachedWithTheTabKey) {
  venue.LoadGame(SmallGame());
  QFocusEvent tabbed(QEvent::FocusIn, Qt::TabFocusReason);
  QApplication::sendEvent(&Board(), &tabbed);
  GiveBonus([this](const auto& choose) { venue.OpenPopup(-1, choose); }, "-3");
  EXPECT_EQ(venue.Row("ScoreDisplay", 1)[2], "-3");
}

TEST_F(Popup, IsFoundByScreenReadersWithoutShowingInTheMenuBar) {
  auto& bar = venue.Find<QMenuBar>("menubar");
  EXPECT_FALSE(venue.Find<QMenu>("mnuPopup").menuAction()->isVisible());
  const QAccessibleInterface* items = QAccessible::queryAccessibleInterface(&bar);
  ASSERT_NE(items, nullptr);
  const QAccessibleInterface* popup = items->child(items->childCount() - 1);
  ASSERT_EQ(popup->childCount(), 1);
  const QAccessibleInterface* menu = popup->child(0);
  EXPECT_EQ(menu->child(menu->childCount() - 1)->text(QAccessible::Name),
            QStringLiteral("Bonus Soldiering Points"));
}

TEST_F(Popup, ClosesWhenAnItemIsPressedByAScreenReader) {
  venue.LoadGame(SmallGame());
  Board().selectRow(0);
  auto& menu = venue.Find<QMenu>("mnuPopup");
  bool open = true;
  venue.OpenPopup(0, [&](QMenu&) {
    venue.Find<QAction>("mnuUnassignMember").trigger();
    open = menu.isVisible();
  });
  EXPECT_FALSE(open);
}

TEST_F(Popup, ActsOnTheLastOfSeveralSelectedRows) {
  venue.LoadGame(GameFile(PlayerOf(1, "<BonusPoints>3</BonusPoints>") +
                          PlayerOf(2, "<BonusPoints>2</BonusPoints>") +
                          PlayerOf(3, "<BonusPoints>1</BonusPoints>")));
  Board().selectAll();
  Board().selectionModel()->select(Board().model()->index(2, 0),
                                   QItemSelectionModel::Deselect | QItemSelectionModel::Rows);
  GiveBonus([this](const auto& choose) { venue.OpenPopup(-1, choose); }, "50");
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[1], "Red  1");
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[2], " 50");
}

TEST_F(Popup, ActsOnPlayersWithNumbersOf32AndAbove) {
  venue.LoadGame(GameFile(PlayerOf(105) + PlayerOf(224) + PlayerOf(9)));
  EXPECT_EQ(venue.Row("ScoreDisplay", 1)[1], "Red  40");
  GiveBonus([this](const auto& choose) { venue.OpenPopup(1, choose); }, "7");
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[1], "Red  40");
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[2], " 7");
}

TEST_F(Popup, FindsThePlayerBehindAMembersNameWithAColon) {
  venue.ChangeDatabase(
      "members.mdb",
      "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES (4, 'A', 'B', 'x: 9')");
  venue.Window.reset();
  venue.Start();
  venue.LoadGame(GameFile(PlayerOf(40, "<MemberIndex>4</MemberIndex>")));
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[1], "Blue  7: x: 9");
  GiveBonus([this](const auto& choose) { venue.OpenPopup(0, choose); }, "7");
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[2], " 7");
}

TEST_F(Popup, CalculatesAnewWhenItCloses) {
  venue.LoadGame(SmallGame());
  venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1 WHERE ID = 1");
  venue.ActiveMission().setCurrentIndex(2);
  venue.Boxes.Boxes.clear();
  venue.OpenPopup(0, [](QMenu&) {});
  EXPECT_EQ(venue.Boxes.Boxes.size(), 2U);  // one for each player of the mission that is gone
}

TEST_F(Popup, UnassignsAMember) {
  venue.ChangeDatabase("members.mdb",
                       "INSERT INTO Members (ContactID, FirstName, LastName) VALUES (4, 'Ada', 'Byron')");
  venue.Window.reset();
  venue.Start();
  venue.LoadGame(GameFile(PlayerOf(40, "<MemberIndex>4</MemberIndex><DallasID>0000000000000000</DallasID>")));
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[1], "Blue  7: Ada Byron");
  venue.ChooseInPopup(0, "mnuUnassignMember");
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[1], "Blue  7");
}

TEST_F(Popup, UnassignsNoMemberForLongWhoseButtonIsKnown) {
  venue.ChangeDatabase("members.mdb",
                       "INSERT INTO Members (ContactID, FirstName, LastName, DallasID) "
                       "VALUES (4, 'Ada', 'Byron', 'AB00000000000001')");
  venue.Window.reset();
  venue.Start();
  venue.LoadGame(GameFile(PlayerOf(40, "<DallasID>AB00000000000001</DallasID>")));
  venue.ChooseInPopup(0, "mnuUnassignMember");
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[1], "Blue  7: Ada Byron");
}

}  // namespace
