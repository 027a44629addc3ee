#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <functional>
#include <numeric>
#include <string>
#include <vector>

#include "archive/Entries.h"
#include "archive/exported/ArchivedGames.h"
#include "bench/Goals.h"
#include "bench/ManyGames.h"
#include "core/gamefile/GameFile.h"
#include "exports/ExportRun.h"
#include "tests/support/OpenSession.h"
#include "tests/support/RandomGame.h"

namespace {

constexpr int PastGames = 100'000;
constexpr int PlayersOfGame = 24;
constexpr std::size_t PastPlayers = std::size_t{PastGames} * PlayersOfGame;
constexpr int GamesWithFiles = 2000;

/// The statement of the archive's own tool that gives the same rows and columns.
constexpr const char* SameRows =
    "SELECT g.GameID AS game, g.Played AS received, g.DateText AS game_date, g.Mission AS mission, "
    "p.Place AS place, p.PlayerIndex AS player, p.PlayerIndex / 97 + 1 AS team, p.PlayerIndex % 97 AS "
    "number, "
    "'Blue 7' AS name, p.Soldiering AS soldiering, p.Accuracy AS accuracy, p.DamageDealt AS damage, "
    "p.Shots AS shots, p.Wia AS heals, p.Kia AS deaths, p.AmmoAdds AS ammo_adds, p.Committed AS committed, "
    "p.DamageTaken AS damage_taken FROM Games g CROSS JOIN GamePlayers p WHERE p.GameID = g.GameID AND "
    "g.Deleted IS NULL ORDER BY g.Played, g.GameID, p.Place";

/// The same rows of the games that have files.
std::string SomeRows() {
  const std::string rows = SameRows;
  const std::size_t order = rows.find(" ORDER BY");
  return rows.substr(0, order) + " AND g.GameID <= " + std::to_string(GamesWithFiles) + rows.substr(order);
}

double SecondsOf(const std::function<void()>& run) {
  const auto start = std::chrono::steady_clock::now();
  run();
  return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

void Require(bool held, const char* what) {
  if (!held) {
    std::fprintf(stderr, "%s\n", what);
    std::abort();
  }
}

/// Members of whom every second one has a nickname.
void AddMembers(const std::string& path) {
  BareSqlite(path).Run(
      "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 3430) INSERT INTO Members "
      "(ContactID, FirstName, LastName, NickName) SELECT i, 'First' || i, 'Last' || i, CASE WHEN i % 2 THEN "
      "'Nick' || i END FROM n");
}

/// Gives each of so many games the file of one that has as many players.
void AddFiles(OpenSession& venue, const std::string& archive, int games) {
  Game game(venue.Strings);
  FillRandomly(game, PlayersOfGame, 7);
  const std::string bytes = WriteGameFile(game, "Mission 1");
  const Blob packed = Packed(bytes);
  BareSqlite bare(archive);
  bare.Run("PRAGMA synchronous = OFF; BEGIN");
  sqlite3_stmt* file =
      bare.Prepare("INSERT INTO sqlar VALUES (?1 || '.game.xml', 33188, 1790000000, ?2, ?3)");
  sqlite3_stmt* name = bare.Prepare("INSERT INTO GameFiles VALUES (?1, 0, ?1 || '.game.xml', '')");
  for (int number = 1; number <= games; ++number) {
    for (sqlite3_stmt* statement : {file, name}) {
      sqlite3_bind_int(statement, 1, number);
    }
    sqlite3_bind_int64(file, 2, static_cast<sqlite3_int64>(bytes.size()));
    sqlite3_bind_blob64(file, 3, packed.data(), packed.size(), SQLITE_STATIC);
    for (sqlite3_stmt* statement : {file, name}) {
      Require(sqlite3_step(statement) == SQLITE_DONE, "no file");
      sqlite3_reset(statement);
    }
  }
  sqlite3_finalize(file);
  sqlite3_finalize(name);
  bare.Run("COMMIT");
}

std::size_t LinesOf(const std::string& path) {
  const std::string bytes = LinuxFiles().Read(path);
  return static_cast<std::size_t>(std::count(bytes.begin(), bytes.end(), '\n'));
}

}  // namespace

/// bench-exports: the table of all players of 100,000 games against the database's own tool.
int main() {
  OpenSession venue;
  AddMembers(venue.MembersFile());
  const std::string archive = venue.Folder / "games.mdb";
  MakeArchive(archive);
  AddGames(archive, PastGames);
  Require(venue.Open(), "no session");
  ArchiveAccess access({.Session = venue.session,
                        .Disk = venue.Disk,
                        .Engine = venue.Databases,
                        .Strings = venue.Strings,
                        .UserDataFolder = venue.Folder.Path(),
                        .ProgramFolder = venue.Folder / "program"});
  const std::string ownFile = venue.Folder / "own.csv";
  const std::string toolFile = venue.Folder / "tool.csv";
  const std::string command = "sqlite3 -csv -header '" + archive + "' \"" + SameRows + "\" > '" + toolFile +
                              "' && sync '" + toolFile + "'";
  std::vector<double> own;
  std::vector<double> tool;
  constexpr int runs = 3;
  for (int run = 0; run < runs; ++run) {
    own.push_back(SecondsOf([&] {
      ArchivedGames games(access, venue.session, venue.Strings);
      const auto file = venue.Disk.BeginReplace(ownFile, FileReaders::AsBefore);
      const ExportOutcome outcome =
          ExportPastGames(games, games.Of("2000-01-01", "2099-12-31"), {.Format = ExportFormat::Figures},
                          venue.Strings, *file, [](double) { return true; });
      Require(outcome.Complete && outcome.Written == std::size_t{PastGames}, "not all games");
    }));
    tool.push_back(SecondsOf([&] { Require(std::system(command.c_str()) == 0, command.c_str()); }));
  }
  Require(LinesOf(ownFile) == PastPlayers + 1 && LinesOf(toolFile) == PastPlayers + 1, "not all players");
  std::vector<double> whole;
  std::vector<double> some;
  AddFiles(venue, archive, GamesWithFiles);
  const std::string someCommand = "sqlite3 -csv -header '" + archive + "' \"" + SomeRows() + "\" > '" +
                                  toolFile + "' && sync '" + toolFile + "'";
  std::vector<std::int64_t> first(GamesWithFiles);
  std::iota(first.begin(), first.end(), 1);
  for (int run = 0; run < runs; ++run) {
    whole.push_back(SecondsOf([&] {
      ArchivedGames games(access, venue.session, venue.Strings);
      const auto file = venue.Disk.BeginReplace(ownFile, FileReaders::AsBefore);
      const ExportOutcome outcome = ExportPastGames(games, first, {.Format = ExportFormat::Players},
                                                    venue.Strings, *file, [](double) { return true; });
      Require(outcome.Complete && outcome.Written == first.size(), "not all files");
    }));
    some.push_back(SecondsOf([&] { Require(std::system(someCommand.c_str()) == 0, someCommand.c_str()); }));
  }
  Require(LinesOf(ownFile) == std::size_t{GamesWithFiles} * PlayersOfGame + 1,
          "not all players of the files");
  constexpr double microseconds = 1e6;
  constexpr double goal = 2;
  bool met =
      ReportGoal("CSV with all figures of 2,000 games / sqlite3 -csv of fewer", Median(whole) / Median(some),
                 goal, TimesText(Median(whole) * microseconds, Median(some) * microseconds));
  met &= ReportGoal("CSV of all players of 100,000 games / sqlite3 -csv", Median(own) / Median(tool), goal,
                    TimesText(Median(own) * microseconds, Median(tool) * microseconds));
  return met ? 0 : 1;
}
