#include "archive/ArchiveQueries.h"

#include <algorithm>
#include <span>
#include <string_view>
#include <unordered_set>

namespace {

/// Conditions joined by AND, with their values.
class Conditions {
 public:
  /// `condition` ends where its parameter belongs.
  void Add(std::string_view condition, Value value, std::string_view rest = "") {
    values_.push_back(std::move(value));
    text_.append(" AND ").append(condition).append("$").append(std::to_string(values_.size())).append(rest);
  }
  /// The same with a list of numbers in parentheses.
  void AddList(std::string_view condition, std::span<const std::int32_t> numbers, std::string_view rest) {
    text_.append(" AND ").append(condition);
    const char* before = "($";
    for (const std::int32_t number : numbers) {
      values_.emplace_back(std::int64_t{number});
      text_.append(before).append(std::to_string(values_.size()));
      before = ", $";
    }
    text_.append(")").append(rest);
  }
  void AddPeriod(const std::string& from, const std::string& before) {
    if (!from.empty()) {
      Add("g.Played >= ", from);
    }
    if (!before.empty()) {
      Add("g.Played < ", before);
    }
  }

  const std::string& Text() const { return text_; }
  const SqlValues& Values() const { return values_; }

 private:
  std::string text_;
  SqlValues values_;
};

int Small(const SqlRow& row, std::size_t column) {
  return static_cast<int>(row.Integer(column));
}

/// More of them are asked for in pieces: a statement takes a limited number of parameters, and a step little
/// time.
constexpr std::size_t MembersAtOnce = 100;

/// The games in which one of these members plays, deleted ones too; none if `goOn` stops it.
std::unordered_set<std::int64_t> GamesOfAny(Sql& sql, std::span<const std::int32_t> members,
                                            const ArchiveQueries::Step& goOn) {
  std::unordered_set<std::int64_t> games;
  const auto all = static_cast<double>(members.size());
  while (!members.empty()) {
    if (goOn && !goOn(1 - static_cast<double>(members.size()) / all)) {
      return {};
    }
    const std::span<const std::int32_t> some = members.first(std::min(members.size(), MembersAtOnce));
    Conditions conditions;
    conditions.AddList("MemberID IN ", some, "");
    sql.Query("SELECT GameID FROM GamePlayers WHERE 1 = 1" + conditions.Text(), conditions.Values(),
              [&games](const SqlRow& row) { games.insert(row.Integer(0)); });
    members = members.subspan(some.size());
  }
  return games;
}

ListedGame ListedGameIn(const SqlRow& row) {
  return {.GameId = row.Integer(0),
          .Played = row.Text(1),
          .DateText = row.Text(2),
          .Mission = row.Text(3),
          .Players = Small(row, 4),
          .TeamTotals = {row.Integer(5), row.Integer(6), row.Integer(7)},
          .BestPlayer = Small(row, 8),
          .BestMember = Small(row, 9),
          .BestSoldiering = row.Integer(10),
          .Pulls = Small(row, 11),
          .Committed = Small(row, 12),
          .Deleted = row.Text(13),
          .EarlierStates = Small(row, 14)};
}

MemberGame MemberGameIn(const SqlRow& row) {
  return {.GameId = row.Integer(0),
          .Played = row.Text(1),
          .Mission = row.Text(2),
          .Place = Small(row, 3),
          .Players = Small(row, 4),
          .Soldiering = row.Integer(5),
          .Accuracy = row.IsNull(6) ? std::nullopt : std::optional(row.Real(6)),
          .Damage = row.Integer(7),
          .Committed = row.Integer(8) != 0};
}

}  // namespace

std::vector<MonthOfGames> ArchiveQueries::Months() {
  std::vector<MonthOfGames> months;
  sql_.Query(
      "SELECT substr(Played, 1, 7), count(*) FROM Games WHERE Deleted IS NULL "
      "GROUP BY substr(Played, 1, 7) ORDER BY 1 DESC",
      {}, [&months](const SqlRow& row) {
        months.push_back({row.Text(0), Small(row, 1)});
      });
  return months;
}

std::vector<std::string> ArchiveQueries::Missions() {
  std::vector<std::string> missions;
  // From one to the next in the index, however many games each has.
  sql_.Query(
      "WITH RECURSIVE m (Mission) AS (SELECT min(Mission) FROM Games UNION ALL "
      "SELECT (SELECT min(Games.Mission) FROM Games WHERE Games.Mission > m.Mission) FROM m "
      "WHERE m.Mission IS NOT NULL) SELECT Mission FROM m WHERE Mission IS NOT NULL ORDER BY Mission",
      {}, [&missions](const SqlRow& row) { missions.push_back(row.Text(0)); });
  return missions;
}

