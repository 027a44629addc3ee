#include "core/game/ScoreList.h"

#include <gmock/gmock.h>

#include "tests/support/ScoredGame.h"

namespace {

using testing::ElementsAre;

class Sorting : public testing::Test {
 protected:
  /// Rows of rank text, player and one figure.
  void Add(const std::string& rank, const std::string& player, const std::string& figure) {
    ScoreList::Row& row = list.AddRow();
    row.Cells[0] = rank;
    row.Cells[1] = player;
    row.Cells[2] = figure;
  }

  std::vector<std::string> Column(int column) const {
    std::vector<std::string> cells;
    for (int place = 0; place < list.RowCount(); ++place) {
      cells.push_back(list.RowAt(place).Cells[static_cast<std::size_t>(column)]);
    }
    return cells;
  }

  StringTable strings{Language::English};
  Game game{strings};
  ScoreList list;
};

TEST_F(Sorting, IsDescendingAtFirst) {
  EXPECT_EQ(list.SortOrder, SortOrder::Descending);
}

TEST_F(Sorting, GoesByNumberAndNotByText) {
  for (const char* figure : {" 9", " 10", "-1", "-20", " 0"}) {
    Add(" 0", "Red  1", figure);
  }
  SortListNumeric(list, 2, false, game);
  EXPECT_THAT(Column(2), ElementsAre(" 10", " 9", " 0", "-1", "-20"));
  list.SortOrder = SortOrder::Ascending;
  SortListNumeric(list, 2, false, game);
  EXPECT_THAT(Column(2), ElementsAre("-20", "-1", " 0", " 9", " 10"));
}

TEST_F(Sorting, ReadsPercentagesAndPutsOtherTextBelowAllNumbers) {
  for (const char* figure : {"N/A", "52.00%", "-5.00%", "Error", "100.00%"}) {
    Add(" 0", "Red  1", figure);
  }
  SortListNumeric(list, 2, false, game);
  EXPECT_THAT(Column(2), ElementsAre("100.00%", "52.00%", "-5.00%", "N/A", "Error"));
  list.SortOrder = SortOrder::Ascending;
  SortListNumeric(list, 2, false, game);
  EXPECT_THAT(Column(2), ElementsAre("N/A", "Error", "-5.00%", "52.00%", "100.00%"));
}

TEST_F(Sorting, KeepsTheOrderOfAddingForEqualCellsInBothDirections) {
  Add("1", "Red  1", " 5");
  Add("2", "Red  2", " 7");
  Add("3", "Red  3", " 5");
  SortListNumeric(list, 2, false, game);
  EXPECT_THAT(Column(1), ElementsAre("Red  2", "Red  1", "Red  3"));
  list.SortOrder = SortOrder::Ascending;
  SortListNumeric(list, 2, false, game);
  EXPECT_THAT(Column(1), ElementsAre("Red  1", "Red  3", "Red  2"));
}

TEST_F(Sorting, ByPlayerRestoresTheOrderOfAdding) {
  Add("1", "Red  1: 12", " 5");
  Add("2", "Blue  2", " 7");
  SortListNumeric(list, 2, false, game);
  SortByHeader(list, 2, game);
  EXPECT_THAT(Column(1), ElementsAre("Red  1: 12", "Blue  2"));
}

TEST_F(Sorting, OfAColumnLeavesTheRankTexts) {
  Add("2", "Red  1", " 5");
  Add("1", "Red  2", " 7");
  SortByHeader(list, 3, game);
  EXPECT_THAT(Column(0), ElementsAre("1", "2"));
  EXPECT_EQ(game.Players(2).Rank, 0);
}

TEST_F(Sorting, ByRankWritesEachPlaceIntoTheRecordOfThatNumber) {
  Add("2", "Blue  4", " 5");
  Add("1", "Yellow  9", " 7");
  SortByHeader(list, 1, game);
  EXPECT_THAT(Column(0), ElementsAre("1", "2"));
  EXPECT_EQ(game.Players(1).Rank, 1);
  EXPECT_EQ(game.Players(2).Rank, 2);
  EXPECT_EQ(game.Players(37).Rank, 0);
}

TEST_F(Sorting, PutsEmptyCellsAndBrokenNumbersBelowAllNumbers) {
  for (const char* figure : {"", "-2000000000", "5%%", "%", "7x"}) {
    Add(" 0", "Red  1", figure);
  }
  SortListNumeric(list, 2, false, game);
  EXPECT_THAT(Column(2), ElementsAre("7x", "-2000000000", "", "5%%", "%"));
}

TEST_F(Sorting, TakesNoPercentageInTheRowText) {
  for (const char* rank : {"9%", "3", "12"}) {
    Add(rank, "Red  1", " 0");
  }
  SortListNumeric(list, 0, false, game);
  EXPECT_THAT(Column(0), ElementsAre("12", "3", "9%"));
}

TEST_F(Sorting, TellsNearPercentagesApart) {
  for (const char* figure : {"9.99%", "10.00%", "9.98%", ".50%"}) {
    Add(" 0", "Red  1", figure);
  }
  SortListNumeric(list, 2, false, game);
  EXPECT_THAT(Column(2), ElementsAre("10.00%", "9.99%", "9.98%", ".50%"));
}

TEST_F(Sorting, WithRanksNumbersTheRowsAndFindsTheRecordsByTeamAndNumber) {
  Add(" 0", "Red  31", " 1");
  Add(" 0", "  Blue  0: 12 ", " 2");
  Add(" 0", "Yellow  5", " 3");
  Add(" 0", "Green  6", " 4");
  Add(" 0", "Red  40: Bo", " 5");
  Add(" 0", "Blue", " 6");
  SortListNumeric(list, 2, true, game);
  EXPECT_THAT(Column(0), ElementsAre("1", "2", "3", "4", "5", "6"));
  const std::pair<int, int> ranks[] = {{41, 2}, {71, 3}, {70, 4}, {33, 5}, {32, 6}};
  int written = 0;
  for (const auto& [record, rank] : ranks) {
    EXPECT_EQ(game.Players(record).Rank, rank) << record;
  }
  for (const Player& player : game.Players) {
    written += player.Rank != 0 ? 1 : 0;
  }
  EXPECT_EQ(written, 5);
}

TEST_F(Sorting, ByRankGoesUpwardByNumber) {
  for (const char* rank : {"10", "9", "1"}) {
    Add(rank, "Red  " + std::string(rank), " 5");
  }
  SortByHeader(list, 1, game);
  EXPECT_THAT(Column(1), ElementsAre("Red  1", "Red  9", "Red  10"));
}

TEST_F(Sorting, OfAnEmptyListIsNoFault) {
  for (int header = 1; header <= 9; ++header) {
    SortByHeader(list, header, game);
  }
  EXPECT_EQ(list.RowCount(), 0);
}

TEST_F(Sorting, SetsTheDirectionByHeader) {
  for (int header = 1; header <= 2; ++header) {
    SortByHeader(list, header, game);
    EXPECT_EQ(list.SortOrder, SortOrder::Ascending) << header;
  }
  for (int header = 3; header <= 9; ++header) {
    list.SortOrder = SortOrder::Ascending;
    SortByHeader(list, header, game);
    EXPECT_EQ(list.SortOrder, SortOrder::Descending) << header;
  }
}

TEST_F(Sorting, TellsTheViewOnce) {
  int changes = 0;
  Add("1", "Red  1", " 5");
  list.Changed = [&changes] { ++changes; };
  SortListNumeric(list, 2, true, game);
  EXPECT_EQ(changes, 1);
  list.Clear();
  EXPECT_EQ(changes, 2);
  EXPECT_EQ(list.RowCount(), 0);
}

constexpr int Red0 = 1;
constexpr int Blue0 = 33;
constexpr int Yellow0 = 65;
constexpr int Red32 = 97;
constexpr int Blue95 = 224;

TEST(Ranks, PutNegativeScoresLast) {
  ScoredGame venue;
  venue.Activate(Red0);
  venue.Activate(Blue0);
  venue.Activate(Yellow0).BonusPoints = -7;
  venue.game.Players(2).HitByPlayer(Red0) = 50;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, -50);
  EXPECT_THAT(venue.Column(BoardColumn::Soldiering), ElementsAre(" 0", "-7", "-50"));
  EXPECT_THAT(venue.Column(BoardColumn::Player), ElementsAre("Blue  0", "Yellow  0", "Red  0"));
}

