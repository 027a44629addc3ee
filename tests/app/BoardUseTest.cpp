#include <gmock/gmock.h>

#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>

#include "board/BoardPane.h"
#include "board/BonusPoints.h"
#include "board/PlayerDetails.h"
#include "board/ScoreListView.h"
#include "tests/support/Announcements.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

// What the operator does on the board beside its context menu.

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class BoardUse : public testing::Test {
 protected:
  BoardUse() {
    venue.PutDefaultFiles();
    venue.ChangeDatabase(
        "members.mdb",
        "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES (4, 'Ada', 'Byron', "
        "'Countess')");
    StartWithGame();
  }

  void StartWithGame() {
    venue.Start();
    venue.LoadGame(GameFile(PlayerOf(1, "<BonusPoints>3</BonusPoints>") +
                            PlayerOf(40, "<BonusPoints>2</BonusPoints><MemberIndex>4</MemberIndex>") +
                            PlayerOf(65, "<BonusPoints>1</BonusPoints>")));
  }

  ScoreListView& Board() { return venue.Find<ScoreListView>("ScoreDisplay"); }

  QPoint CentreOf(int row) { return Board().visualRect(Board().model()->index(row, 2)).center(); }

  /// A modal window counts as active while its parent still has the keyboard.
  static void ShowInFront(QWidget& window) {
    Show(window);
    ASSERT_TRUE(QTest::qWaitFor([&window] { return window.isActiveWindow(); }));
  }

  static std::string NameIn(const QWidget& window) {
    return ::Find<QLabel>(window, "PlayerName").text().toStdString();
  }

  std::string SelectedGun() {
    const QModelIndexList rows = Board().selectionModel()->selectedRows(1);
    return rows.size() == 1 ? rows[0].data().toString().toStdString() : "";
  }

  Venue venue;
};

TEST_F(BoardUse, ShowsThePlayersDetailsByDoubleClickAndByReturn) {
  for (const bool byKey : {false, true}) {
    const WhileModal<PlayerDetails> details([](PlayerDetails& window) {
      EXPECT_EQ(NameIn(window), "Blue  7: Countess");
      ::Press(window, "OKButton");
    });
    if (byKey) {
      QTest::keyClick(&Board(), Qt::Key_Return);
    } else {
      QTest::mouseDClick(Board().viewport(), Qt::LeftButton, {}, CentreOf(1));
    }
    EXPECT_EQ(details.Runs(), 1);
    EXPECT_EQ(SelectedGun(), "Blue  7: Countess");
  }
}

TEST_F(BoardUse, CalculatesAnewAfterTheDetails) {
  venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1 WHERE ID = 1");
  venue.ActiveMission().setCurrentIndex(2);
  venue.Boxes.Boxes.clear();
  Board().selectRow(0);
  const WhileModal<PlayerDetails> details([](PlayerDetails& window) { window.close(); });
  QTest::keyClick(&Board(), Qt::Key_Return);
  EXPECT_EQ(venue.Boxes.Boxes.size(), 3U);  // one for each player of the mission that is gone
}

TEST_F(BoardUse, DoesNothingByReturnWithoutASelectedRow) {
  Board().clearSelection();
  const WhileModal<PlayerDetails> details([](PlayerDetails& window) { window.close(); });
  QTest::keyClick(&Board(), Qt::Key_Return);
  QCoreApplication::processEvents();
  EXPECT_EQ(details.Runs(), 0);
}

