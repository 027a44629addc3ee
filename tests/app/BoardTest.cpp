#include <gmock/gmock.h>

#include <QHeaderView>
#include <QItemSelectionModel>
#include <QLineEdit>
#include <set>

#include "board/PlayerDetails.h"
#include "board/ScoreListView.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// Damage that the player whose record this stands in took from player `shooter`.
std::string HitBy(int shooter, int amount) {
  return "<HitData><HitByPlayer><Index>" + std::to_string(shooter) + "</Index><Amount>" +
         std::to_string(amount) + "</Amount></HitByPlayer></HitData>";
}

/// Red 1 with 289 points, Yellow 7 (member 3) with 12, Blue 40 (by button, member 5) with 0, Red 5 with -4.
std::string GameOfFour() {
  return GameFile(
      PlayerOf(2,
               "<ShotCount>60</ShotCount><HealCount>1</HealCount><AmmoAddCount>2</AmmoAddCount>"
               "<DeathCount>3</DeathCount><PrimaryDamage>10</PrimaryDamage><BonusPoints>5</BonusPoints>") +
      PlayerOf(6, "<DeathCount>4</DeathCount>" + HitBy(2, 30)) +
      PlayerOf(72,
               "<PrimaryDamage>5</PrimaryDamage><BonusPoints>12</BonusPoints><MemberIndex>3</MemberIndex>") +
      PlayerOf(169,
               "<PrimaryDamage>20</PrimaryDamage><DallasID>AB00000000000001</DallasID>" + HitBy(2, 270)));
}

class Board : public testing::Test {
 protected:
  Board() {
    venue.PutDefaultFiles();
    venue.ChangeDatabase("members.mdb",
                         "INSERT INTO Members (ContactID, FirstName, LastName, NickName, DallasID) VALUES"
                         " (3, 'Ada', 'Berg', 'Falke: One', NULL),"
                         " (5, 'Jörg', 'Östlund', NULL, 'AB00000000000001')");
    venue.Start();
  }

  void ClickHeader(const std::string& list, int section) const {
    QHeaderView& header = *venue.Find<QTableView>(list).horizontalHeader();
    QTest::mouseClick(header.viewport(), Qt::LeftButton, {},
                      QPoint(header.sectionViewportPosition(section) + header.sectionSize(section) / 2,
                             header.height() / 2));
  }

  /// Calculates anew without changing an input.
  void Recalculate() const {
    venue.ActiveMission().setCurrentIndex(1);
    venue.ActiveMission().setCurrentIndex(0);
  }

  /// Team and number of each row.
  std::vector<std::string> Players() const {
    std::vector<std::string> players = venue.Column("ScoreDisplay", 1);
    for (std::string& player : players) {
      player.erase(std::min(player.find(':'), player.size()));
    }
    return players;
  }

  Venue venue;
};

TEST_F(Board, HasItsHeadersInEachLanguage) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    Venue place(language);
    place.Start();
    const QAbstractItemModel& board = *place.Find<QTableView>("ScoreDisplay").model();
    ASSERT_EQ(board.columnCount(), 9);
    for (int column = 0; column < 9; ++column) {
      EXPECT_EQ(board.headerData(column, Qt::Horizontal).toString().toStdString(),
                place.Strings.Text(103 + column));
    }
    const QAbstractItemModel& teams = *place.Find<QTableView>("TeamScores").model();
    ASSERT_EQ(teams.columnCount(), 3);
    EXPECT_EQ(teams.headerData(0, Qt::Horizontal).toString().toStdString(), place.Strings.Text(112));
    EXPECT_EQ(teams.headerData(1, Qt::Horizontal).toString().toStdString(), place.Strings.Text(113));
    EXPECT_EQ(teams.headerData(2, Qt::Horizontal).toString().toStdString(), place.Strings.Text(105));
  }
}

