#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "archive/GameKeeper.h"
#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "bench/ManyGames.h"
#include "core/gamefile/GameFile.h"
#include "tests/support/OpenSession.h"
#include "tests/support/RandomGame.h"

namespace {

using Clock = std::chrono::steady_clock;

constexpr int PastGames = 5000;

/// A session on databases of its own, all players members, with an archive or without.
class Desk {
 public:
  Desk(int players, bool hasArchive) : players_(players) {
    std::filesystem::remove(venue_.MembersFile());
    MakeMembers(venue_.MembersFile(), PlayerCount);
    venue_.Open();
    progress_.emplace(Games(), venue_.Time);
    if (hasArchive) {
      MakeArchive(venue_.Folder / "games.mdb");
      AddGames(venue_.Folder / "games.mdb", PastGames);
      keeper_.emplace(GameKeeper::Parts{Games(), *progress_, venue_.Time, venue_.Disk, venue_.Databases,
                                        venue_.Strings, venue_.Folder.Path(), venue_.Folder / "program"});
    }
    Fill();
    file_ = WriteGameFile(Games().Game(), "None");
    EndCommand();
  }

  Session& Games() { return venue_.session; }
  Player& First() { return *std::ranges::find(Games().Game().Players, true, &Player::Active); }

  /// Puts a further game on the board, whose guns have all come in.
  void Fill() {
    Game& game = Games().Game();
    ++games_;
    if (players_ == PlayerCount) {
      FillCompletely(game);
    } else {
      FillRandomly(game, players_, 7);
    }
    First().ShotCount += games_;
    game.DataPresent = true;
    game.GameDate = "21/05/2013 14:30";
    for (int index = 1; index <= PlayerCount; ++index) {
      game.Players(index).MemberIndex = game.Players(index).Active ? index : 0;
      game.Players(index).Committed = false;
    }
    Games().CalculateScores();
  }

  void BeginPull() {
    if (keeper_) {
      keeper_->BeginPull(GameSource::Cable);
    }
  }
  void Load() {
    Games().LoadGame([this](Game& game, const Session::MissionChoice& choose) {
      std::string mission;
      const bool isGame = ReadGameFile(file_, game, [&](const std::string& name) {
        mission = name;
        choose(name);
      });
      if (isGame && keeper_) {
        keeper_->Load(game, mission, {});
      }
      return isGame;
    });
  }
  void Save() {
    Games().SaveGame([this](const Game& game, const std::string& mission) {
      venue_.Disk.Replace(venue_.Folder / "saved.game.xml", WriteGameFile(game, mission));
      return true;
    });
  }

  /// Time of a command, in microseconds.
  double Run(const std::function<void(Desk&)>& command) {
    const auto start = Clock::now();
    command(*this);
    EndCommand();
    return std::chrono::duration<double, std::micro>(Clock::now() - start).count();
  }

 private:
  void EndCommand() {
    if (!keeper_) {
      return;
    }
    keeper_->Keep();
    if (!keeper_->State().Failure.empty()) {
      std::fprintf(stderr, "%s\n", keeper_->State().Failure.c_str());
      std::abort();
    }
  }

  const int players_;
  int games_ = 0;  ///< that were on the board
  OpenSession venue_;
  std::optional<GameProgress> progress_;
  std::optional<GameKeeper> keeper_;
  std::string file_;
};

struct Command {
  const char* Name;
  std::function<void(Desk&)> Prepare;  ///< not measured
  std::function<void(Desk&)> Do;
};

void Nothing(Desk& /*desk*/) {}

void Recalculate(Desk& desk) {
  desk.Games().CalculateScores();
}

void GiveBonus(Desk& desk) {
  ++desk.First().BonusPoints;
  Recalculate(desk);
}

const std::vector<Command>& AllCommands() {
  static const std::vector<Command> commands = {
      {"Calculate", Nothing, Recalculate},
      {"Bonus Points", Nothing, GiveBonus},
      {"Save Game", GiveBonus, [](Desk& desk) { desk.Save(); }},
      {"Commit Game",
       [](Desk& desk) {
         for (Player& player : desk.Games().Game().Players) {
           player.Committed = false;
         }
       },
       [](Desk& desk) { desk.Games().CommitGame(); }},
      {"end of a pull", Nothing,
       [](Desk& desk) {
         desk.BeginPull();
         desk.First().ShotCount += 5;
         Recalculate(desk);
       }},
      {"end of a new game's pull",
       [](Desk& desk) {
         desk.Games().ClearPlayerData();
         desk.BeginPull();
         desk.Fill();
       },
       Recalculate},
      {"Clear Game", GiveBonus, [](Desk& desk) { desk.Games().ClearPlayerData(); }},
      {"Load Game", Nothing, [](Desk& desk) { desk.Load(); }}};
  return commands;
}

/// What each command takes longer with an archive than without, in pairs of turns.
bool Report(const char* game, int players, double limitMilliseconds) {
  constexpr int runs = 15;
  constexpr double microseconds = 1000;
  Desk with(players, true);
  Desk without(players, false);
  std::vector<std::vector<double>> more(AllCommands().size());
  std::vector<std::vector<double>> alone(AllCommands().size());
  for (int run = 0; run < runs; ++run) {
    for (std::size_t i = 0; i < AllCommands().size(); ++i) {
      const Command& command = AllCommands()[i];
      command.Prepare(with);
      command.Prepare(without);
      const double time = without.Run(command.Do);
      alone[i].push_back(time);
      more[i].push_back(with.Run(command.Do) - time);
    }
  }
  bool met = true;
  for (std::size_t i = 0; i < AllCommands().size(); ++i) {
    char detail[80];
    std::snprintf(detail, sizeof detail, "%.1f ms more than %.1f ms", Median(more[i]) / microseconds,
                  Median(alone[i]) / microseconds);
    const std::string name = std::string("archive: ").append(AllCommands()[i].Name).append(game);
    met &= ReportGoal(name, Median(more[i]) / (limitMilliseconds * microseconds), 1, detail);
  }
  return met;
}

}  // namespace

/// bench-keeping: no command may get noticeably slower because games are kept.
int main() {
  bool met = Report(", 40 players / 10 ms", 40, 10);
  met &= Report(", fullest game / 100 ms", PlayerCount, 100);
  return met ? 0 : 1;
}
