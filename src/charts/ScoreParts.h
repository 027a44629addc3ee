#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "charts/ChartGame.h"

/// What points come from.
enum class ScorePart {
  Damage,
  OwnTeam,  ///< hits on one's own team, with their factor
  Accuracy,
  Deaths,
  Heals,
  AmmoAdds,
  Bonus,
  Objectives,
  RespawnPenalty,
  HealPenalty,
  Rounding,  ///< what the score gained or lost by being rounded, in whatever step
  Other,  ///< what the factors and the mission at hand do not explain, as when they were others at the time
};
inline constexpr int ScorePartCount = 12;

/// A player's score and its parts, which always add up to it.
struct PlayerParts {
  ChartPlayer Player;
  int Team = 0;
  std::int32_t Soldiering = 0;
  std::array<std::int64_t, ScorePartCount> Hundredths{};  ///< of points, by ScorePart

  std::int64_t Of(ScorePart part) const { return Hundredths[static_cast<std::size_t>(part)]; }
};

/// The parts of all players of the chart, the highest score first; equal ones in the order of their records.
std::vector<PlayerParts> ScorePartsOf(const ChartGame& game);

/// The parts that at least one of the players has, in their order.
std::vector<ScorePart> PartsInUse(const std::vector<PlayerParts>& players);

/// Points in plain digits with no more decimals than they need: "12", "-0.5".
std::string PointsText(std::int64_t hundredths);
