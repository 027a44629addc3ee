#include <vector>

#include "tests/soak/kills/DatabaseState.h"
#include "tests/soak/kills/Desk.h"
#include "tests/soak/kills/Work.h"

namespace {

constexpr int Members = 40;

/// What member `id` gains in game `number`.
std::int32_t DamageIn(int number, int id) {
  return (number * 31 + id * 7) % 500;
}

/// Each step adds the game of 40 members to their figures.
class CommitWork : public Work {
 public:
  explicit CommitWork(WorkSources sources) : sources_(std::move(sources)) {}

  std::string Name() const override { return "commits"; }
  int Share() const override { return 20; }

  void Prepare(const std::filesystem::path& folder) override {
    PutDefaultDatabases(sources_, folder);
    for (int id = 1; id <= Members; ++id) {
      ChangeDatabase(folder / "members.mdb",
                     "INSERT INTO Members (ContactID, FirstName) VALUES (" + std::to_string(id) + ", 'Ann')");
    }
  }

  void Run(const std::filesystem::path& folder, int first,
           const std::function<void(int step)>& report) override {
    Desk desk(sources_, folder);
    Session& games = desk.Games;
    for (int number = first;; ++number) {
      games.Game().Clear();
      for (int id = 1; id <= Members; ++id) {
        Player& player = games.Game().Players(id);
        player.Active = true;
        player.MemberIndex = id;
        player.TotalDamage = DamageIn(number, id);
        player.Soldiering = id;
      }
      if (games.CommitGame() != CommitResult::Committed) {
        throw std::runtime_error("the commit of game " + std::to_string(number) + " failed");
      }
      report(number);
    }
  }

  std::string StateAfter(int steps) override {
    std::string rows;
    for (int id = 1; id <= Members; ++id) {
      long damage = 0;
      for (int number = 1; number <= steps; ++number) {
        damage += DamageIn(number, id);
      }
      rows += std::to_string(id) + ": " + std::to_string(steps) + " games, " + std::to_string(damage) + ", " +
              std::to_string(steps * id) + "\n";
    }
    return rows;
  }

  std::string StateIn(const std::filesystem::path& folder) override {
    CheckBackups(folder);
    return RowsOf(
        folder / "members.mdb",
        "SELECT ContactID || ': ' || TotalGamesPlayed || ' games, ' || CAST(TotalDamage AS INTEGER) || "
        "', ' || CAST(TotalSoldiering AS INTEGER) FROM Members ORDER BY ContactID");
  }

 private:
  WorkSources sources_;
};

}  // namespace

std::unique_ptr<Work> MakeCommitWork(const WorkSources& sources) {
  return std::make_unique<CommitWork>(sources);
}
