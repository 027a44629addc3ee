#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "core/game/PlayerId.h"
#include "platform/Sql.h"

struct MonthOfGames {
  std::string Month;  ///< "2026-11"
  int Games = 0;
};

/// Which games to list; what is empty or 0 does not limit them.
struct GameFilter {
  std::string From = {};    ///< earliest local time, "YYYY-MM-DD HH:MM:SS" or the beginning of one
  std::string Before = {};  ///< earliest time that is too late, in the same form
  std::string Mission = {};
  std::int32_t Member = 0;
  std::vector<std::int32_t> Members = {};  ///< one of whom plays
  int Player = 0;                          ///< record of a gun, 1 to 224
  bool Deleted = false;                    ///< the deleted games in place of the others
};

/// A game's row.
struct ListedGame {
  std::int64_t GameId = 0;
  std::string Played;    ///< local time, "YYYY-MM-DD HH:MM:SS"
  std::string DateText;  ///< the date in the game's file
  std::string Mission;
  int Players = 0;
  std::array<std::int64_t, TeamCount> TeamTotals{};
  int BestPlayer = 0;           ///< record of the first, 1 to 224; 0 without players
  std::int32_t BestMember = 0;  ///< 0 for a guest
  std::int64_t BestSoldiering = 0;
  int Pulls = 0;
  int Committed = 0;         ///< players
  std::string Deleted = {};  ///< local time of the deletion; empty for most games
  int EarlierStates = 0;     ///< which have files of their own
};

/// A game of one member.
struct MemberGame {
  std::int64_t GameId = 0;
  std::string Played;
  std::string Mission;
  int Place = 0;
  int Players = 0;
  std::int64_t Soldiering = 0;
  std::optional<double> Accuracy;  ///< fraction
  std::int64_t Damage = 0;
  bool Committed = false;
};

/// What a member did in the games of a period.
struct MemberPeriod {
  std::int32_t Member = 0;
  int Games = 0;
  std::int64_t SoldieringSum = 0;
  std::int64_t SoldieringBest = 0;
  double AccuracySum = 0;  ///< of the games with an accuracy above 0
  int AccuracyGames = 0;   ///< how many these are
};

/// Questions to the archive. Deleted games are in no answer unless it is said. Each is answered through an
/// index, however many games there are. All throw RuntimeError as Sql does.
class ArchiveQueries {
 public:
  explicit ArchiveQueries(Sql& sql) : sql_(sql) {}

  /// The months in which games were played, the latest first.
  std::vector<MonthOfGames> Months();

  /// The missions of all games, deleted ones too, by name.
  std::vector<std::string> Missions();

  /// Asked between steps with the part done, 0 to 1; may process events. False stops them.
  using Step = std::function<bool(double done)>;

  /// The numbers of the games, the latest first. Those of many members are found in steps; none if `goOn`
  /// stops that.
  std::vector<std::int64_t> Games(const GameFilter& filter, const Step& goOn = {});

  /// The row of one of them, deleted or not; none if it has meanwhile gone.
  std::optional<ListedGame> Game(std::int64_t gameId);

  /// The member's games, the latest first.
  std::vector<MemberGame> GamesOf(std::int32_t member);

  /// All members who played in the period, by number. Both ends are those of GameFilter.
  std::vector<MemberPeriod> Period(const std::string& from, const std::string& before);

 private:
  Sql& sql_;
};
