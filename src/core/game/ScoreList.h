#pragma once

#include <array>
#include <cstddef>
#include <functional>
#include <string>
#include <vector>

#include "core/game/Game.h"

inline constexpr int BoardColumnCount = 9;

enum class SortOrder { Ascending, Descending };

/// The contents of a score list as the operator sees it: rows of texts, the first being the row text.
class ScoreList {
 public:
  struct Row {
    std::array<std::string, BoardColumnCount>
        Cells;  ///< a list with fewer columns leaves the last ones empty
  };

  ::SortOrder SortOrder = ::SortOrder::Descending;
  std::function<void()> Changed;  ///< called when the rows have new contents or a new order; may be empty

  int RowCount() const { return static_cast<int>(order_.size()); }

  /// The row at a place from the top, counted from 0.
  const Row& RowAt(int place) const { return rows_[order_.at(static_cast<std::size_t>(place))]; }

  void Clear();
  /// Adds a row of empty cells at the end. The reference holds until the next change of the list.
  Row& AddRow();

 private:
  friend void SortListNumeric(ScoreList& list, int column, bool assignRanks, Game& game);

  void Sort(int column);
  void NotifyChanged() const;

  std::vector<Row> rows_;           ///< in the order of adding
  std::vector<std::size_t> order_;  ///< indexes into `rows_` as shown
};

/// Sorts by the numbers in `column` (0 = row text) in the list's present direction. A cell that is a number
/// with one more character behind it (a percentage) sorts by that number; any other text sorts below all
/// numbers, and equal cells keep the order in which their rows were added.
///
/// Column 0 writes each place into the record of the same number, whichever player stands there. For other
/// columns, `assignRanks` numbers the row texts from 1 and stores the places in the players' records. The
/// record is found from the team word and number alone, 32 to a team, so the place of a player numbered 32 or
/// above goes into another record.
void SortListNumeric(ScoreList& list, int column, bool assignRanks, Game& game);

/// The board's answer to a click on column header `header` (counted from 1).
void SortByHeader(ScoreList& scoreDisplay, int header, Game& game);
