#include "core/game/ScoreList.h"

#include <algorithm>
#include <limits>
#include <optional>
#include <string_view>
#include <utility>

#include "core/text/NumberForms.h"

namespace {

/// What a cell sorts by: its number, or less than any number.
double SortKey(std::string_view text, bool isRowText) {
  std::optional<double> number = NumberIn(text);
  if (!number && !isRowText && !text.empty()) {
    text.remove_suffix(1);
    number = NumberIn(text);
  }
  return number.value_or(-std::numeric_limits<double>::infinity());
}

std::string_view Trimmed(std::string_view text) {
  const auto first = text.find_first_not_of(' ');
  if (first == std::string_view::npos) {
    return {};
  }
  return text.substr(first, text.find_last_not_of(' ') - first + 1);
}

void StoreRank(std::string_view playerText, std::int16_t rank, Game& game) {
  playerText = Trimmed(playerText);
  const auto blank = playerText.find(' ');
  if (blank == std::string_view::npos) {
    return;
  }
  const std::string_view team = playerText.substr(0, blank);
  const int number = RoundToInt32(Val(playerText.substr(blank)));
  const int base = team == game.TeamNames(1) ? 1 : team == game.TeamNames(2) ? 33 : 65;
  game.Players(base + number).Rank = rank;
}

}  // namespace

void ScoreList::Clear() {
  rows_.clear();
  rows_.reserve(PlayerCount);
  order_.clear();
  NotifyChanged();
}

ScoreList::Row& ScoreList::AddRow() {
  order_.push_back(rows_.size());
  return rows_.emplace_back();
}

void ScoreList::Sort(int column) {
  struct Entry {
    double Key;
    std::size_t Index;
  };
  std::vector<Entry> entries(rows_.size());
  for (std::size_t index = 0; index < rows_.size(); ++index) {
    entries[index] = {SortKey(rows_[index].Cells[static_cast<std::size_t>(column)], column == 0), index};
  }
  const bool ascending = SortOrder == ::SortOrder::Ascending;
  std::sort(entries.begin(), entries.end(), [ascending](const Entry& left, const Entry& right) {
    return left.Key == right.Key ? left.Index < right.Index : (left.Key < right.Key) == ascending;
  });
  std::transform(entries.begin(), entries.end(), order_.begin(),
                 [](const Entry& entry) { return entry.Index; });
}

void ScoreList::NotifyChanged() const {
  if (Changed) {
    Changed();
  }
}

void SortListNumeric(ScoreList& list, int column, bool assignRanks, Game& game) {
  list.Sort(std::max(column, 0));
  std::int16_t place = 0;
  for (const std::size_t index : list.order_) {
    ScoreList::Row& row = list.rows_[index];
    ++place;
    if (column < 1) {
      game.Players(place).Rank = place;
    } else if (assignRanks) {
      row.Cells[0] = std::to_string(place);
      StoreRank(row.Cells[1], place, game);
    }
  }
  list.NotifyChanged();
}

void SortByHeader(ScoreList& scoreDisplay, int header, Game& game) {
  scoreDisplay.SortOrder = header <= 2 ? SortOrder::Ascending : SortOrder::Descending;
  SortListNumeric(scoreDisplay, header - 1, false, game);
}
