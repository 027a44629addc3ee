#pragma once

#include <functional>
#include <string>
#include <string_view>

#include "core/game/Game.h"

/// Game files: one XML tree without attributes. Writer and reader are not mirror images: the writer emits
/// `TotalDamage` twice and never `AbsoluteDamage`, and leaves out inactive players and hits of 0 or below;
/// the reader looks for all of these and uses the default for anything missing.

/// The bytes of a game file: UTF-8, no XML declaration. `missionName` is the text of the active mission.
std::string WriteGameFile(const Game& game, const std::string& missionName);

/// The same bytes in pieces, header and players one by one, so that a full game is never in memory as a
/// whole.
void WriteGameFile(const Game& game, const std::string& missionName,
                   const std::function<void(std::string_view piece)>& write);

/// Reads `bytes` (used as work space) into `game`, which the caller has cleared. Calls `selectMission` with
/// the mission's name ("None" if the file has none) before anything is read into `game`. Returns false, with
/// nothing read, if the bytes are not XML or have another root element. Throws RuntimeError 13 for a text
/// where a number is expected, 6 for a number out of its field's range, 9 for a fourth team or an index
/// outside the table; what was read before stays in `game`.
bool ReadGameFile(std::string bytes, Game& game,
                  const std::function<void(const std::string&)>& selectMission);
