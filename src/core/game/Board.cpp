#include "core/game/Board.h"

#include <algorithm>
#include <limits>

#include "core/text/NumberForms.h"

namespace {

constexpr double BelowAllNumbers = -std::numeric_limits<double>::infinity();

/// What a cell sorts by: the number that it shows, or less than any number.
double SortKey(const BoardRow& row, BoardColumn column) {
  switch (column) {
    case BoardColumn::Rank:
      return row.Rank;
    case BoardColumn::Player:
      return BelowAllNumbers;
    case BoardColumn::Soldiering:
      return row.Soldiering;
    case BoardColumn::Accuracy:
      return row.HasAccuracy == AccuracyKind::Known ? PercentHundredths(row.Accuracy) : BelowAllNumbers;
    case BoardColumn::Damage:
      return row.Damage;
    case BoardColumn::ShotsFired:
      return row.ShotsFired;
    case BoardColumn::Wia:
      return row.Wia;
    case BoardColumn::Kia:
      return row.Kia;
    case BoardColumn::AmmoAdds:
      return row.AmmoAdds;
  }
  return BelowAllNumbers;
}

void StoreRank(const BoardRow& row, std::int16_t rank, Game& game) {
  if (row.Index == 0) {
    return;
  }
  constexpr int recordsOfTeam = 32;
  const int base = (row.Team - 1) * recordsOfTeam + 1;
  game.Players(base + PlayerNumberFromId(IdFromIndex(row.Index))).Rank = rank;
}

}  // namespace

std::optional<int> Board::PlaceOf(int index) const {
  for (int place = 0; place < RowCount(); ++place) {
    if (RowAt(place).Index == index) {
      return place;
    }
  }
  return std::nullopt;
}

void Board::Clear() {
  rows_.clear();
  rows_.reserve(PlayerCount);
  order_.clear();
  sortedBy_.reset();
  ++clears_;
  changed_();
}

void Board::AddRow(BoardRow row) {
  order_.push_back(rows_.size());
  rows_.push_back(std::move(row));
}

void Board::Sort(BoardColumn column) {
  struct Entry {
    double Key;
    std::size_t Index;
  };
  std::vector<Entry> entries(rows_.size());
  for (std::size_t index = 0; index < rows_.size(); ++index) {
    entries[index] = {SortKey(rows_[index], column), index};
  }
  const bool ascending = SortOrder == ::SortOrder::Ascending;
  std::sort(entries.begin(), entries.end(), [ascending](const Entry& left, const Entry& right) {
    return left.Key == right.Key ? left.Index < right.Index : (left.Key < right.Key) == ascending;
  });
  std::transform(entries.begin(), entries.end(), order_.begin(),
                 [](const Entry& entry) { return entry.Index; });
  // All cells of the players sort as equal.
  sortedBy_ = column == BoardColumn::Player ? std::nullopt : std::optional(column);
}

void SortListNumeric(Board& list, BoardColumn column, bool assignRanks, Game& game) {
  list.Sort(column);
  std::int16_t place = 0;
  for (const std::size_t index : list.order_) {
    BoardRow& row = list.rows_[index];
    ++place;
    if (column == BoardColumn::Rank) {
      game.Players(place).Rank = place;
    } else if (assignRanks) {
      row.Rank = place;
      StoreRank(row, place, game);
    }
  }
  list.changed_();
}

void SortByHeader(Board& players, int header, Game& game) {
  players.SortOrder = header <= 2 ? SortOrder::Ascending : SortOrder::Descending;
  SortListNumeric(players, static_cast<BoardColumn>(header - 1), false, game);
}
