#pragma once

#include <optional>
#include <string>

#include "archive/PastGame.h"
#include "charts/ChartGame.h"
#include "core/game/HiddenNames.h"
#include "core/game/PublicName.h"
#include "core/text/StringTable.h"
#include "platform/Database.h"

/// The points that the mission of this name gives today; none if there is no such mission.
std::optional<MissionPoints> PointsOfMission(Database& dbScenarios, const std::string& missionName);

/// A past game as charts take it, all of its players by place, without names in `hidden`. Valid while the
/// game is. What its scores do not owe to `points` and to the game's factors, the charts show as a part of
/// its own.
ChartGame ChartOf(const PastGame& past, const NickNames& nickNames, const HiddenNames& hidden,
                  const std::optional<MissionPoints>& points);
