#include "core/game/Board.h"

#include <gmock/gmock.h>

#include <random>

#include "tests/support/ScoredGame.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;

/// Record indexes by team and number.
constexpr int Red(int number) {
  return number + 1 + (number < 32 ? 0 : 64);
}
constexpr int Blue(int number) {
  return number + 33 + (number < 32 ? 0 : 96);
}
constexpr int Yellow(int number) {
  return number + 65;
}

class Sorting : public testing::Test {
 protected:
  static BoardRow RowOf(int index) { return {.Index = index, .Team = TeamFromId(IdFromIndex(index))}; }

  /// Adds a player's row with a place and one figure.
  void Add(std::int32_t rank, int index, std::int32_t soldiering) {
    BoardRow row = RowOf(index);
    row.Rank = rank;
    row.Soldiering = soldiering;
    list.AddRow(std::move(row));
  }

  /// The texts of a column, from the top.
  std::vector<std::string> Column(BoardColumn column) const {
    std::vector<std::string> cells;
    for (int place = 0; place < list.RowCount(); ++place) {
      cells.push_back(texts.Cell(list.RowAt(place), column));
    }
    return cells;
  }

  StringTable strings{Language::English};
  Game game{strings};
  BoardTexts texts{game, strings};
  int changes = 0;
  Board list{[this] { ++changes; }};
};

TEST_F(Sorting, IsDescendingAtFirst) {
  EXPECT_EQ(list.SortOrder, SortOrder::Descending);
}

TEST_F(Sorting, GoesByNumberAndNotByText) {
  for (const int figure : {9, 10, -1, -20, 0}) {
    Add(0, Red(1), figure);
  }
  SortListNumeric(list, BoardColumn::Soldiering, false, game);
  EXPECT_THAT(Column(BoardColumn::Soldiering), ElementsAre(" 10", " 9", " 0", "-1", "-20"));
  list.SortOrder = SortOrder::Ascending;
  SortListNumeric(list, BoardColumn::Soldiering, false, game);
  EXPECT_THAT(Column(BoardColumn::Soldiering), ElementsAre("-20", "-1", " 0", " 9", " 10"));
}

class SortingByAccuracy : public Sorting {
 protected:
  void AddAccuracy(AccuracyKind kind, float accuracy) {
    BoardRow row = RowOf(Red(list.RowCount()));
    row.HasAccuracy = kind;
    row.Accuracy = accuracy;
    list.AddRow(std::move(row));
  }

  std::vector<std::string> SortedDown() {
    SortListNumeric(list, BoardColumn::Accuracy, false, game);
    return Column(BoardColumn::Accuracy);
  }
};

TEST_F(SortingByAccuracy, PutsCellsWithoutANumberBelowAllNumbers) {
  AddAccuracy(AccuracyKind::NoShots, 3);
  AddAccuracy(AccuracyKind::Known, 0.52F);
  AddAccuracy(AccuracyKind::Known, -0.05F);
  AddAccuracy(AccuracyKind::NoPrimaryDamage, 9);
  AddAccuracy(AccuracyKind::Known, 1);
  EXPECT_THAT(SortedDown(), ElementsAre("100.00%", "52.00%", "-5.00%", "N/A", "Error"));
  list.SortOrder = SortOrder::Ascending;
  SortListNumeric(list, BoardColumn::Accuracy, false, game);
  EXPECT_THAT(Column(BoardColumn::Accuracy), ElementsAre("N/A", "Error", "-5.00%", "52.00%", "100.00%"));
}

TEST_F(SortingByAccuracy, TellsNearOnesApart) {
  for (const float accuracy : {0.0999F, 0.1F, 0.0998F, 0.005F}) {
    AddAccuracy(AccuracyKind::Known, accuracy);
  }
  EXPECT_THAT(SortedDown(), ElementsAre("10.00%", "9.99%", "9.98%", "0.50%"));
}

TEST_F(SortingByAccuracy, TakesThoseForEqualThatLookEqual) {
  for (const float accuracy : {0.50001F, 0.5F, 0.50004F, -0.00001F, 0.00004F}) {
    AddAccuracy(AccuracyKind::Known, accuracy);
  }
  EXPECT_THAT(SortedDown(), ElementsAre("50.00%", "50.00%", "50.00%", "0.00%", "0.00%"));
  EXPECT_THAT(Column(BoardColumn::Player), ElementsAre("Red  0", "Red  1", "Red  2", "Red  3", "Red  4"));
}

