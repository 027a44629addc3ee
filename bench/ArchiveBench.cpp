#include <benchmark/benchmark.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <memory>

#include "archive/ArchiveQueries.h"
#include "archive/Entries.h"
#include "archive/GameArchive.h"
#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "bench/ManyGames.h"
#include "core/gamefile/GameFile.h"
#include "tests/support/RandomGame.h"

namespace {

constexpr int VenuePlayers = 40;
constexpr int Members = 1000;
constexpr int PastGames = 100'000;
constexpr int AskedMember = 1234;
constexpr const char* Month = "2023-05";
constexpr const char* NextMonth = "2023-06";

/// The files of one run of this benchmark.
class Folder {
 public:
  Folder() {
    std::string pattern = (std::filesystem::temp_directory_path() / "tessarine-bench-XXXXXX").string();
    path_ = mkdtemp(pattern.data());
    MakeMembers(MembersFile(), Members);
    MakeArchive(Kept());
    MakeArchive(Bare());
    MakeArchive(Past());
    AddGames(Past(), PastGames);
  }
  ~Folder() { std::filesystem::remove_all(path_); }
  Folder(const Folder&) = delete;
  Folder& operator=(const Folder&) = delete;

  std::string MembersFile() const { return path_ / "members.mdb"; }
  std::string Kept() const { return path_ / "kept.mdb"; }
  std::string Bare() const { return path_ / "bare.mdb"; }
  std::string Past() const { return path_ / "past.mdb"; }
  std::string New() const { return path_ / "new.mdb"; }

 private:
  std::filesystem::path path_;
};

/// An archive with a game of so many players, all of them members.
class OpenArchive {
 public:
  OpenArchive(const Folder& folder, const std::string& path, int players) {
    SqliteEngine engine;
    archiveFile_ = engine.OpenDatabase(path);
    membersFile_ = engine.OpenDatabase(folder.MembersFile());
    Archive = std::make_unique<GameArchive>(*archiveFile_, *membersFile_, Strings);
    FillRandomly(Game, players, 7);
    for (int index = 1; index <= PlayerCount; ++index) {
      Game.Players(index).MemberIndex = Game.Players(index).Active ? index : 0;
    }
  }

  GameState State() const {
    return {.Game = Game, .Mission = "Capture the Flag", .Played = "2026-11-21 20:15:30"};
  }

  StringTable Strings{Language::English};
  ::Game Game{Strings};
  std::unique_ptr<GameArchive> Archive;

