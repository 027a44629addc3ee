#pragma once

#include <string>
#include <utility>
#include <vector>

#include "core/game/Game.h"
#include "core/game/MemberLookup.h"

/// Bookmarks and their texts, in the order in which they are written.
using BookmarkTexts = std::vector<std::pair<const char*, std::string>>;

/// Cells of a table, down each column.
using CellTexts = std::vector<std::string>;

/// Team (1 to 3) that has won: the one that achieved a primary objective, of several sets the last; else the
/// one with the highest total above 0, of equals the lower number; 0 when nobody has won.
int WinningTeam(const Game& game);

/// A date in long form without the weekday in front of its first comma.
std::string WithoutWeekday(const std::string& longDate);

/// Whose sheet it is and how the game ended for the team.
BookmarkTexts ResultTexts(const Game& game, int index, int winner);

BookmarkTexts MemberTexts(const Member& member, const MemberHistory& history);

BookmarkTexts GuestTexts();

/// The game's figures. `rank` is the text of the rank.
BookmarkTexts GameTexts(const Player& player, const std::string& missionName, const std::string& date,
                        const std::string& rank);

/// The hits that player `index` scored on others, oneself included.
CellTexts HitsScored(const Game& game, int index, MemberLookup& members);

/// The hits that player `index` took, then the special damage.
CellTexts HitsTaken(const Game& game, int index, MemberLookup& members);
