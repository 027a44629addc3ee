#include "sheets/SheetTexts.h"

#include <optional>

#include "core/text/NumberForms.h"

namespace {

std::string Trimmed(const std::string& text) {
  const auto first = text.find_first_not_of(' ');
  return first == std::string::npos ? std::string()
                                    : text.substr(first, text.find_last_not_of(' ') - first + 1);
}

std::string NumberText(int index) {
  return Str(std::int32_t{PlayerNumberFromId(IdFromIndex(index))});
}

const std::string& TeamName(const Game& game, int index) {
  return game.TeamNames(TeamFromId(IdFromIndex(index)));
}

/// What was hit, or who hit: team, number, damage, and the name of a member.
std::string HitText(const Game& game, int index, std::int32_t damage, MemberLookup& members) {
  std::string text = Trimmed(TeamName(game, index)) + " " + Trimmed(NumberText(index)) + ": " + Str(damage);
  if (const std::int32_t contactId = game.Players(index).MemberIndex; contactId != 0) {
    if (const std::optional<Member> member = members.LoadMember(contactId)) {
      text += "  (" + member->GetPlayerName(true) + ")";
    }
  }
  return text;
}

}  // namespace

int WinningTeam(const Game& game) {
  int winner = 0;
  for (const ObjectiveTeam& objective : game.ObjectiveTeams) {
    for (int team = 1; objective.PrimaryAchieved && team <= TeamCount; ++team) {
      if (game.TeamNames(team) == objective.Name) {
        winner = team;
      }
    }
  }
  if (winner != 0) {
    return winner;
  }
  std::int32_t best = 0;
  for (int team = 1; team <= TeamCount; ++team) {
    if (game.TeamTotals(team) > best) {
      best = game.TeamTotals(team);
      winner = team;
    }
  }
  return winner;
}

std::string WithoutWeekday(const std::string& longDate) {
  const auto comma = longDate.find(',');
  if (comma == std::string::npos) {
    return longDate;
  }
  // The character behind the comma goes too, all of its bytes.
  const auto isContinuation = [&longDate](std::size_t at) {
    return at < longDate.size() && (static_cast<unsigned char>(longDate[at]) & 0xC0) == 0x80;
  };
  std::size_t rest = comma + 2;
  while (isContinuation(rest)) {
    ++rest;
  }
  return rest < longDate.size() ? longDate.substr(rest) : std::string();
}

BookmarkTexts ResultTexts(const Game& game, int index, int winner) {
  const bool won = TeamFromId(IdFromIndex(index)) == winner;
  return {{"Victory", won ? "Team Won!" : "Team Lost!"},
          {"PlayerTeam", TeamName(game, index)},
          {"PlayerID", NumberText(index) + " "}};
}

BookmarkTexts MemberTexts(const Member& member, const MemberHistory& history) {
  const auto orNone = [](const std::string& text) { return text.empty() ? "None" : text; };
  return {{"PlayerName", member.GetPlayerName(false)},
          {"NickName", orNone(member.NickName)},
          {"AvgGames", PlainDecimal(history.TotalGamesPlayed)},
          {"AvgAccuracy", FormatPercent(history.AveragePrimAccuracy)},
          {"AvgDamage", PlainDecimal(Round2(history.AverageDamage))},
          {"AvgSoldiering", PlainDecimal(Round2(history.AverageSoldiering))},
          {"ClanName", orNone(history.Clan)}};
}

BookmarkTexts GuestTexts() {
  return {{"PlayerName", "Guest"}, {"AvgGames", "N/A"},      {"AvgAccuracy", "N/A"},
          {"AvgDamage", "N/A"},    {"AvgSoldiering", "N/A"}, {"ClanName", "N/A"}};
}

BookmarkTexts GameTexts(const Player& player, const std::string& missionName, const std::string& date,
                        const std::string& rank) {
  return {{"MissionName", missionName},
          {"Date", date},
          {"Rank", rank},
          {"TotalDamage", Str(player.TotalDamage)},
          {"Soldiering", Str(player.Soldiering)},
          {"ShotsFired", Str(player.ShotCount)},
          {"Accuracy", player.Accuracy == 0 ? "N/A" : FormatPercent(player.Accuracy)},
          {"WIA", Str(player.HealCount)},
          {"KIA", Str(player.DeathCount)},
          {"AmmoAdds", Str(player.AmmoAddCount)}};
}

CellTexts HitsScored(const Game& game, int index, MemberLookup& members) {
  CellTexts cells;
  for (int other = 1; other <= PlayerCount; ++other) {
    const std::int32_t damage = game.Players(other).HitByPlayer(index);
    if (damage > 0) {
      cells.push_back(HitText(game, other, damage, members));
    }
  }
  return cells;
}

CellTexts HitsTaken(const Game& game, int index, MemberLookup& members) {
  const Player& player = game.Players(index);
  CellTexts cells;
  for (int other = 1; other <= PlayerCount; ++other) {
    if (player.HitByPlayer(other) > 0) {
      cells.push_back(HitText(game, other, player.HitByPlayer(other), members));
    }
  }
  const std::pair<const char*, std::int32_t> specials[] = {{"Explosive: ", player.ExplosiveDamage},
                                                           {"Radiation: ", player.RadiationDamage},
                                                           {"Stuns: ", player.StunCount}};
  for (const auto& [label, amount] : specials) {
    if (amount > 0) {
      cells.push_back(label + Str(amount));
    }
  }
  return cells;
}