 private:
  std::unique_ptr<Database> archiveFile_;
  std::unique_ptr<Database> membersFile_;
};

void Keep(benchmark::State& state, const Folder& folder, int players) {
  const OpenArchive open(folder, folder.Kept(), players);
  while (state.KeepRunning()) {
    open.Archive->Keep(open.State());
  }
}

/// The same rows and bytes as Keep writes for 40 players, without making them.
void KeepBare(benchmark::State& state, const Folder& folder) {
  const OpenArchive open(folder, folder.Kept(), VenuePlayers);
  const Blob data = Packed(WriteGameFile(open.Game, "Capture the Flag"));
  BareSqlite bare(folder.Bare());
  sqlite3_stmt* game = bare.Prepare(
      "INSERT INTO Games SELECT NULL, '2026-11-21 20:15:30', '21.11.2026 20:15', 'Capture the Flag', "
      "'cable', "
      "1, 40, 20, 100, 200, 300, 40, 1, -1, -1, -1, 1, -1, hex(randomblob(32)), NULL");
  sqlite3_stmt* player = bare.Prepare(
      "INSERT INTO GamePlayers SELECT max(GameID), ?1, ?1, '0000000000000000', ?1, 400, 0.5, 1000, 1000, "
      "900, "
      "5, 6, 7, 1, NULL FROM Games");
  sqlite3_stmt* file = bare.Prepare(
      "INSERT INTO sqlar SELECT '2026-11-21/2015-' || printf('%06d', max(GameID)) || '.game.xml', 33188, "
      "1790000000, 200000, ?1 FROM Games");
  sqlite3_stmt* name = bare.Prepare(
      "INSERT INTO GameFiles SELECT max(GameID), 0, '2026-11-21/2015-' || printf('%06d', max(GameID)) || "
      "'.game.xml', hex(randomblob(32)) FROM Games");
  sqlite3_stmt* member = bare.Prepare(
      "INSERT INTO KnownMembers VALUES (?1, '0000000000000000', hex(zeroblob(32))) ON CONFLICT (MemberID) "
      "DO UPDATE SET DallasID = '0000000000000000', Digest = hex(zeroblob(32))");
  const auto run = [](sqlite3_stmt* statement) {
    if (sqlite3_step(statement) != SQLITE_DONE) {
      std::abort();
    }
    sqlite3_reset(statement);
  };
  while (state.KeepRunning()) {
    bare.Run("BEGIN IMMEDIATE");
    run(game);
    for (int index = 1; index <= VenuePlayers; ++index) {
      sqlite3_bind_int(player, 1, index);
      run(player);
      sqlite3_bind_int(member, 1, index);
      run(member);
    }
    sqlite3_bind_blob64(file, 1, data.data(), data.size(), SQLITE_STATIC);
    run(file);
    run(name);
    bare.Run("COMMIT");
  }
  for (sqlite3_stmt* statement : {game, player, file, name, member}) {
    sqlite3_finalize(statement);
  }
}

/// Bytes of the archive for each of a hundred games.
double BytesOfGame(const Folder& folder) {
  constexpr int games = 100;
  MakeArchive(folder.New());
  const auto before = static_cast<double>(std::filesystem::file_size(folder.New()));
  {
    OpenArchive open(folder, folder.New(), VenuePlayers);
    for (int game = 0; game < games; ++game) {
      FillRandomly(open.Game, VenuePlayers, 7);
      open.Game.GameDate = std::to_string(game);
      open.Archive->Keep(open.State());
    }
  }
  return (static_cast<double>(std::filesystem::file_size(folder.New())) - before) / games;
}

/// The longest step of a copy of the archive of 100,000 games, in microseconds.
double LongestStepOfCopy(const Folder& folder) {
  SqliteEngine engine;
  const auto past = engine.OpenDatabase(folder.Past());
  const auto copy = past->BeginCopy(folder.New() + ".part");
  double longest = 0;
  for (bool isWhole = false; !isWhole;) {
    const auto start = std::chrono::steady_clock::now();
    isWhole = copy->Step();
    const std::chrono::duration<double, std::micro> time = std::chrono::steady_clock::now() - start;
    longest = std::max(longest, time.count());
  }
  return longest;
}

template <typename Ask>
void Asked(benchmark::State& state, const Folder& folder, const Ask& ask) {
  SqliteEngine engine;
  const auto database = engine.OpenDatabase(folder.Past());
  ArchiveQueries queries(database->Statements());
  while (state.KeepRunning()) {
    if (ask(queries).empty()) {
      std::abort();
    }
  }
}

void AskedBare(benchmark::State& state, const Folder& folder, const std::string& sql,
               const std::string& first, const std::string& second = "") {
  BareSqlite bare(folder.Past());
  while (state.KeepRunning()) {
    if (bare.RowsOf(sql, first, second) == 0) {
      std::abort();
    }
  }
}

constexpr const char* HistoryQuery =
    "SELECT g.GameID, g.Played, g.Mission, p.Place, g.Players, p.Soldiering, p.Accuracy, p.DamageDealt, "
    "p.Committed FROM GamePlayers p JOIN Games g ON g.GameID = p.GameID WHERE p.MemberID = CAST(?1 AS "
    "INTEGER) "
    "AND g.Deleted IS NULL ORDER BY g.Played DESC, g.GameID DESC";

constexpr const char* RankingQuery =
    "SELECT p.MemberID, count(*), sum(p.Soldiering), max(p.Soldiering), sum(p.Accuracy), count(p.Accuracy) "
    "FROM Games g CROSS JOIN GamePlayers p WHERE p.GameID = g.GameID AND g.Deleted IS NULL AND p.MemberID > "
    "0 "
    "AND g.Played >= ?1 AND g.Played < ?2 GROUP BY p.MemberID";

void Register(const Folder& folder) {
  const auto add = [&folder](const char* name, auto run) {
    benchmark::RegisterBenchmark(name, [run, &folder](benchmark::State& state) { run(state, folder); });
  };
  add("Keep/40", [](benchmark::State& state, const Folder& in) { Keep(state, in, VenuePlayers); });
  add("Keep/224", [](benchmark::State& state, const Folder& in) { Keep(state, in, PlayerCount); });
  add("Keep/bare", KeepBare);
  add("List", [](benchmark::State& state, const Folder& in) {
    Asked(state, in, [](ArchiveQueries& queries) { return queries.Games({}); });
  });
  add("Months", [](benchmark::State& state, const Folder& in) {
    Asked(state, in, [](ArchiveQueries& queries) { return queries.Months(); });
  });
  add("History", [](benchmark::State& state, const Folder& in) {
    Asked(state, in, [](ArchiveQueries& queries) { return queries.GamesOf(AskedMember); });
  });
  add("History/bare", [](benchmark::State& state, const Folder& in) {
    AskedBare(state, in, HistoryQuery, std::to_string(AskedMember));
  });
  add("Ranking", [](benchmark::State& state, const Folder& in) {
    Asked(state, in, [](ArchiveQueries& queries) { return queries.Period(Month, NextMonth); });
  });
  add("Ranking/bare", [](benchmark::State& state, const Folder& in) {
    AskedBare(state, in, RankingQuery, Month, NextMonth);
  });
}

}  // namespace

/// bench-archive: keeping a game, and questions to 100,000 games.
int main(int argc, char** argv) {
  const Folder folder;
  Register(folder);
  auto times = MedianTimes(argc, argv);
  const auto against = [&times](const char* name, const char* what, const char* limit, double goal) {
    return ReportGoal(name, times[what] / times[limit], goal, TimesText(times[what], times[limit]));
  };
  const auto within = [&times](const char* name, const char* what, double limit) {
    return ReportGoal(name, times[what] / limit, 1, TimesText(times[what], limit));
  };
  constexpr double milliseconds = 1000;
  bool met = against("keeping a game of 40 players / the same through SQLite", "Keep/40", "Keep/bare", 2);
  met &= within("  / 10 ms", "Keep/40", 10 * milliseconds);
  met &= within("  the fullest of games / 100 ms", "Keep/224", 100 * milliseconds);
  const double bytes = BytesOfGame(folder);
  met &= ReportGoal("archive for a game of 40 players / 20 kB", bytes / 20'000, 1,
                    std::to_string(static_cast<int>(bytes)) + " bytes");
  met &= within("numbers of 100,000 games / 100 ms", "List", 100 * milliseconds);
  met &= within("their months / 100 ms", "Months", 100 * milliseconds);
  met &= against("history of 700 games / the same through SQLite", "History", "History/bare", 2);
  met &= against("ranking of a month / the same through SQLite", "Ranking", "Ranking/bare", 2);
  times["Step"] = LongestStepOfCopy(folder);
  met &= within("longest step of the weekly copy / 100 ms", "Step", 100 * milliseconds);
  return met ? 0 : 1;
}
