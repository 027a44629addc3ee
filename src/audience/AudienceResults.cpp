#include "audience/AudienceResults.h"

#include <algorithm>
#include <array>
#include <functional>
#include <utility>

#include "platform/RuntimeError.h"
#include "platform/Utf8.h"

namespace {

/// Players by their guns, with what else they may be called.
void PutPlayers(AudienceResults& results, Session& session, const NickNames& nickNames,
                const GuestNames& guests) {
  const Game& game = session.Game();
  results.Players = Standings(game, [](std::int32_t) { return std::string(); });
  results.Names.clear();
  for (const Standing& player : results.Players) {
    results.Names.push_back(
        {.Holder = HolderOf(game, player.Index, nickNames, guests), .Gun = GunName(game, player.Index)});
  }
}

}  // namespace

AudienceResults ResultsOf(Session& session, const GuestNames& guests) {
  const Game& game = session.Game();
  AudienceResults results;
  results.Mission = session.MissionIsActive() ? session.Missions().Text() : std::string();
  results.Time = game.GameDate;
  try {
    const ReadScope scope(session.DbMembers());
    PutPlayers(
        results, session,
        [&session](std::int32_t contactId) { return session.Members().NickNameOf(contactId); }, guests);
  } catch (const RuntimeError&) {
    PutPlayers(
        results, session, [](std::int32_t) { return std::string(); }, guests);
  }
  ShowNames(results, [](const NameHolder& holder) {
    return holder.NickName.empty() ? holder.GuestName : holder.NickName;
  });
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

void LookUpNickNames(AudienceResults& results, Session& session) {
  try {
    const ReadScope scope(session.DbMembers());
    std::vector<std::string> nickNames;
    for (const AudienceName& name : results.Names) {
      const std::int32_t member = name.Holder.Member;
      nickNames.push_back(member == 0 ? std::string() : CleanName(session.Members().NickNameOf(member)));
    }
    for (std::size_t at = 0; at < nickNames.size(); ++at) {
      results.Names[at].Holder.NickName = std::move(nickNames[at]);
    }
  } catch (const RuntimeError&) {
    return;
  }
}

void ShowNames(AudienceResults& results, const std::function<std::string(const NameHolder&)>& nameShown) {
  for (std::size_t at = 0; at < results.Names.size(); ++at) {
    const AudienceName& name = results.Names[at];
    const std::string shown = nameShown(name.Holder);
    results.Players.at(at).PublicName = shown.empty() ? name.Gun : shown;
  }
}

std::string TeamLetter(const StringTable& strings, int team) {
  const std::string name = TeamNameFromNumber(strings, static_cast<std::int16_t>(team));
  return name.substr(0, Utf8::LengthOfCharacter(name));
}

std::string ShortGunName(const StringTable& strings, const Standing& standing) {
  return TeamLetter(strings, standing.Team) + std::to_string(standing.Number);
}
