#include "board/BoardPane.h"

#include <gtest/gtest.h>

#include <QHeaderView>
#include <QLabel>
#include <QScrollBar>
#include <QSignalSpy>
#include <QVBoxLayout>

#include "board/BoardLetters.h"
#include "board/PlayerDelegate.h"
#include "board/ScoreListHeader.h"
#include "board/ScoreListModel.h"
#include "board/ScoreListView.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"
#include "tests/support/OnScreen.h"
#include "tests/support/OpenSession.h"

namespace {

/// A pane as in the main window, which is some 100 pixels higher.
class APane : public BoardPane {
 public:
  APane(Session& session, const StringTable& strings)
      : playerModel_(session, BoardList::Players, strings, nullptr),
        teamModel_(session, BoardList::Teams, strings, nullptr) {
    auto* parts = new QVBoxLayout(this);
    parts->setContentsMargins(16, 8, 16, 8);
    for (ScoreListView* list : {Players, Teams}) {
      auto* part = new QVBoxLayout;
      part->addWidget(new QLabel(QStringLiteral("Rank"), this));
      part->addWidget(list);
      parts->addLayout(part, list == Players ? 1 : 0);
    }
    static_cast<QVBoxLayout*>(parts->itemAt(1)->layout())->addStretch();
    Players->setModel(&playerModel_);
    Players->setItemDelegateForColumn(1, new PlayerDelegate(Players));
    Players->SetColumnShares(std::vector<double>(BoardColumnCount, 1.0 / BoardColumnCount));
    Teams->setModel(&teamModel_);
    Teams->SetColumnShares(std::vector<double>(TeamColumnCount, 1.0 / TeamColumnCount));
    Teams->ShowWholeRows(TeamCount);
    SetLists(*Players, *Teams, *parts);
  }

  double Capitals() const { return QFontMetricsF(Players->font()).capHeight(); }
  bool Scrolls() const {
    return Players->verticalScrollBar()->isVisible() || Players->horizontalScrollBar()->isVisible();
  }

  ScoreListView* const Players = new ScoreListView(this);
  ScoreListView* const Teams = new ScoreListView(this);

 private:
  ScoreListModel playerModel_;
  ScoreListModel teamModel_;
};

class BoardOnItsScreen : public testing::Test {
 protected:
  BoardOnItsScreen() {
    ExecuteSql(venue.MembersFile(), "INSERT INTO Members (ContactID, NickName) VALUES (3, 'Countess')");
    venue.Open();
  }

  /// A game of that many guns with figures as they are, every second one a member's.
  void PlayGuns(int guns) {
    for (int index = 1; index <= guns; ++index) {
      Player& player = venue.Play(index, 20 * index);
      player.MemberIndex = index % 2 * 3;
      player.ShotCount = 100 + 9 * index;
      player.PrimaryDamage = 10;
      player.HealCount = 12;
      player.HitByPlayer(1 + (index + 40) % 224) = 500;
    }
    venue.session.CalculateScores();
  }

  APane& ShowPane(int width, int height) {
    pane = std::make_unique<APane>(venue.session, venue.Strings);
    pane->resize(width, height);
    Show(*pane);
    return *pane;
  }

