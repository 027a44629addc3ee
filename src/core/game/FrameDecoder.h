#pragma once

#include <array>
#include <cstdint>
#include <optional>

#include "core/game/Game.h"
#include "platform/Clock.h"

/// One frame of a gun's scores as it came in. Offsets from its start; M counts from offset 4,
/// S from offset 6:
///
///     0        length L without the check byte, low byte first
///     2        length M of the player record, low byte first
///     4        PlayerId
///     5        length S of the statistics block
///     6        nine counters, words, high byte first
///     6 + S    iButton id, 8 bytes, family code first
///     14 + S   health, clips, ammunition, secondary and primary damage, run counter: words, high byte first
///     26 + S   power cheat flag
///     4 + M    number of hits, then 3 bytes each: PlayerId of the shooter, amount with its low byte first
///
/// All words are signed; one with its high bit set overflows and leaves its field as it was.
using ReceiveBuffer = std::array<std::uint8_t, 1001>;

/// high * 256 + low; nothing when the high byte is 128 or more.
std::optional<std::int16_t> MakeWord(std::uint8_t high, std::uint8_t low);

/// Adds the frame in `buffer` to `game` (counters and hits add up, the rest replaces), dates the game, and
/// empties the buffer. Whatever cannot be taken (an overflow, an id below 32, an offset past the buffer) is
/// left out by itself.
void AnalyseData(ReceiveBuffer& buffer, Game& game, const Clock& clock);
