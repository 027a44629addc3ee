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

std::int32_t WithObjectivePoints(std::int32_t score, const MissionPoints& points,
                                 const OneBased<ObjectiveTeam, TeamCount>& objectives,
                                 const std::string& teamName) {
  const auto add = [&score](bool achieved, long double amount) {
    if (achieved) {
      score = RoundToInt32(score + amount);
    }
  };
  for (int set = 0; set < TeamCount; ++set) {
    const ObjectiveTeam& objective = objectives(set + 1);
    if (objective.Name == teamName) {
      add(objective.PrimaryAchieved, points.Primary[set]);
      add(objective.SecondaryAchieved, points.Secondary[set]);
    }
  }
  return score;
}