TEST_F(Board, ShowsEveryCellInItsForm) {
  venue.LoadGame(GameOfFour());
  ASSERT_EQ(venue.RowCount("ScoreDisplay"), 4);
  EXPECT_THAT(venue.Row("ScoreDisplay", 0),
              ElementsAre("1", "Red  1", " 289", "50.00%", " 240", " 60", " 1", " 3", " 2"));
  EXPECT_THAT(venue.Row("ScoreDisplay", 1),
              ElementsAre("2", "Yellow  7: Falke: One", " 12", "N/A", " 0", " 0", " 0", " 0", " 0"));
  EXPECT_THAT(venue.Row("ScoreDisplay", 2),
              ElementsAre("3", "Blue  40: Jörg Östlund", " 0", "N/A", " 0", " 0", " 0", " 0", " 0"));
  EXPECT_THAT(venue.Row("ScoreDisplay", 3),
              ElementsAre("4", "Red  5", "-4", "Error", " 0", " 0", " 0", " 4", " 0"));
}

TEST_F(Board, ShowsTheTeamsInOrderOfTheirTotals) {
  venue.LoadGame(GameOfFour());
  ASSERT_EQ(venue.RowCount("TeamScores"), 3);
  EXPECT_THAT(venue.Row("TeamScores", 0), ElementsAre("1", "Red", " 285"));
  EXPECT_THAT(venue.Row("TeamScores", 1), ElementsAre("2", "Yellow", " 12"));
  EXPECT_THAT(venue.Row("TeamScores", 2), ElementsAre("3", "Blue", " 0"));
}

TEST_F(Board, ShowsAllTeamsForAGameWithoutPlayers) {
  venue.LoadGame(GameFile(""));
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  EXPECT_THAT(venue.Column("TeamScores", 1), ElementsAre("Red", "Blue", "Yellow"));
  EXPECT_THAT(venue.Column("TeamScores", 2), ElementsAre(" 0", " 0", " 0"));
}

TEST_F(Board, SaysWhenAMemberIsGone) {
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>99</MemberIndex>")));
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Could not locate specified Member in database!",
                                                "Member Error", BoxIcon::Exclamation, BoxButtons::Ok}));
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  0"));
}

TEST_F(Board, NamesTheTeamsInChinese) {
  Venue chinese(Language::SimplifiedChinese);
  chinese.Start();
  chinese.LoadGame(SmallGame());
  EXPECT_THAT(chinese.Column("ScoreDisplay", 1), ElementsAre("蓝队  7", "红队  0"));
  EXPECT_THAT(chinese.Column("ScoreDisplay", 3), ElementsAre("错误", "错误"));
}

TEST_F(Board, SortsUpwardsByRankAndDownwardsByEveryFigure) {
  const auto figures = [](int shots, int heals, int deaths, int ammo, int bonus) {
    const auto element = [](const std::string& name, int value) {
      return "<" + name + ">" + std::to_string(value) + "</" + name + ">";
    };
    return element("ShotCount", shots) + element("HealCount", heals) + element("DeathCount", deaths) +
           element("AmmoAddCount", ammo) + element("BonusPoints", bonus) + element("PrimaryDamage", 1);
  };
  // Soldiering: Blue 0 is first, Red 0 second, Yellow 0 last.
  venue.LoadGame(GameFile(PlayerOf(1, figures(9, 2, 1, 10, 20) + HitBy(65, 4)) +
                          PlayerOf(33, figures(10, 1, 2, 3, 900) + HitBy(1, 2)) +
                          PlayerOf(65, figures(1, 10, 3, 2, -500) + HitBy(33, 3))));
  ASSERT_THAT(Players(), ElementsAre("Blue  0", "Red  0", "Yellow  0"));
  const auto sortedBy = [this](int column) {
    ClickHeader("ScoreDisplay", column);
    return Players();
  };
  EXPECT_THAT(sortedBy(3), ElementsAre("Yellow  0", "Blue  0", "Red  0"));  // 400%, 30%, 22.22%
  EXPECT_THAT(sortedBy(4), ElementsAre("Yellow  0", "Blue  0", "Red  0"));
  EXPECT_THAT(sortedBy(0), ElementsAre("Blue  0", "Red  0", "Yellow  0"));
  EXPECT_THAT(sortedBy(5), ElementsAre("Blue  0", "Red  0", "Yellow  0"));
  EXPECT_THAT(sortedBy(6), ElementsAre("Yellow  0", "Red  0", "Blue  0"));
  EXPECT_THAT(sortedBy(7), ElementsAre("Yellow  0", "Blue  0", "Red  0"));
  EXPECT_THAT(sortedBy(8), ElementsAre("Red  0", "Blue  0", "Yellow  0"));
  EXPECT_THAT(sortedBy(2), ElementsAre("Blue  0", "Red  0", "Yellow  0"));
  EXPECT_THAT(venue.Column("ScoreDisplay", 0), ElementsAre("1", "2", "3"));
}