  OpenSession venue;
  std::unique_ptr<APane> pane;
};

constexpr int FullHeight = 940;  ///< of a screen of 1080 pixels, with menu, banner and two more bars

TEST_F(BoardOnItsScreen, IsReadFromTwoMetresWithTwelveRows) {
  PlayGuns(12);
  for (const int points : {9, 11, 14}) {
    const FontOfSize font(points);
    const APane& board = ShowPane(1920, FullHeight);
    EXPECT_GE(board.Capitals(), ReadableCapitals) << points;
    EXPECT_FALSE(board.Scrolls()) << points;
    ExpectHeadersFit(board);
  }
}

TEST_F(BoardOnItsScreen, HasTheSameLettersForFewRowsAndSmallerOnesForMany) {
  PlayGuns(3);
  const double few = ShowPane(1920, FullHeight).Capitals();
  PlayGuns(12);
  EXPECT_DOUBLE_EQ(pane->Capitals(), few);
  PlayGuns(20);
  const double many = pane->Capitals();
  EXPECT_LT(many, few);
  EXPECT_GT(many, pane->Players->LeastCapitals());
  QCoreApplication::processEvents();
  EXPECT_FALSE(pane->Players->verticalScrollBar()->isVisible());
}

TEST_F(BoardOnItsScreen, ScrollsInTheSmallestLettersWithTooManyRows) {
  PlayGuns(60);
  const APane& board = ShowPane(1920, FullHeight);
  EXPECT_TRUE(board.Players->verticalScrollBar()->isVisible());
  EXPECT_FALSE(board.Players->horizontalScrollBar()->isVisible());
  EXPECT_DOUBLE_EQ(board.Players->Growth(), 1);
  EXPECT_EQ(board.Players->verticalHeader()->defaultSectionSize(), board.Players->LeastRow());
}

TEST_F(BoardOnItsScreen, HasTheTeamsBesideThePlayersWhereItIsWide) {
  PlayGuns(12);
  const APane& board = ShowPane(1920, FullHeight);
  EXPECT_GT(board.Teams->x(), board.Players->geometry().right());
  EXPECT_EQ(board.Teams->y(), board.Players->y());
  EXPECT_LT(board.Teams->width(), 550);
  EXPECT_FALSE(board.Teams->horizontalScrollBar()->isVisible());
  pane->resize(1024, 640);
  QCoreApplication::processEvents();
  EXPECT_GT(board.Teams->y(), board.Players->geometry().bottom());
  EXPECT_EQ(board.Teams->width(), board.Players->width());
  pane->resize(1920, FullHeight);
  QCoreApplication::processEvents();
  EXPECT_GT(board.Teams->x(), board.Players->geometry().right());
}

TEST_F(BoardOnItsScreen, CutsNoFigureOnAnyScreen) {
  PlayGuns(12);
  ShowPane(1920, FullHeight);
  for (const auto& [width, height] :
       {std::pair{1024, 640}, {1366, 640}, {1280, 900}, {1920, 940}, {2560, 1480}}) {
    pane->resize(width, height);
    QCoreApplication::processEvents();
    for (const ScoreListView* list : {pane->Players, pane->Teams}) {
      EXPECT_FALSE(list->horizontalScrollBar()->isVisible()) << width;
      const QAbstractItemModel& model = *list->model();
      for (int row = 0; row < model.rowCount(); ++row) {
        for (int column = 0; column < model.columnCount(); ++column) {
          EXPECT_LE(list->sizeHintForIndex(model.index(row, column)).width(), list->columnWidth(column))
              << width << ": " << model.index(row, column).data().toString().toStdString();
        }
      }
    }
  }
}

TEST_F(BoardOnItsScreen, HasRoomForNamesInLargeLetters) {
  PlayGuns(12);
  const ScoreListView& list = *ShowPane(1920, FullHeight).Players;
  EXPECT_GT(list.columnWidth(1), list.fontMetrics().horizontalAdvance(QStringLiteral("Countess")) + 60);
}

/// Counts how often a widget is painted.
class Paintings : public QObject {
 public:
  explicit Paintings(QWidget& widget) { widget.installEventFilter(this); }
  int Count = 0;

 protected:
  bool eventFilter(QObject* /*watched*/, QEvent* event) override {
    Count += event->type() == QEvent::Paint ? 1 : 0;
    return false;
  }
};

TEST_F(BoardOnItsScreen, IsPaintedOnceForEachSizeOfTheWindow) {
  PlayGuns(40);
  ShowPane(1920, FullHeight);
  QCoreApplication::processEvents();
  Paintings paintings(*pane->Players->viewport());
  constexpr int sizes = 10;
  for (int size = 1; size <= sizes; ++size) {
    pane->resize(1800 - size, 900 - size);
    QCoreApplication::processEvents();
  }
  EXPECT_GE(paintings.Count, sizes);
  EXPECT_LE(paintings.Count, sizes + 1);
}

TEST_F(BoardOnItsScreen, HasTheSignOfTheOrderCloseToTheCaption) {
  PlayGuns(12);
  const APane& board = ShowPane(1100, 1480);  // captions smaller than there is room for
  const auto& header = static_cast<const ScoreListHeader&>(*board.Players->horizontalHeader());
  const QRect section(0, 0, 200, header.height());
  const int captionTop = section.center().y() - header.fontMetrics().capHeight() / 2;
  const int gap = captionTop - header.SignPlace(2, section).bottom();
  EXPECT_GT(gap, 0);
  EXPECT_LT(gap, 7);
}

TEST_F(BoardOnItsScreen, TakesTheOperatorsWishForItsLetters) {
  PlayGuns(20);
  ShowPane(1920, FullHeight);
  const double usual = pane->Capitals();
  const QSignalSpy chosen(pane.get(), &BoardPane::LettersChosen);
  pane->MakeLettersLarger();
  EXPECT_GT(pane->Capitals(), usual);
  pane->MakeLettersUsual();
  EXPECT_DOUBLE_EQ(pane->Capitals(), usual);
  for (int press = 0; press < 20; ++press) {
    pane->MakeLettersSmaller();
  }
  EXPECT_DOUBLE_EQ(pane->Players->Growth(), 1);
  const int smallest = pane->Letters();
  pane->MakeLettersLarger();
  EXPECT_GT(pane->Players->verticalHeader()->defaultSectionSize(), pane->Players->LeastRow())
      << "after " << smallest << " %";
  EXPECT_GT(chosen.count(), 4);
  EXPECT_LT(chosen.count(), 15) << "more than the sizes that look different";
}

}  // namespace
