#pragma once

#include <optional>
#include <string>
#include <vector>

#include "core/game/Game.h"
#include "core/game/MissionPoints.h"
#include "core/game/SoldieringFactors.h"

/// A player as charts name them: "Blue  7 (Mole)".
struct ChartPlayer {
  int Index;  ///< record, 1 to 224
  std::string Name;
};

/// A game with its scores, the one on the board or any other, and what the scores were calculated from.
struct ChartGame {
  const ::Game& Game;
  std::vector<ChartPlayer> Players;  ///< those who are shown, in any order
  SoldieringFactors Factors;
  bool FreeForAll = false;                         ///< hits on one's own team count like any other
  std::optional<MissionPoints> PointsOfMission{};  ///< none in a game without a mission
  std::string Title{};                             ///< heading of the charts: mission and date
  std::string FileName{};                          ///< for pictures, without folder and ending
};