TEST_F(Board, SortsByThePlayerInTheOrderOfTheirRecords) {
  venue.LoadGame(GameOfFour());
  ClickHeader("ScoreDisplay", 1);
  EXPECT_THAT(Players(), ElementsAre("Red  1", "Red  5", "Yellow  7", "Blue  40"));
  EXPECT_THAT(venue.Column("ScoreDisplay", 0), ElementsAre("1", "4", "2", "3"));
}

TEST_F(Board, KeepsThePlacesInAClickOnAHeader) {
  venue.LoadGame(GameOfFour());
  ClickHeader("ScoreDisplay", 7);
  EXPECT_THAT(Players(), ElementsAre("Red  5", "Red  1", "Yellow  7", "Blue  40"));
  EXPECT_THAT(venue.Column("ScoreDisplay", 0), ElementsAre("4", "1", "2", "3"));
}

TEST_F(Board, RanksUpwardsAfterAClickOnAnUpwardHeaderUntilALaterOne) {
  venue.LoadGame(GameOfFour());
  for (const int upward : {0, 1}) {
    ClickHeader("ScoreDisplay", upward);
    Recalculate();
    EXPECT_THAT(venue.Column("ScoreDisplay", 2), ElementsAre("-4", " 0", " 12", " 289")) << upward;
    EXPECT_THAT(venue.Column("ScoreDisplay", 0), ElementsAre("1", "2", "3", "4"));
    EXPECT_THAT(venue.Column("TeamScores", 2), ElementsAre(" 285", " 12", " 0"));
    ClickHeader("ScoreDisplay", 8);
    Recalculate();
    EXPECT_THAT(venue.Column("ScoreDisplay", 2), ElementsAre(" 289", " 12", " 0", "-4"));
  }
}

TEST_F(Board, DoesNothingAtAClickOnAHeaderOfTheTeams) {
  venue.LoadGame(GameOfFour());
  for (const int section : {0, 1, 2}) {
    ClickHeader("TeamScores", section);
    EXPECT_THAT(venue.Column("TeamScores", 1), ElementsAre("Red", "Yellow", "Blue"));
    EXPECT_FALSE(venue.Find<QTableView>("TeamScores").selectionModel()->hasSelection());
  }
  Recalculate();
  EXPECT_THAT(venue.Column("TeamScores", 1), ElementsAre("Red", "Yellow", "Blue"));
}

TEST_F(Board, TakesAClickOnAHeaderWhileItIsEmpty) {
  ClickHeader("ScoreDisplay", 0);
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  EXPECT_EQ(venue.RowCount("TeamScores"), 0);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Board, SelectsWholeRowsAndLetsNobodyWriteIntoThem) {
  venue.LoadGame(GameOfFour());
  QTableView& board = venue.Find<QTableView>("ScoreDisplay");
  const QModelIndex cell = board.model()->index(1, 4);
  QTest::mouseClick(board.viewport(), Qt::LeftButton, {}, board.visualRect(cell).center());
  EXPECT_TRUE(board.selectionModel()->isRowSelected(1));
  EXPECT_EQ(board.selectionModel()->selectedRows().size(), 1);
  const WhileModal<PlayerDetails> details([](PlayerDetails& window) { window.close(); });
  QTest::mouseDClick(board.viewport(), Qt::LeftButton, {}, board.visualRect(cell).center());
  QTest::keyClick(&board, Qt::Key_F2);
  EXPECT_EQ(board.findChild<QLineEdit*>(), nullptr);
  EXPECT_FALSE(cell.flags().testFlag(Qt::ItemIsEditable));
}

