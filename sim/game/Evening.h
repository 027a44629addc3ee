#pragma once

#include <chrono>
#include <cstdint>
#include <vector>

#include "sim/game/GunScores.h"

namespace sim {

/// The games of an evening, which follow each other at equal distances. Before each of them the guns are
/// cleared, so they always have the scores of one game. The same people play: those who brought their buttons
/// have them in every game, in other guns.
class Evening {
 public:
  /// `players` and `seed` as for MakeGame. A game ends every `every`; 0: there is one game only.
  Evening(int players, std::uint32_t seed, std::chrono::seconds every)
      : players_(players), seed_(seed), every_(every) {}

  /// Number of the game whose scores the guns have so long after the first one has ended, counted from 1.
  int NumberAt(std::chrono::microseconds elapsed) const;

  /// The game of that number; the first is MakeGame's. Throws as MakeGame does.
  std::vector<GunScores> Game(int number) const;

  std::chrono::seconds Every() const { return every_; }

 private:
  int players_;
  std::uint32_t seed_;
  std::chrono::seconds every_;
};

}  // namespace sim