std::vector<std::int64_t> ArchiveQueries::Games(const GameFilter& filter, const Step& goOn) {
  Conditions conditions;
  conditions.AddPeriod(filter.From, filter.Before);
  if (!filter.Mission.empty()) {
    conditions.Add("g.Mission = ", filter.Mission);
  }
  if (filter.Member != 0) {
    conditions.Add(
        "g.GameID IN (SELECT GameID FROM GamePlayers WHERE MemberID = ", std::int64_t{filter.Member}, ")");
  }
  const bool manyMembers = filter.Members.size() > MembersAtOnce;
  if (!filter.Members.empty() && !manyMembers) {
    conditions.AddList("g.GameID IN (SELECT GameID FROM GamePlayers WHERE MemberID IN ", filter.Members, ")");
  }
  if (filter.Player != 0) {
    conditions.Add(
        "g.GameID IN (SELECT GameID FROM GamePlayers WHERE PlayerIndex = ", std::int64_t{filter.Player}, ")");
  }
  std::vector<std::int64_t> games;
  const std::string which = filter.Deleted ? "g.Deleted IS NOT NULL" : "g.Deleted IS NULL";
  sql_.Query("SELECT g.GameID FROM Games g WHERE " + which + conditions.Text() +
                 " ORDER BY g.Played DESC, g.GameID DESC",
             conditions.Values(), [&games](const SqlRow& row) { games.push_back(row.Integer(0)); });
  if (manyMembers) {
    const std::unordered_set<std::int64_t> theirs = GamesOfAny(sql_, filter.Members, goOn);
    std::erase_if(games, [&theirs](std::int64_t game) { return !theirs.contains(game); });
  }
  return games;
}

std::optional<ListedGame> ArchiveQueries::Game(std::int64_t gameId) {
  std::optional<ListedGame> game;
  sql_.Query(
      "SELECT g.GameID, g.Played, g.DateText, g.Mission, g.Players, g.RedTotal, g.BlueTotal, g.YellowTotal, "
      "g.BestPlayer, p.MemberID, p.Soldiering, g.Pulls, g.Committed, g.Deleted, "
      "(SELECT max(State) FROM GameFiles WHERE GameID = $1) FROM Games g LEFT JOIN GamePlayers p "
      "ON p.GameID = g.GameID AND p.PlayerIndex = g.BestPlayer WHERE g.GameID = $1",
      {gameId}, [&game](const SqlRow& row) { game = ListedGameIn(row); });
  return game;
}

std::vector<MemberGame> ArchiveQueries::GamesOf(std::int32_t member) {
  std::vector<MemberGame> games;
  sql_.Query(
      "SELECT g.GameID, g.Played, g.Mission, p.Place, g.Players, p.Soldiering, p.Accuracy, p.DamageDealt, "
      "p.Committed FROM GamePlayers p JOIN Games g ON g.GameID = p.GameID "
      "WHERE p.MemberID = $1 AND g.Deleted IS NULL ORDER BY g.Played DESC, g.GameID DESC, p.PlayerIndex",
      {std::int64_t{member}}, [&games](const SqlRow& row) { games.push_back(MemberGameIn(row)); });
  return games;
}

std::vector<MemberPeriod> ArchiveQueries::Period(const std::string& from, const std::string& before) {
  Conditions conditions;
  conditions.AddPeriod(from, before);
  std::vector<MemberPeriod> members;
  // SQLite keeps the order of a CROSS JOIN: first the period's games. Otherwise it begins with all rows of
  // all members.
  sql_.Query(
      "SELECT p.MemberID, count(*), sum(p.Soldiering), max(p.Soldiering), "
      "sum(CASE WHEN p.Accuracy <> 0 THEN p.Accuracy ELSE 0.0 END), "
      "sum(CASE WHEN p.Accuracy <> 0 THEN 1 ELSE 0 END) "
      "FROM Games g CROSS JOIN GamePlayers p "
      "WHERE p.GameID = g.GameID AND g.Deleted IS NULL AND p.MemberID > 0" +
          conditions.Text() + " GROUP BY p.MemberID ORDER BY p.MemberID",
      conditions.Values(), [&members](const SqlRow& row) {
        members.push_back({.Member = static_cast<std::int32_t>(row.Integer(0)),
                           .Games = Small(row, 1),
                           .SoldieringSum = row.Integer(2),
                           .SoldieringBest = row.Integer(3),
                           .AccuracySum = row.Real(4),
                           .AccuracyGames = Small(row, 5)});
      });
  return members;
}
