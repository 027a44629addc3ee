#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>

#include "archive/MemberCheck.h"
#include "archive/history/ForgetMember.h"
#include "archive/history/OldGames.h"
#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "bench/ManyGames.h"
#include "core/gamefile/GameFile.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"

namespace {

using std::chrono::steady_clock;

constexpr int PastGames = 100'000;
constexpr int Members = 4000;
constexpr int Forgotten = 1234;
constexpr int Players = 24;

double MicrosecondsSince(steady_clock::time_point begin) {
  return std::chrono::duration<double, std::micro>(steady_clock::now() - begin).count();
}

/// The longest time between two calls of Note.
class Breaks {
 public:
  void Note() {
    longest_ = std::max(longest_, MicrosecondsSince(last_));
    last_ = steady_clock::now();
  }
  double Longest() const { return longest_; }

 private:
  steady_clock::time_point last_ = steady_clock::now();
  double longest_ = 0;
};

/// A data folder with past games that all have files, and a copy of them.
class Site {
 public:
  Site() {
    std::string pattern = (std::filesystem::temp_directory_path() / "tessarine-bench-XXXXXX").string();
    path_ = mkdtemp(pattern.data());
    MakeMembers(path_ / "members.mdb", Members);
    MakeArchive(path_ / "games.mdb");
    AddGames(path_ / "games.mdb", PastGames);
    DbMembers = Engine.OpenDatabase(path_ / "members.mdb");
    AddFiles();
    std::filesystem::create_directory(path_ / "backups");
    std::filesystem::copy_file(path_ / "games.mdb", path_ / "backups/games-2025-12-31-201530-weekly.mdb");
    sync();  // or the first step would wait for all of that
  }
  ~Site() { std::filesystem::remove_all(path_); }
  Site(const Site&) = delete;
  Site& operator=(const Site&) = delete;

  std::unique_ptr<Database> Open() { return Engine.OpenDatabase(path_ / "games.mdb"); }
  std::string Folder() const { return path_; }

  SqliteEngine Engine;
  LinuxFiles Disk;
  const StringTable Strings{Language::English};
  std::unique_ptr<Database> DbMembers;

 private:
  /// Gives all games one and the same file, but for the member.
  void AddFiles() {
    Game game(Strings);
    for (int place = 1; place <= Players; ++place) {
      Player& player = game.Players(place * 8);
      player.Active = true;
      player.ShotCount = 300;
      for (int other = 1; other <= Players; ++other) {
        player.HitByPlayer(other * 8) = 5 + (place * 31 + other * 17) % 90;
      }
    }
    game.Players(8).MemberIndex = Forgotten;
    GameArchive(*Open(), *DbMembers, Strings)
        .Keep({.Game = game, .Mission = "None", .Played = "2025-12-31 20:15:30"});
    BareSqlite archive(path_ / "games.mdb");
    archive.Run("PRAGMA synchronous = OFF");
    const std::string last = std::to_string(PastGames + 1);
    archive.Run(
        "INSERT INTO sqlar SELECT printf('%06d.game.xml', GameID), mode, mtime, sz, data FROM sqlar, "
        "Games WHERE GameID < " +
        last);
    archive.Run(
        "INSERT INTO GameFiles SELECT GameID, 0, printf('%06d.game.xml', GameID), InputsHash FROM "
        "Games WHERE GameID < " +
        last);
  }

  std::filesystem::path path_;
};

bool Within(const char* name, double microseconds) {
  constexpr double limit = 100'000;
  return ReportGoal(name, microseconds / limit, 1, TimesText(microseconds, limit));
}

/// Number 1234 and another one belong to others now.
bool CheckTheMembers(Site& site) {
  const auto archive = site.Open();
  archive->Statements().Change("INSERT INTO KnownMembers VALUES ($1, '', 'x'), ($2, '', 'x')",
                               {std::int64_t{Forgotten + 1}, std::int64_t{Forgotten + 2}});
  const MemberCheck::Parts parts{*archive, *site.DbMembers, site.Strings};
  Breaks breaks;
  const auto begin = steady_clock::now();
  MemberCheck check(parts);
  breaks.Note();
  while (check.Step(parts)) {
    breaks.Note();
  }
  breaks.Note();
  if (check.Games() < 1000) {
    std::abort();
  }
  std::printf("  %d games cut in %.1f s\n", check.Games(), MicrosecondsSince(begin) / 1e6);
  return Within("longest step of checking the members / 100 ms", breaks.Longest());
}

bool DeleteOld(Site& site) {
  const auto archive = site.Open();
  constexpr int atOnce = 5;
  Breaks breaks;
  for (int step = 0; step < 200; ++step) {
    if (DeleteGamesBefore(*archive, "2022", atOnce) != atOnce) {
      std::abort();
    }
    breaks.Note();
  }
  return Within("longest step of deleting old games / 100 ms", breaks.Longest());
}

bool Forget(Site& site) {
  ForgetMember forgetting({.Engine = site.Engine,
                           .Disk = site.Disk,
                           .DbMembers = *site.DbMembers,
                           .Strings = site.Strings,
                           .UserDataFolder = site.Folder()},
                          Forgotten);
  Breaks breaks;
  const auto begin = steady_clock::now();
  const auto step = [&breaks](const ForgetMember::State&) {
    breaks.Note();
    return true;
  };
  const int games = forgetting.CountGames(step).value();
  breaks.Note();
  bool met = Within("longest step of counting a member's games / 100 ms", breaks.Longest());
  Breaks others;
  const auto forgotten = forgetting.Forget([&others](const ForgetMember::State&) {
    others.Note();
    return true;
  });
  others.Note();
  if (games < 500 || !forgotten.Failures.empty()) {
    std::abort();
  }
  std::printf("  %d games of an archive and its copy in %.1f s\n", games, MicrosecondsSince(begin) / 1e6);
  met &= Within("longest step of forgetting a member / 100 ms", others.Longest());
  return met;
}

}  // namespace

/// bench-forget: what takes long in an archive of 100,000 games, in its steps.
int main() {
  Site site;
  bool met = CheckTheMembers(site);
  met &= DeleteOld(site);
  met &= Forget(site);
  return met ? 0 : 1;
}
