#include "core/ScoreList.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;

class Sorting : public testing::Test {
 protected:
  /// Rows of rank text, player and one figure.
  void Add(const std::string& rank, const std::string& player, const std::string& figure) {
    list.AddRow({rank, player, figure});
  }

  std::vector<std::string> Column(int column) const {
    std::vector<std::string> cells;
    for (const ScoreList::Row& row : list.Rows()) {
      cells.push_back(row.Cells[static_cast<std::size_t>(column)]);
    }
    return cells;
  }

  StringTable strings{Language::English};
  Game game{strings};
  ScoreList list;
};

TEST_F(Sorting, IsDescendingAtFirst) { EXPECT_EQ(list.SortOrder, SortOrder::Descending); }

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
  EXPECT_TRUE(list.Rows().empty());
}

}  // namespace