TEST_F(SortingByAccuracy, GoesByTheNumbersOfTheShownTexts) {
  std::mt19937 random(5);
  for (int row = 0; row < 32; ++row) {
    const auto thousandths = static_cast<float>(random() % 2000);
    AddAccuracy(AccuracyKind::Known, row % 3 == 0 ? thousandths * 1.1e6F : thousandths / 160'000);
  }
  const std::vector<std::string> shown = SortedDown();
  for (std::size_t row = 1; row < shown.size(); ++row) {
    EXPECT_GE(std::stod(shown[row - 1]), std::stod(shown[row]));
    if (shown[row - 1] == shown[row]) {
      EXPECT_LT(list.RowAt(static_cast<int>(row) - 1).Index, list.RowAt(static_cast<int>(row)).Index);
    }
  }
}

TEST_F(Sorting, KeepsTheOrderOfAddingForEqualCellsInBothDirections) {
  Add(1, Red(1), 5);
  Add(2, Red(2), 7);
  Add(3, Red(3), 5);
  SortListNumeric(list, BoardColumn::Soldiering, false, game);
  EXPECT_THAT(Column(BoardColumn::Player), ElementsAre("Red  2", "Red  1", "Red  3"));
  list.SortOrder = SortOrder::Ascending;
  SortListNumeric(list, BoardColumn::Soldiering, false, game);
  EXPECT_THAT(Column(BoardColumn::Player), ElementsAre("Red  1", "Red  3", "Red  2"));
}

TEST_F(Sorting, ByPlayerRestoresTheOrderOfAdding) {
  BoardRow member = RowOf(Red(1));
  member.MemberName = "12";
  member.Soldiering = 5;
  list.AddRow(std::move(member));
  Add(2, Blue(2), 7);
  SortListNumeric(list, BoardColumn::Soldiering, false, game);
  SortByHeader(list, 2, game);
  EXPECT_THAT(Column(BoardColumn::Player), ElementsAre("Red  1: 12", "Blue  2"));
}

TEST_F(Sorting, OfAColumnLeavesThePlaces) {
  Add(2, Red(1), 5);
  Add(1, Red(2), 7);
  SortByHeader(list, 3, game);
  EXPECT_THAT(Column(BoardColumn::Rank), ElementsAre("1", "2"));
  EXPECT_EQ(game.Players(Red(1)).Rank, 0);
}

TEST_F(Sorting, ByRankWritesEachPlaceIntoTheRecordOfThatNumber) {
  Add(2, Blue(4), 5);
  Add(1, Yellow(9), 7);
  SortByHeader(list, 1, game);
  EXPECT_THAT(Column(BoardColumn::Rank), ElementsAre("1", "2"));
  EXPECT_EQ(game.Players(1).Rank, 1);
  EXPECT_EQ(game.Players(2).Rank, 2);
  EXPECT_EQ(game.Players(Blue(4)).Rank, 0);
}

TEST_F(Sorting, ByRankFailsWhereThereIsNoRecordOfThatNumber) {
  for (int row = 0; row <= PlayerCount; ++row) {
    Add(0, Red(1), 0);
  }
  EXPECT_EQ(NumberThrownBy([this] { SortByHeader(list, 1, game); }), 9);
}

TEST_F(Sorting, WithRanksNumbersTheRowsAndFindsTheRecordsByTeamAndNumber) {
  Add(0, Red(31), 1);
  Add(0, Blue(0), 2);
  Add(0, Yellow(5), 3);
  Add(0, Blue(95), 4);
  Add(0, Red(40), 5);
  list.AddRow({.Team = 2, .Soldiering = 6});
  SortListNumeric(list, BoardColumn::Soldiering, true, game);
  EXPECT_THAT(Column(BoardColumn::Rank), ElementsAre("1", "2", "3", "4", "5", "6"));
  const std::pair<int, int> ranks[] = {{41, 2}, {128, 3}, {70, 4}, {33, 5}, {32, 6}};
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
  for (const int rank : {10, 9, 1}) {
    Add(rank, Red(rank), 5);
  }
  SortByHeader(list, 1, game);
  EXPECT_THAT(Column(BoardColumn::Player), ElementsAre("Red  1", "Red  9", "Red  10"));
}

TEST_F(Sorting, OfEachColumnGoesByItsOwnFigure) {
  std::vector<BoardRow> rows;
  for (int header = 3; header <= BoardColumnCount; ++header) {
    rows.push_back(RowOf(Red(header)));
  }
  rows[0].Soldiering = rows[2].Damage = rows[3].ShotsFired = rows[4].Wia = rows[5].Kia = rows[6].AmmoAdds = 1;
  rows[1].Accuracy = 0.5F;
  for (BoardRow& row : rows) {
    list.AddRow(std::move(row));
  }
  for (int header = 3; header <= BoardColumnCount; ++header) {
    SortByHeader(list, header, game);
    EXPECT_EQ(list.RowAt(0).Index, Red(header));
  }
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
  Add(1, Red(1), 5);
  SortListNumeric(list, BoardColumn::Soldiering, true, game);
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

TEST_F(Sorting, TellsWhichColumnOrdersTheRows) {
  EXPECT_EQ(list.SortedBy(), std::nullopt);
  Add(0, Red(1), 5);
  SortListNumeric(list, BoardColumn::Soldiering, true, game);
  EXPECT_EQ(list.SortedBy(), BoardColumn::Soldiering);
  SortByHeader(list, 9, game);
  EXPECT_EQ(list.SortedBy(), BoardColumn::AmmoAdds);
  SortByHeader(list, 2, game);  // for which all players are equal
  EXPECT_EQ(list.SortedBy(), std::nullopt);
  SortByHeader(list, 1, game);
  EXPECT_EQ(list.SortedBy(), BoardColumn::Rank);
  list.Clear();
  EXPECT_EQ(list.SortedBy(), std::nullopt);
}

TEST_F(Sorting, LetsAPlayerBeFoundInTheNewOrder) {
  Add(0, Red(1), 5);
  Add(0, Blue(2), 9);
  SortListNumeric(list, BoardColumn::Soldiering, true, game);
  EXPECT_EQ(list.PlaceOf(Blue(2)), 0);
  EXPECT_EQ(list.PlaceOf(Red(1)), 1);
  EXPECT_EQ(list.PlaceOf(Red(2)), std::nullopt);
}

}  // namespace
