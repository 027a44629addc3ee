#include "audience/AudienceResults.h"

#include <algorithm>
#include <array>
#include <functional>

#include "platform/RuntimeError.h"
#include "platform/Utf8.h"

namespace {

std::vector<Standing> StandingsOf(Session& session, const GuestNames& guests) {
  const Game& game = session.Game();
  try {
    const ReadScope scope(session.DbMembers());
    return Standings(
        game, [&session](std::int32_t contactId) { return session.Members().NickNameOf(contactId); }, guests);
  } catch (const RuntimeError&) {
    return Standings(
        game, [](std::int32_t) { return std::string(); }, guests);
  }
}

}  // namespace

AudienceResults ResultsOf(Session& session, const GuestNames& guests) {
  const Game& game = session.Game();
  AudienceResults results;
  results.Mission = session.MissionIsActive() ? session.Missions().Text() : std::string();
  results.Time = game.GameDate;
  results.Players = StandingsOf(session, guests);
  std::array<bool, TeamCount> present{};
  for (const Standing& player : results.Players) {
    present.at(static_cast<std::size_t>(player.Team - 1)) = true;
  }
  for (int team = 1; team <= TeamCount; ++team) {
    if (present.at(static_cast<std::size_t>(team - 1))) {
      results.Totals.push_back({team, game.TeamTotals(team)});
    }
  }
  std::ranges::stable_sort(results.Totals, std::greater(), &AudienceTotal::Points);
  return results;
}

std::string TeamLetter(const StringTable& strings, int team) {
  const std::string name = TeamNameFromNumber(strings, static_cast<std::int16_t>(team));
  return name.substr(0, Utf8::LengthOfCharacter(name));
}

std::string ShortGunName(const StringTable& strings, const Standing& standing) {
  return TeamLetter(strings, standing.Team) + std::to_string(standing.Number);
}
