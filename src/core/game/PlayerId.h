#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "core/text/StringTable.h"

/// The equipment identifies a gun by one byte, 32 to 255: the top three bits give the team and the block
/// within the team, the low five bits the number within the block. Teams 1 and 2 have player numbers 0 to 95,
/// team 3 has 0 to 31.

inline constexpr std::int16_t TeamCount = 3;

/// Number of guns, and of records in the table of players.
inline constexpr int PlayerCount = 224;

/// Number of the gun within its team; ids below 32 count as number 0.
std::int16_t PlayerNumberFromId(std::uint8_t id);

/// Team (1 to 3) of the gun `id`; ids below 32 count as team 1.
std::int16_t TeamFromId(std::uint8_t id);

/// Highest player number of `team`: 31 for team 3, 95 for any other value.
std::int16_t MaxPlayerNumber(std::int16_t team);

/// Inverse of TeamFromId and PlayerNumberFromId; 0 for a team other than 1 to 3 and for team 3 from number 32
/// up. Throws RuntimeError 6 if a number above 95 would give an id above 255.
std::uint8_t IdFromTeamAndNumber(std::uint8_t team, std::uint8_t number);

/// Display name of team 1 to 3, empty for any other.
std::string TeamNameFromNumber(const StringTable& texts, std::int16_t team);

/// How the gun `id` of a team is named: team, one blank, number form of the number ("Blue  7").
std::string PlayerName(std::string_view teamName, std::uint8_t id);

/// Team (1 to 3) whose display name is exactly `name`, 0 if there is none.
std::int16_t TeamNumberFromName(const StringTable& texts, std::string_view name);

/// Index (1 to 224) of the record of the gun `id`; 0 or below for ids below 32.
constexpr int IndexFromId(std::uint8_t id) {
  return id - 31;
}

/// Id of the gun whose record has `index`, 1 to 224.
constexpr std::uint8_t IdFromIndex(int index) {
  return static_cast<std::uint8_t>(index + 31);
}
