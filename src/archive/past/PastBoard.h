#pragma once

#include <cstdint>
#include <functional>
#include <string>

#include "archive/PastGame.h"
#include "core/game/Board.h"

/// What the board calls the member with this number; empty if there is no such member any more.
using MemberNames = std::function<std::string(std::int32_t contactId)>;

/// Lists the players of a past game in `board` as they were on the board after the calculation, the highest
/// score first. The records' `Rank` are those places afterwards. Throws RuntimeError as `nameOf` does.
void ListPastPlayers(Game& game, const MemberNames& nameOf, Board& board);
