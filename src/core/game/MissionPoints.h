#pragma once

#include <array>
#include <cstdint>
#include <string>

#include "core/game/Game.h"
#include "core/game/OneBased.h"
#include "platform/Database.h"

/// Rewards and penalties of a mission.
struct MissionPoints {
  std::array<double, TeamCount> Primary{};    ///< by objective set
  std::array<double, TeamCount> Secondary{};  ///< by objective set
  double RespawnPenalty = 0;
  double HealPenalty = 0;
};

/// Reads them from the mission's row. Throws RuntimeError as Recordset::Fields and NumberOf do.
MissionPoints ReadMissionPoints(Recordset& mission);

/// `score` with the points that a player of team `teamName` gets for the objectives achieved: those of every
/// set that the team plays. It is rounded after each of them; halves go to the even number, so points with a
/// half give an odd score another sum than an even one. Throws RuntimeError 6 for a result beyond 32 bits.
std::int32_t WithObjectivePoints(std::int32_t score, const MissionPoints& points,
                                 const OneBased<ObjectiveTeam, TeamCount>& objectives,
                                 const std::string& teamName);

/// What the player of team `teamName` gets for the objectives achieved, before any rounding.
long double ObjectivePointsOf(const MissionPoints& points,
                              const OneBased<ObjectiveTeam, TeamCount>& objectives,
                              const std::string& teamName);

/// `score` less the mission's penalties for the player's respawns, then for the heals; rounded after each.
/// Throws as WithObjectivePoints does.
std::int32_t WithPenalties(std::int32_t score, const MissionPoints& points, const Player& player);
