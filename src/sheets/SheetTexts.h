#pragma once

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "core/game/Game.h"
#include "core/game/MemberLookup.h"
#include "platform/WordProcessor.h"

/// Bookmarks and their texts, in the order in which they are written.
using BookmarkTexts = std::vector<std::pair<const char*, std::string>>;

/// The cells of a table, column by column.
using CellTexts = std::vector<std::string>;

/// The winning team (1 to 3): the one that achieved a primary objective, or the last such set's if there are
/// several; else the one with the highest total above 0, the lower number in a tie; 0 if nobody has won.
int WinningTeam(const Game& game);

/// A long date without the weekday before its first comma.
std::string WithoutWeekday(const std::string& longDate);

/// Whose sheet it is, and the game's result for the player's team.
BookmarkTexts ResultTexts(const Game& game, int index, int winner);

BookmarkTexts MemberTexts(const Member& member, const MemberHistory& history);

BookmarkTexts GuestTexts();

/// The game's figures. `rank` is the text of the rank.
BookmarkTexts GameTexts(const Player& player, const std::string& missionName, const std::string& date,
                        const std::string& rank);

/// How the rows of a table of hits change where its first column holds them all, so that few hits stand in
/// large letters and the table keeps its height. `rows` is the number of rows for hits. None where letters
/// stay as in the template.
std::optional<RowSizes> SizesForHits(int hits, int rows);

/// The hits that player `index` scored, on themselves too.
CellTexts HitsScored(const Game& game, int index, MemberLookup& members);

/// The hits that player `index` took, then the special damage.
CellTexts HitsTaken(const Game& game, int index, MemberLookup& members);
