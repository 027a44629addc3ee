#pragma once

#include <cstdint>
#include <optional>
#include <vector>

enum class RankedBy { Sum, Mean, Best, Accuracy, Games };

/// What a member did in the period of a ranking.
struct RankedFigures {
  std::int32_t Member = 0;
  std::int64_t Games = 0;  ///< at least 1
  double Sum = 0;          ///< soldiering
  std::optional<double> Best = {};
  std::optional<double> Accuracy = {};  ///< fraction, the mean of the games with an accuracy above 0

  double Mean() const { return Sum / static_cast<double>(Games); }
};

struct RankedPlace {
  int Place = 0;  ///< equal ones share theirs, and the next one's counts them all: 1, 2, 2, 4
  RankedFigures Figures;
};

/// Those with at least `leastGames` games and with a figure to rank by, the highest first; equal ones in the
/// order of games, sum (most first) and number (lowest first).
std::vector<RankedPlace> PlacedBy(RankedBy by, const std::vector<RankedFigures>& figures,
                                  std::int64_t leastGames);