TEST_F(Board, GivesEachColumnItsShareOfTheWidth) {
  venue.LoadGame(GameOfFour());
  for (const int width : {1024, 1900}) {
    venue.Window->resize(width, 700);
    const QTableView& board = venue.Find<QTableView>("ScoreDisplay");
    const double share = board.viewport()->width() / 9.0;
    const double moved = board.viewport()->width() * 0.027;
    EXPECT_NEAR(board.columnWidth(0), share - moved, 1);
    EXPECT_NEAR(board.columnWidth(1), share + moved, 1);
    for (int column = 2; column < 8; ++column) {
      EXPECT_NEAR(board.columnWidth(column), share, 1);
    }
    const QTableView& teams = venue.Find<QTableView>("TeamScores");
    EXPECT_NEAR(teams.columnWidth(0), teams.viewport()->width() / 3.0, 1);
    EXPECT_NEAR(teams.columnWidth(1), teams.viewport()->width() / 3.0, 1);
  }
}

TEST_F(Board, ColoursEachTeamInBothLists) {
  venue.LoadGame(GameOfFour());
  const auto colours = [this](const std::string& list, int column) {
    std::set<QRgb> found;
    const QAbstractItemModel& model = *venue.Find<QTableView>(list).model();
    for (int row = 0; row < model.rowCount(); ++row) {
      found.insert(model.index(row, column).data(Qt::BackgroundRole).value<QColor>().rgba());
      EXPECT_FALSE(model.index(row, 1).data(Qt::DecorationRole).isNull());
    }
    return found;
  };
  EXPECT_EQ(colours("ScoreDisplay", 2).size(), 3u);
  EXPECT_EQ(colours("ScoreDisplay", 2), colours("TeamScores", 2));
}

TEST_F(Board, ShowsAMembersNameBelowThePlayer) {
  venue.LoadGame(GameOfFour());
  const auto& board = venue.Find<QTableView>("ScoreDisplay");
  // Dark dots to the right of the team's badge, in the lowest quarter of the cell.
  const auto inkBelow = [&board](int row) {
    const QRect cell = board.visualRect(board.model()->index(row, 1));
    const QImage picture = board.viewport()->grab(cell.adjusted(40, cell.height() * 3 / 4, 0, 0)).toImage();
    int dots = 0;
    for (int y = 0; y < picture.height(); ++y) {
      for (int x = 0; x < picture.width(); ++x) {
        dots += picture.pixelColor(x, y).lightness() < 128 ? 1 : 0;
      }
    }
    return dots;
  };
  EXPECT_EQ(inkBelow(0), 0);  // Red 1, who is no member
  EXPECT_GT(inkBelow(2), 20);
}

TEST_F(Board, TellsTheWholePlayerAsToolTip) {
  venue.LoadGame(GameOfFour());
  const QAbstractItemModel& board = *venue.Find<QTableView>("ScoreDisplay").model();
  EXPECT_EQ(board.index(2, 1).data(Qt::ToolTipRole).toString(), QStringLiteral("Blue  40: Jörg Östlund"));
  EXPECT_TRUE(board.index(2, 2).data(Qt::ToolTipRole).isNull());
}

TEST_F(Board, IsEmptiedByClearGameOnOk) {
  venue.LoadGame(GameOfFour());
  venue.Boxes.Answers = {BoxAnswer::Ok};
  venue.Trigger("mnuClearScores");
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"This will delete all Player Score. Are you sure?",
                                                "Confirm Clear", BoxIcon::Question, BoxButtons::OkCancel}));
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  EXPECT_EQ(venue.RowCount("TeamScores"), 0);
  Recalculate();  // without a game this does nothing
  EXPECT_EQ(venue.RowCount("TeamScores"), 0);
}

TEST_F(Board, StaysAsItIsWhenClearGameIsCancelled) {
  venue.LoadGame(GameOfFour());
  const std::vector<std::string> before = venue.Column("ScoreDisplay", 2);
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  venue.Trigger("mnuClearScores");
  EXPECT_EQ(venue.Column("ScoreDisplay", 2), before);
  EXPECT_EQ(venue.RowCount("TeamScores"), 3);
  Recalculate();
  EXPECT_EQ(venue.Column("ScoreDisplay", 2), before);
}

}  // namespace
