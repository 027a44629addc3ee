#include "core/game/MissionPoints.h"

#include "core/data/FieldValue.h"
#include "core/text/NumberForms.h"

MissionPoints ReadMissionPoints(Recordset& mission) {
  const auto number = [&mission](const std::string& column) { return NumberOf(mission.Fields(column)); };
  MissionPoints points;
  for (int set = 0; set < TeamCount; ++set) {
    const char letter = static_cast<char>('A' + set);
    points.Primary[set] = number(std::string("PrimaryObjectivePoints") + letter);
    points.Secondary[set] = number(std::string("SecondaryObjectivePoints") + letter);
  }
  points.RespawnPenalty = number("RespawnPenalty");
  points.HealPenalty = number("HealPenalty");
  return points;
}

namespace {

/// Calls `add` with the points of each objective that the team has achieved, in their order.
template <typename Add>
void ForEachAchieved(const MissionPoints& points, const OneBased<ObjectiveTeam, TeamCount>& objectives,
                     const std::string& teamName, Add add) {
  for (int set = 0; set < TeamCount; ++set) {
    const ObjectiveTeam& objective = objectives(set + 1);
    if (objective.Name == teamName && objective.PrimaryAchieved) {
      add(points.Primary[set]);
    }
    if (objective.Name == teamName && objective.SecondaryAchieved) {
      add(points.Secondary[set]);
    }
  }
}

}  // namespace

std::int32_t WithObjectivePoints(std::int32_t score, const MissionPoints& points,
                                 const OneBased<ObjectiveTeam, TeamCount>& objectives,
                                 const std::string& teamName) {
  ForEachAchieved(points, objectives, teamName,
                  [&score](long double amount) { score = RoundToInt32(score + amount); });
  return score;
}

long double ObjectivePointsOf(const MissionPoints& points,
                              const OneBased<ObjectiveTeam, TeamCount>& objectives,
                              const std::string& teamName) {
  long double sum = 0;
  ForEachAchieved(points, objectives, teamName, [&sum](long double amount) { sum += amount; });
  return sum;
}

std::int32_t WithPenalties(std::int32_t score, const MissionPoints& points, const Player& player) {
  const auto subtract = [&score](long double penalty, std::int32_t count) {
    score = RoundToInt32(score - penalty * count);
  };
  subtract(points.RespawnPenalty, player.RespawnCount);
  subtract(points.HealPenalty, player.HealCount);
  return score;
}
