#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "core/game/Game.h"

/// Columns of the list of players; those after `Player` hold numbers. The list of teams has the first three,
/// with the team in the second.
enum class BoardColumn { Rank, Player, Soldiering, Accuracy, Damage, ShotsFired, Wia, Kia, AmmoAdds };
inline constexpr int BoardColumnCount = 9;
inline constexpr int TeamColumnCount = 3;

/// The two lists of a game.
enum class BoardList { Players, Teams };

enum class SortOrder { Ascending, Descending };

/// Whether a row has an accuracy and, if not, why.
enum class AccuracyKind { Known, NoShots, NoPrimaryDamage };

/// A player or a team, with the figures as they were when the scores were calculated.
struct BoardRow {
  int Index = 0;                ///< record of the player, 1 to 224; 0 for a team
  int Team = 0;                 ///< 1 to 3
  std::int32_t Rank = 0;        ///< place, 1 = first; 0 until a sort assigns it
  std::string MemberName = {};  ///< empty for a player who is no member
  std::int32_t Soldiering = 0;
  AccuracyKind HasAccuracy = AccuracyKind::Known;
  float Accuracy = 0;  ///< fraction, 1.0 = all shots hit
  std::int32_t Damage = 0;
  std::int32_t ShotsFired = 0;
  std::int32_t Wia = 0;
  std::int32_t Kia = 0;
  std::int32_t AmmoAdds = 0;
};

/// The rows of a score list in the order in which the operator sees them.
class Board {
 public:
  /// `changed` is called when the contents or the order of the rows change. Adding a row does not call it;
  /// the next sort does.
  explicit Board(std::function<void()> changed) : changed_(std::move(changed)) {}
  Board(const Board&) = delete;
  Board& operator=(const Board&) = delete;

  ::SortOrder SortOrder = ::SortOrder::Descending;

  int RowCount() const { return static_cast<int>(order_.size()); }

  /// The row at a place from the top, counted from 0.
  const BoardRow& RowAt(int place) const { return rows_[order_.at(static_cast<std::size_t>(place))]; }

  /// Where the row of the player with this record stands; none if there is no such row.
  std::optional<int> PlaceOf(int index) const;

  /// The column whose figures order the rows; none while they stand in the order in which they were added.
  std::optional<BoardColumn> SortedBy() const { return sortedBy_; }

  void Clear();
  /// How many times the list has been cleared.
  int Clears() const { return clears_; }
  void AddRow(BoardRow row);

 private:
  friend void SortListNumeric(Board& list, BoardColumn column, bool assignRanks, Game& game);

  void Sort(BoardColumn column);

  const std::function<void()> changed_;
  std::vector<BoardRow> rows_;      ///< in the order in which they were added
  std::vector<std::size_t> order_;  ///< indexes into `rows_`, from the top of the list
  std::optional<BoardColumn> sortedBy_;
  int clears_ = 0;
};

/// Sorts by the numbers that `column` shows, in the list's current direction; an accuracy counts with its two
/// decimals. A cell that shows no number sorts below all numbers, and equal cells keep the order in which
/// their rows were added.
///
/// Column 0 writes each place into the record of the same number, whichever player that is. For other
/// columns, `assignRanks` numbers the rows from 1 and stores the places in the players' records. The record
/// is computed from team and number alone, 32 to a team, so the place of a player numbered 32 or above goes
/// into another record. Throws RuntimeError 9 for an index outside the table.
void SortListNumeric(Board& list, BoardColumn column, bool assignRanks, Game& game);

/// Sorts the board as a click on column header `header` (counted from 1) does.
void SortByHeader(Board& players, int header, Game& game);
