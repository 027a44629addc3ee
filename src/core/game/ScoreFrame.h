#pragma once

#include <array>
#include <cstdint>
#include <optional>

#include "core/game/Game.h"
#include "platform/Clock.h"

/// One frame of a gun's scores as received. Offsets are from its start; M counts from offset 4, S from
/// offset 6:
///
///     0        length L without the check byte, little-endian
///     2        length M of the player record, little-endian
///     4        PlayerId
///     5        length S of the statistics block
///     6        nine counters, big-endian words
///     6 + S    iButton id, 8 bytes, family code first
///     14 + S   health, clips, ammunition, secondary and primary damage, run counter: big-endian words
///     26 + S   power cheat flag
///     4 + M    number of hits, then 3 bytes each: PlayerId of the shooter, damage (little-endian)
///
/// All words are signed; one with its high bit set counts as an overflow and leaves its field unchanged.
using ReceiveBuffer = std::array<std::uint8_t, 1001>;

/// high * 256 + low; nullopt if the high byte is 128 or more.
std::optional<std::int16_t> MakeWord(std::uint8_t high, std::uint8_t low);

/// Adds the frame in `buffer` to `game` (counters and hits are added, all else is replaced), dates the game,
/// and clears the buffer. An invalid part (an overflow, an id below 32, an offset past the buffer) is
/// skipped; the rest still counts.
void AnalyseData(ReceiveBuffer& buffer, Game& game, const Clock& clock);
