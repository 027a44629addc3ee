#include "sheets/SheetTexts.h"

#include <algorithm>
#include <string_view>

#include "core/game/HitLines.h"
#include "core/text/NumberForms.h"
#include "core/text/Pieces.h"
#include "core/text/TextEncoding.h"
#include "platform/Letters.h"

namespace {

std::string NumberText(int index) {
  return Str(std::int32_t{PlayerNumberFromId(IdFromIndex(index))});
}

/// Sheets show the other player with one blank between team and number, and a member by the nickname.
CellTexts TextsOf(const std::vector<Hit>& hits, const Game& game, MemberLookup& members) {
  CellTexts cells;
  for (const Hit& hit : hits) {
    const std::string number(Trimmed(NumberText(hit.Index), IsBlank));
    cells.push_back(HitText(game.TeamName(hit.Index) + " " + number, hit, game, members, true));
  }
  return cells;
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
  // The character after the comma is dropped too.
  return Characters(std::string_view(longDate).substr(comma + 1), 1, longDate.size());
}

BookmarkTexts ResultTexts(const Game& game, int index, int winner) {
  const bool won = TeamFromId(IdFromIndex(index)) == winner;
  return {{"Victory", won ? "Team Won!" : "Team Lost!"},
          {"PlayerTeam", game.TeamName(index)},
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

std::optional<RowSizes> SizesForHits(int hits, int rows) {
  constexpr double leastRest = 0.35;     // of an unused row's height
  constexpr double mostUsed = 1.6;       // of a used row's height
  constexpr double lettersInRow = 1.15;  // what a row has room for beyond its letters
  if (hits <= 0 || hits > rows) {
    return std::nullopt;
  }
  const int rest = rows - hits;
  const double used = std::min(mostUsed, (rows - leastRest * rest) / hits);
  return RowSizes{.Used = hits,
                  .Letters = used * lettersInRow,
                  .UsedHeight = used,
                  .RestHeight = rest > 0 ? (rows - used * hits) / rest : 1};
}

CellTexts HitsScored(const Game& game, int index, MemberLookup& members) {
  return TextsOf(HitsGivenBy(index, game), game, members);
}

CellTexts HitsTaken(const Game& game, int index, MemberLookup& members) {
  CellTexts cells = TextsOf(HitsTakenBy(index, game), game, members);
  for (const SpecialHit& hit : SpecialHitsOf(game.Players(index))) {
    cells.push_back(hit.Caption + Str(hit.Amount));
  }
  return cells;
}
