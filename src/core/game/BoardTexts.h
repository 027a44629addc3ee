#pragma once

#include <string>

#include "core/game/Board.h"
#include "core/text/StringTable.h"

/// The texts of the board's lists as the operator reads them. All of them are made here, and none is ever
/// parsed: code that needs a player or a number takes it from the row.
class BoardTexts {
 public:
  BoardTexts(const Game& game, const StringTable& strings) : game_(game), strings_(strings) {}

  std::string Header(BoardList list, BoardColumn column) const;

  /// What the column shows: "W.I.A.: times healed".
  std::string HeaderTip(BoardList list, BoardColumn column) const;

  std::string Cell(const BoardRow& row, BoardColumn column) const;

  /// The second column's cell without the member's name: "Blue  7", or the team "Blue".
  std::string Name(const BoardRow& row) const;

 private:
  std::string AccuracyText(const BoardRow& row) const;

  const Game& game_;
  const StringTable& strings_;
};

/// The gun with this record as the board names it, with its member: "Blue  7: Mole". The gun alone if it has
/// no row there.
std::string PlayerText(int index, const Board& players, const Game& game, const BoardTexts& texts);