TEST_F(BoardUse, WalksFromPlayerToPlayerInTheDetails) {
  Board().selectRow(0);
  const WhileModal<PlayerDetails> details([](PlayerDetails& window) {
    ShowInFront(window);
    EXPECT_EQ(NameIn(window), "Red  0");
    Type(window, Qt::Key_PageUp);
    EXPECT_EQ(NameIn(window), "Red  0");
    Type(window, Qt::Key_PageDown);
    EXPECT_EQ(NameIn(window), "Blue  7: Countess");
    EXPECT_EQ(::Find<QLabel>(window, "SoldieringDisplay").text(), QStringLiteral(" 2"));
    ::Find<QListWidget>(window, "WhoYouHit").setFocus();
    Type(window, Qt::Key_PageDown);
    Type(window, Qt::Key_PageDown);
    EXPECT_EQ(NameIn(window), "Yellow  0");
    Type(window, Qt::Key_PageUp);
    Type(window, Qt::Key_PageDown);
    ::Press(window, "OKButton");
  });
  QTest::keyClick(&Board(), Qt::Key_Return);
  EXPECT_EQ(details.Runs(), 1);
  EXPECT_EQ(SelectedGun(), "Yellow  0");
}

TEST_F(BoardUse, SaysToScreenReadersWhoseDetailsAreShownNow) {
  Board().selectRow(0);
  const WhileModal<PlayerDetails> details([](PlayerDetails& window) {
    ShowInFront(window);
    const Announcements announced;
    Type(window, Qt::Key_PageUp);
    EXPECT_THAT(announced.Heard(), IsEmpty()) << "at the first player";
    Type(window, Qt::Key_PageDown);
    EXPECT_THAT(announced.Heard(), ElementsAre(QStringLiteral("PlayerName")));
    window.close();
  });
  QTest::keyClick(&Board(), Qt::Key_Return);
  EXPECT_EQ(details.Runs(), 1);
}

TEST_F(BoardUse, NamesTheMemberInTheBonusPoints) {
  const WhileModal<BonusPoints> bonus([](BonusPoints& window) {
    EXPECT_EQ(NameIn(window), "Blue  7: Countess");
    ::Find<QLineEdit>(window, "BonusPointsEntry").setText(QStringLiteral("50"));
    ::Press(window, "OK");
  });
  venue.ChooseInPopup(1, "mnuBonusPoints");
  EXPECT_EQ(bonus.Runs(), 1);
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[2], " 50");
  EXPECT_EQ(SelectedGun(), "Blue  7: Countess");
}

TEST_F(BoardUse, SelectsNothingInTheNextGame) {
  Board().selectRow(0);
  venue.LoadGame(GameFile(PlayerOf(1)));
  EXPECT_EQ(SelectedGun(), "");
}

TEST_F(BoardUse, RemembersLettersAndColumns) {
  const auto heightOfRows = [this] { return Board().verticalHeader()->defaultSectionSize(); };
  const int usual = heightOfRows();
  Type(*venue.Window, Qt::Key_Plus, Qt::ControlModifier);
  Type(*venue.Window, Qt::Key_Equal, Qt::ControlModifier);
  const int larger = heightOfRows();
  EXPECT_GT(larger, usual);
  Board().SetDraggedShares({0.3, 0.1, 0.1, 0.1, 0.1, 0.1, 0.1, 0.05, 0.05});
  emit Board().WidthsDragged();
  EXPECT_THAT(ReadFile(venue.DataFile("state.ini")),
              HasSubstr("[board]\nletters=120\nScoreDisplay_columns=3000,"));
  venue.Window.reset();
  StartWithGame();
  EXPECT_EQ(heightOfRows(), larger);
  EXPECT_NEAR(Board().columnWidth(0), 0.3 * Board().viewport()->width(), 2);
  Type(*venue.Window, Qt::Key_0, Qt::ControlModifier);
  EXPECT_EQ(heightOfRows(), usual);
  Type(*venue.Window, Qt::Key_Plus, Qt::ControlModifier);
  Type(*venue.Window, Qt::Key_Minus, Qt::ControlModifier);
  EXPECT_EQ(heightOfRows(), usual);
  venue.Trigger("mnuUsualColumns");
  EXPECT_TRUE(Board().DraggedShares().empty());
  venue.Window.reset();
  StartWithGame();
  EXPECT_EQ(heightOfRows(), usual);
  EXPECT_TRUE(Board().DraggedShares().empty());
}

}  // namespace