TEST(Ranks, GoIntoThePlayersOwnRecordsUpToNumber31) {
  ScoredGame venue;
  venue.Activate(32).BonusPoints = 1;       // red 31
  venue.Activate(64).BonusPoints = 3;       // blue 31
  venue.Activate(Yellow0).BonusPoints = 2;  // yellow 0
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(64).Rank, 1);
  EXPECT_EQ(venue.game.Players(Yellow0).Rank, 2);
  EXPECT_EQ(venue.game.Players(32).Rank, 3);
}

TEST(Ranks, OfNumbersFrom32UpGoIntoAnotherRecord) {
  ScoredGame venue;
  venue.Activate(Red32);                   // 1 + 32
  venue.Activate(161).BonusPoints = 9;     // blue 32: 33 + 32
  venue.Activate(Blue95).BonusPoints = 5;  // 33 + 95
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(65).Rank, 1);
  EXPECT_EQ(venue.game.Players(128).Rank, 2);
  EXPECT_EQ(venue.game.Players(33).Rank, 3);
  for (const int own : {Red32, 161, Blue95}) {
    EXPECT_EQ(venue.game.Players(own).Rank, 0);
  }
  EXPECT_THAT(venue.Column(BoardColumn::Rank), ElementsAre("1", "2", "3"));
}

TEST(Ranks, AreConsecutiveAlsoForEqualScores) {
  ScoredGame venue;
  for (const int index : {3, 1, 2}) {
    venue.Activate(index);
  }
  venue.CalculateScores();
  EXPECT_THAT(venue.Column(BoardColumn::Player), ElementsAre("Red  0", "Red  1", "Red  2"));
  EXPECT_THAT(venue.Column(BoardColumn::Rank), ElementsAre("1", "2", "3"));
}

TEST(Ranks, RunUpwardAfterAClickOnOneOfTheFirstTwoColumns) {
  for (const int header : {1, 2}) {
    ScoredGame venue;
    venue.Activate(Red0).BonusPoints = 5;
    venue.Activate(Blue0).BonusPoints = 9;
    venue.CalculateScores();
    SortByHeader(venue.Board, header, venue.game);
    venue.CalculateScores();
    EXPECT_EQ(venue.Board.SortOrder, SortOrder::Ascending);
    EXPECT_THAT(venue.Column(BoardColumn::Soldiering), ElementsAre(" 5", " 9"));
    EXPECT_EQ(venue.game.Players(Red0).Rank, 1);
    SortByHeader(venue.Board, 5, venue.game);
    venue.CalculateScores();
    EXPECT_THAT(venue.Column(BoardColumn::Soldiering), ElementsAre(" 9", " 5"));
    EXPECT_EQ(venue.game.Players(Blue0).Rank, 1);
  }
}

}  // namespace
