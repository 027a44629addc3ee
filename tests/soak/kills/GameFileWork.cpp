#include "core/gamefile/CurrentGameFile.h"
#include "core/gamefile/GameFile.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/soak/kills/DatabaseState.h"
#include "tests/soak/kills/Desk.h"
#include "tests/soak/kills/Work.h"
#include "tests/support/RandomGame.h"

namespace {

constexpr int Players = 30;

/// Each step saves another game under the same name.
class GameFileWork : public Work {
 public:
  explicit GameFileWork(WorkSources sources) : sources_(std::move(sources)) {}

  std::string Name() const override { return "game saves"; }

  void Prepare(const std::filesystem::path& folder) override { PutDefaultDatabases(sources_, folder); }

  void Run(const std::filesystem::path& folder, int first,
           const std::function<void(int step)>& report) override {
    Desk desk(sources_, folder);
    FakeFileDialog dialog;
    CurrentGameFile file(dialog, desk.Disk, desk.Boxes);
    for (int number = first;; ++number) {
      desk.Games.Game().Clear();
      FillRandomly(desk.Games.Game(), Players, static_cast<unsigned>(number));
      dialog.Answers = {folder / "game.xml"};
      desk.Games.SaveGame(
          [&](const Game& game, const std::string& mission) { return file.SaveGame(game, mission); });
      report(number);
    }
  }

  std::string StateAfter(int steps) override {
    if (steps == 0) {
      return "none";
    }
    Game game(strings_);
    FillRandomly(game, Players, static_cast<unsigned>(steps));
    return DigestOf(WriteGameFile(game, "None"));
  }

  std::string StateIn(const std::filesystem::path& folder) override {
    const std::filesystem::path file = folder / "game.xml";
    return std::filesystem::exists(file) ? DigestOf(BytesOf(file)) : "none";
  }

 private:
  WorkSources sources_;
  StringTable strings_{Language::English};
};

}  // namespace

std::unique_ptr<Work> MakeGameFileWork(const WorkSources& sources) {
  return std::make_unique<GameFileWork>(sources);
}
