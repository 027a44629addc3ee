#include "app/PastChart.h"

#include <algorithm>
#include <string_view>

#include "app/ChartPlayers.h"
#include "core/game/Standings.h"
#include "core/gamefile/SuggestedName.h"

namespace {

/// In whichever language the game was kept.
bool IsFreeForAll(const std::string& mission) {
  constexpr int freeForAll = 120;
  return std::ranges::any_of(
      std::initializer_list<Language>{Language::English, Language::SimplifiedChinese},
      [&mission](Language language) { return StringTable(language).Text(freeForAll) == mission; });
}

}  // namespace

std::optional<MissionPoints> PointsOfMission(Database& dbScenarios, const std::string& missionName) {
  const ReadScope scope(dbScenarios);
  const auto missions = dbScenarios.OpenRecordset("Table1");
  if (!missions->WalkTo("MissionName", missionName)) {
    return std::nullopt;
  }
  return ReadMissionPoints(*missions);
}

ChartGame ChartOf(const PastGame& past, const NickNames& nickNames, const HiddenNames& hidden,
                  const std::optional<MissionPoints>& points) {
  ChartGame chart{
      .Game = past.Game,
      .Players = {},
      .Factors = past.Factors,
      .FreeForAll = IsFreeForAll(past.Mission),
      .PointsOfMission = points,
      .Title = past.Game.GameDate.empty() ? past.Mission : past.Mission + ", " + past.Game.GameDate};
  for (const Standing& standing : Standings(past.Game, [](std::int32_t) { return std::string(); })) {
    chart.Players.push_back(
        PlayerOfChart(past.Game, standing.Index, nickNames, past.NamesOfGuests(), hidden));
  }
  if (!chart.Players.empty()) {
    chart.FileName = SuggestedFileName(past.Played, past.Mission, {});
  }
  return chart;
}
