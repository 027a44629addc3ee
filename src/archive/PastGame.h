#pragma once

#include <cstdint>
#include <string>

#include "core/game/Game.h"
#include "core/game/GuestList.h"
#include "core/game/PublicName.h"
#include "core/game/SoldieringFactors.h"

/// A game of the archive, its scores as they were when it was kept: calculating them anew would give those of
/// today's factors and of what has become of its mission.
struct PastGame {
  explicit PastGame(const StringTable& strings) : Game(strings) {}

  std::int64_t GameId = 0;
  std::int64_t State = 0;  ///< 0 for the last one; earlier ones count from 1, the first
  std::string Played;      ///< local time, "YYYY-MM-DD HH:MM:SS"
  std::string Mission;     ///< its name at the time
  ::Game Game;
  /// Of which the figures of the last state were made. Those of earlier states may have been made of others.
  SoldieringFactors Factors;
  GuestList::Names Guests;  ///< of the last state

  /// Valid as long as the game.
  GuestNames NamesOfGuests() const {
    return [this](int index) {
      const auto found = Guests.find(index);
      return found == Guests.end() ? std::string() : found->second;
    };
  }
};

/// Completes what game files do not tell of a game, its figures as the file has them: all damage that each
/// player did, and the sums of the teams. Throws RuntimeError 6 if one of them does not fit into 32 bits.
void CompleteScores(Game& game);
