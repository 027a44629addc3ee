#pragma once

#include "archive/PastGame.h"
#include "core/game/Board.h"
#include "core/game/PublicName.h"

/// Lists the players of a past game in `board` as they were on the board after the calculation, the highest
/// score first, with nicknames of today and the guest names of the game: first and last names stand nowhere
/// about past games. The records' `Rank` are those places afterwards. Throws RuntimeError as `nickNames`
/// does.
void ListPastPlayers(PastGame& past, const NickNames& nickNames, Board& board);
