#include <stdexcept>
#include <utility>

#include "archive/copies/CopyWork.h"
#include "tests/soak/kills/DatabaseState.h"
#include "tests/soak/kills/Desk.h"
#include "tests/soak/kills/Work.h"

namespace {

constexpr int Restores = 20;

std::string CopyNumber(int number) {
  return "members-2020-01-01-0000" + std::to_string(10 + number) + ".mdb";
}

std::string CityIn(int number) {
  return "City " + std::to_string(number);
}

/// Each step restores the next copy.
class RestoreWork : public Work {
 public:
  explicit RestoreWork(WorkSources sources) : sources_(std::move(sources)) {}

  std::string Name() const override { return "restores"; }

  /// Each one leaves a copy of what was there before.
  int MostSteps() const override { return Restores; }

  void Prepare(const std::filesystem::path& folder) override {
    PutDefaultDatabases(sources_, folder);
    ChangeDatabase(folder / "members.mdb",
                   "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 40) INSERT INTO "
                   "Members (ContactID, Photograph) SELECT i, randomblob(6000) FROM n");
    std::filesystem::create_directory(folder / "backups");
    for (int number = Restores; number >= 0; --number) {
      ChangeDatabase(folder / "members.mdb", "UPDATE Members SET City = '" + CityIn(number) + "'");
      std::filesystem::copy_file(folder / "members.mdb", folder / "backups" / CopyNumber(number));
    }
  }

  void Run(const std::filesystem::path& folder, int first,
           const std::function<void(int step)>& report) override {
    Desk desk(sources_, folder);
    SqliteEngine engine;
    const CopyWork work({.Engine = engine,
                         .Disk = desk.Disk,
                         .Time = desk.Time,
                         .Strings = desk.Strings,
                         .Folder = folder / "backups"});
    const CopiedDatabase members{.Name = "members",
                                 .Table = "Members",
                                 .DefaultPath = sources_.ProgramFolder / "members_default.mdb",
                                 .Title = OwnText::CopiedMembers,
                                 .InUse = [&desk]() -> Database& { return desk.Games.DbMembers(); }};
    for (int step = first; step <= MostSteps(); ++step) {
      const Restored restored =
          work.Restore(*BackupCopyOf(CopyNumber(step)), members, [](CopyStep) { return true; });
      if (restored.What != Restored::Done) {
        throw std::runtime_error("restore " + std::to_string(step) + ": " + restored.Reason);
      }
      desk.Games.Reopen();
      report(step);
    }
  }

  std::string StateAfter(int steps) override { return "40 in " + CityIn(steps) + "\n"; }

  std::string StateIn(const std::filesystem::path& folder) override {
    for (const char* left : {"members.mdb-journal", "members.mdb-wal", "members.mdb-shm"}) {
      if (std::filesystem::exists(folder / left)) {
        throw std::runtime_error(std::string(left) + " was left");
      }
    }
    for (const auto& entry : std::filesystem::directory_iterator(folder / "backups")) {
      if (entry.path().extension() == ".mdb") {
        RowsOf(entry.path(), "SELECT ''");
      }
    }
    return RowsOf(folder / "members.mdb", "SELECT count(*) || ' in ' || City FROM Members GROUP BY City");
  }

 private:
  WorkSources sources_;
};

}  // namespace

std::unique_ptr<Work> MakeRestoreWork(const WorkSources& sources) {
  return std::make_unique<RestoreWork>(sources);
}
