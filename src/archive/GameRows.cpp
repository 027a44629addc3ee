#include "archive/GameRows.h"

#include <algorithm>
#include <set>

#include "core/game/Standings.h"

namespace {

std::string NameOf(GameSource source) {
  switch (source) {
    case GameSource::Cable:
      return "cable";
    case GameSource::Radio:
      return "radio";
    case GameSource::File:
      return "file";
    case GameSource::Import:
      return "import";
  }
  return {};
}

/// The standings without names, which the archive does not keep.
std::vector<Standing> StandingsOf(const Game& game) {
  return Standings(game, [](std::int32_t) { return std::string(); });
}

std::int64_t CountPlayers(const Game& game, bool Player::*flag) {
  return std::ranges::count_if(game.Players,
                               [flag](const Player& player) { return player.Active && player.*flag; });
}

/// The values of $1 to $15, which both statements on a game's row share.
SqlValues SummaryOf(const GameState& state, const std::string& inputsHash) {
  const Game& game = state.Game;
  const std::vector<Standing> standings = StandingsOf(game);
  const auto whole = [](std::int64_t number) { return number; };
  return {game.GameDate,
          state.Mission,
          whole(state.Pulls),
          CountPlayers(game, &Player::Active),
          CountPlayers(game, &Player::Committed),
          whole(game.TeamTotals(1)),
          whole(game.TeamTotals(2)),
          whole(game.TeamTotals(3)),
          whole(standings.empty() ? 0 : standings.front().Index),
          state.Factors.Damage,
          state.Factors.Death,
          state.Factors.Heal,
          state.Factors.Ammo,
          state.Factors.Accuracy,
          state.Factors.FriendlyFire,
          inputsHash};
}

/// Rows of guns that take no part any more.
void DeleteOthers(Sql& sql, std::int64_t gameId, const Game& game) {
  std::vector<std::int64_t> others;
  sql.Query("SELECT PlayerIndex FROM GamePlayers WHERE GameID = $1", {gameId}, [&](const SqlRow& row) {
    const std::int64_t index = row.Integer(0);
    if (index < 1 || index > PlayerCount || !game.Players(static_cast<int>(index)).Active) {
      others.push_back(index);
    }
  });
  for (const std::int64_t index : others) {
    sql.Change("DELETE FROM GamePlayers WHERE GameID = $1 AND PlayerIndex = $2", {gameId, index});
  }
}

}  // namespace

std::int64_t InsertGame(Sql& sql, const GameState& state, const std::string& inputsHash) {
  SqlValues values = SummaryOf(state, inputsHash);
  values.emplace_back(state.Played);
  values.emplace_back(NameOf(state.Source));
  return sql.Insert(
      "INSERT INTO Games (DateText, Mission, Pulls, Players, Committed, RedTotal, BlueTotal, YellowTotal, "
      "BestPlayer, DamageFactor, DeathFactor, HealFactor, AmmoFactor, AccuracyFactor, FriendlyFireFactor, "
      "InputsHash, Played, Source) VALUES "
      "($1, $2, $3, $4, $5, $6, $7, $8, $9, $10, $11, $12, $13, $14, $15, $16, $17, $18) RETURNING GameID",
      values);
}

bool UpdateGame(Sql& sql, std::int64_t gameId, const GameState& state, const std::string& inputsHash) {
  SqlValues values = SummaryOf(state, inputsHash);
  values.emplace_back(gameId);
  return sql.Change(
             "UPDATE Games SET DateText = $1, Mission = $2, Pulls = $3, Players = $4, Committed = $5, "
             "RedTotal = $6, BlueTotal = $7, YellowTotal = $8, BestPlayer = $9, DamageFactor = $10, "
             "DeathFactor = $11, HealFactor = $12, AmmoFactor = $13, AccuracyFactor = $14, "
             "FriendlyFireFactor = $15, InputsHash = $16 WHERE GameID = $17",
             values) != 0;
}

void WritePlayers(Sql& sql, std::int64_t gameId, const Game& game) {
  DeleteOthers(sql, gameId, game);
  std::vector<Standing> standings = StandingsOf(game);
  std::ranges::sort(standings, {}, &Standing::Index);  // the order of the rows in the file
  for (const Standing& standing : standings) {
    const Player& player = game.Players(standing.Index);
    const auto whole = [](std::int64_t number) { return Value(number); };
    sql.Change(
        "INSERT INTO GamePlayers (GameID, PlayerIndex, MemberID, DallasID, Place, Soldiering, Accuracy, "
        "DamageDealt, DamageTaken, Shots, Wia, Kia, AmmoAdds, Committed) VALUES "
        "($1, $2, $3, $4, $5, $6, $7, $8, $9, $10, $11, $12, $13, $14) "
        "ON CONFLICT (GameID, PlayerIndex) DO UPDATE SET MemberID = $3, DallasID = $4, Place = $5, "
        "Soldiering = $6, Accuracy = $7, DamageDealt = $8, DamageTaken = $9, Shots = $10, Wia = $11, "
        "Kia = $12, AmmoAdds = $13, Committed = $14",
        {gameId, whole(standing.Index), whole(player.MemberIndex), player.DallasID, whole(standing.Place),
         whole(standing.Soldiering), standing.Accuracy ? Value(double{*standing.Accuracy}) : Value(),
         whole(standing.DamageDealt), whole(standing.DamageTaken), whole(standing.Shots), whole(standing.Wia),
         whole(standing.Kia), whole(standing.AmmoAdds), whole(player.Committed ? 1 : 0)});
  }
}

void DeleteGame(Sql& sql, std::int64_t gameId) {
  sql.Change("DELETE FROM sqlar WHERE name IN (SELECT Name FROM GameFiles WHERE GameID = $1)", {gameId});
  sql.Change("DELETE FROM GameFiles WHERE GameID = $1", {gameId});
  sql.Change("DELETE FROM GamePlayers WHERE GameID = $1", {gameId});
  sql.Change("DELETE FROM Games WHERE GameID = $1", {gameId});
}

std::string PlayedIn(Sql& sql, std::int64_t gameId) {
  std::string played;
  sql.Query("SELECT Played FROM Games WHERE GameID = $1 AND Deleted IS NULL", {gameId},
            [&played](const SqlRow& row) { played = row.Text(0); });
  return played;
}

std::vector<std::int32_t> MembersIn(const Game& game) {
  std::set<std::int32_t> numbers;
  for (const Player& player : game.Players) {
    if (player.Active && player.MemberIndex != 0) {
      numbers.insert(player.MemberIndex);
    }
  }
  return {numbers.begin(), numbers.end()};
}
