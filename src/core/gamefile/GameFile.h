#pragma once

#include <functional>
#include <string>

#include "core/game/Game.h"

/// Game files: one XML tree without attributes. Writer and reader are not mirror images: the writer emits
/// `TotalDamage` twice and never `AbsoluteDamage`, leaves out inactive players and hits of 0 or below; the
/// reader looks for all of them and gives what is missing its default.

/// The bytes of a game file: UTF-8, no XML declaration. `missionName` is the text of the active mission.
std::string WriteGameFile(const Game& game, const std::string& missionName);

/// Reads `bytes` (taken over as work space) into `game`, which the caller has cleared. Once the mission's
/// name is known `selectMission` is called with it ("None" when the file names none). Returns false, with
/// nothing read, when the bytes are no XML or have another root element. Throws RuntimeError 13 for a text
/// where a number is due, 6 for a number out of its field's range, 9 for a fourth team or an index outside
/// the table; what was read so far stays in `game`.
bool ReadGameFile(std::string bytes, Game& game,
                  const std::function<void(const std::string&)>& selectMission);
