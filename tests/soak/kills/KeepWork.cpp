#include <stdexcept>

#include "archive/ArchiveCopies.h"
#include "archive/GameInputs.h"
#include "archive/GameKeeper.h"
#include "core/gamefile/GameFile.h"
#include "tests/soak/kills/DatabaseState.h"
#include "tests/soak/kills/Desk.h"
#include "tests/soak/kills/Work.h"
#include "tests/support/RandomGame.h"

namespace {

constexpr int Players = 40;
constexpr int StepsOfGame = 3;

constexpr int GameOfStep(int step) {
  return (step - 1) / StepsOfGame + 1;
}

/// What a step does to the game on the board.
enum class Change { NewGame, Bonus, SecondPull };

Change ChangeOf(int step) {
  return static_cast<Change>((step - 1) % StepsOfGame);
}

void Make(Change change, Game& game, int number) {
  if (change == Change::NewGame) {
    game.Clear();
    FillRandomly(game, Players, static_cast<unsigned>(number));
    game.DataPresent = true;
    game.GameDate = "game " + std::to_string(number);
  }
  for (int index = 1; index <= PlayerCount; ++index) {
    if (Player& player = game.Players(index); player.Active) {
      player.MemberIndex = change == Change::NewGame ? 1 + index % Players : player.MemberIndex;
      player.BonusPoints += change == Change::Bonus ? 1 : 0;
      player.ShotCount += change == Change::SecondPull ? 5 : 0;
    }
  }
}

/// Each step keeps a game: a new one, then its later state, then one after a second pull.
class KeepWork : public Work {
 public:
  explicit KeepWork(WorkSources sources) : sources_(std::move(sources)) {}

  std::string Name() const override { return "keeping"; }
  int MostSteps() const override { return 60; }

  void Prepare(const std::filesystem::path& folder) override {
    PutDefaultDatabases(sources_, folder);
    ChangeDatabase(folder / "members.mdb",
                   "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 40) INSERT INTO "
                   "Members (ContactID, FirstName) SELECT i, 'Ann' FROM n");
  }

  void Run(const std::filesystem::path& folder, int first,
           const std::function<void(int step)>& report) override {
    Desk desk(sources_, folder);
    const GameProgress progress(desk.Games, desk.Time);
    SqliteEngine engine;
    GameKeeper keeper(
        {desk.Games, progress, desk.Time, desk.Disk, engine, desk.Strings, folder, sources_.ProgramFolder});
    if (ChangeOf(first) != Change::NewGame) {
      Reload(desk, folder, GameOfStep(first));
      Keep(keeper);
    }
    for (int step = first; step <= MostSteps(); ++step) {
      const Change change = ChangeOf(step);
      if (change == Change::NewGame) {
        desk.Games.ClearPlayerData();
      }
      if (change != Change::Bonus) {
        keeper.BeginPull(GameSource::Cable);
      }
      Make(change, desk.Games.Game(), GameOfStep(step));
      desk.Games.CalculateScores();
      Keep(keeper);
      report(step);
      keeper.CopyAPart();
    }
  }

  std::string StateAfter(int steps) override {
    std::string games;
    Game game(strings_);
    std::string former;
    for (int step = 1; step <= steps; ++step) {
      const Change change = ChangeOf(step);
      if (change == Change::SecondPull) {
        former = LineOf(game, 1);
      }
      Make(change, game, GameOfStep(step));
      if (step == steps || ChangeOf(step + 1) == Change::NewGame) {
        games += std::to_string(GameOfStep(step)) + ": 40 of 40\n" + LineOf(game, 0) + former;
        former.clear();
      }
    }
    return games;
  }

  std::string StateIn(const std::filesystem::path& folder) override {
    for (const BackupCopy& copy : ArchiveCopies(LinuxFiles(), folder)) {
      RowsOf(folder / "backups" / copy.File, "SELECT ''");
    }
    const std::filesystem::path path = folder / "games.mdb";
    if (!std::filesystem::exists(path)) {
      return {};
    }
    RowsOf(path, "SELECT ''");
    SqliteEngine engine;
    const auto archiveFile = engine.OpenDatabase(path);
    const auto members = engine.OpenDatabase(folder / "members.mdb");
    GameArchive archive(*archiveFile, *members, strings_);
    std::string games;
    archiveFile->Statements().Query(
        "SELECT g.GameID, g.Players, (SELECT count(*) FROM GamePlayers p WHERE p.GameID = g.GameID) "
        "FROM Games g ORDER BY g.GameID",
        {}, [&](const SqlRow& row) {
          games += std::to_string(row.Integer(0)) + ": " + std::to_string(row.Integer(2)) + " of " +
                   std::to_string(row.Integer(1)) + "\n";
          for (std::int64_t state = 0; state <= archive.EarlierStates(row.Integer(0)); ++state) {
            games += LineOf(Read(archive.FileOf(row.Integer(0), state)), static_cast<int>(state));
          }
        });
    return games;
  }

 private:
  static void Keep(GameKeeper& keeper) {
    keeper.Keep();
    if (keeper.State().KeptAt.empty() || !keeper.State().Failure.empty()) {
      throw std::runtime_error("a game was not kept: " + keeper.State().Failure);
    }
  }

  void Reload(Desk& desk, const std::filesystem::path& folder, int number) const {
    SqliteEngine engine;
    const auto archiveFile = engine.OpenDatabase(folder / "games.mdb");
    GameArchive archive(*archiveFile, desk.Games.DbMembers(), strings_);
    const std::string bytes = archive.FileOf(number);
    desk.Games.LoadGame(
        [&](Game& game, const Session::MissionChoice& choose) { return ReadGameFile(bytes, game, choose); });
  }

  Game Read(const std::string& bytes) const {
    Game game(strings_);
    if (!ReadGameFile(bytes, game, [](const std::string&) {})) {
      throw std::runtime_error("a file in the archive is no game");
    }
    return game;
  }

  static std::string LineOf(const Game& game, int state) {
    return "  state " + std::to_string(state) + " " + GameInputsHash(GameInputs(game, "None")) + "\n";
  }

  WorkSources sources_;
  StringTable strings_{Language::English};
};

}  // namespace

std::unique_ptr<Work> MakeKeepWork(const WorkSources& sources) {
  return std::make_unique<KeepWork>(sources);
}
