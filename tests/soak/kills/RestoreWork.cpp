#include <stdexcept>
#include <utility>

#include "archive/CopiedArchive.h"
#include "archive/copies/CopyWork.h"
#include "tests/soak/kills/DatabaseState.h"
#include "tests/soak/kills/Desk.h"
#include "tests/soak/kills/Work.h"

namespace {

constexpr int Restores = 20;
constexpr int Rows = 40;

/// A database whose copies are restored in turn. All of its rows hold the number of the copy.
struct RestoredFile {
  std::string Name;
  std::string Filling;  ///< what gives it its rows
  std::string Table;
  std::string Column;  ///< which holds the number
};

const RestoredFile& FileOfStep(int step) {
  static const RestoredFile members = {
      "members",
      "INSERT INTO Members (ContactID, Photograph) SELECT i, randomblob(6000) FROM n",
      "Members",
      "City",
  };
  static const RestoredFile games = {
      "games",
      "INSERT INTO sqlar (name, sz, data) SELECT 'game ' || i, 6000, randomblob(6000) FROM n",
      "sqlar",
      "mode",
  };
  return step % 2 == 1 ? members : games;
}

/// The number of the copy that a step restores. That of copy 0 is there before the first.
constexpr int CopyOfStep(int step) {
  return (step + 1) / 2;
}

std::string NameOfCopy(const RestoredFile& file, int number) {
  return file.Name + "-2020-01-01-0000" + std::to_string(10 + number) + ".mdb";
}

/// Each step restores the next copy, of members and of past games in turn.
class RestoreWork : public Work {
 public:
  explicit RestoreWork(WorkSources sources) : sources_(std::move(sources)) {}

  std::string Name() const override { return "restores"; }

  /// Each one leaves a copy of what was there before.
  int MostSteps() const override { return Restores; }

  void Prepare(const std::filesystem::path& folder) override {
    PutDefaultDatabases(sources_, folder);
    std::filesystem::copy_file(sources_.ProgramFolder / "games_default.mdb", folder / "games.mdb");
    std::filesystem::create_directory(folder / "backups");
    for (const int step : {1, 2}) {
      const RestoredFile& file = FileOfStep(step);
      const std::filesystem::path path = folder / (file.Name + ".mdb");
      ChangeDatabase(path, "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < " +
                               std::to_string(Rows) + ") " + file.Filling);
      for (int number = CopyOfStep(Restores); number >= 0; --number) {
        ChangeDatabase(path, "UPDATE " + file.Table + " SET " + file.Column + " = " + std::to_string(number));
        std::filesystem::copy_file(path, folder / "backups" / NameOfCopy(file, number));
      }
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
    CopiedArchive archive({.Engine = engine,
                           .Disk = desk.Disk,
                           .UserDataFolder = folder,
                           .ProgramFolder = sources_.ProgramFolder});
    const CopiedDatabase games = archive.Entry();
    for (int step = first; step <= MostSteps(); ++step) {
      const RestoredFile& file = FileOfStep(step);
      const Restored restored =
          work.Restore(*BackupCopyOf(NameOfCopy(file, CopyOfStep(step))),
                       file.Name == members.Name ? members : games, [](CopyStep) { return true; });
      if (restored.What != Restored::Done) {
        throw std::runtime_error("restore " + std::to_string(step) + ": " + restored.Reason);
      }
      desk.Games.Reopen();
      report(step);
    }
  }

  std::string StateAfter(int steps) override {
    const std::string rows = std::to_string(Rows);
    return rows + " of " + std::to_string(CopyOfStep(steps)) + "\n" + rows + " of " +
           std::to_string(steps / 2) + "\n";
  }

  std::string StateIn(const std::filesystem::path& folder) override {
    for (const auto& entry : std::filesystem::directory_iterator(folder / "backups")) {
      if (entry.path().extension() == ".mdb") {
        RowsOf(entry.path(), "SELECT ''");
      }
    }
    std::string state;
    for (const int step : {1, 2}) {
      const RestoredFile& file = FileOfStep(step);
      const std::string path = folder / (file.Name + ".mdb");
      for (const char* left : {"-journal", "-wal", "-shm"}) {
        if (std::filesystem::exists(path + left)) {
          throw std::runtime_error(path + left + " was left");
        }
      }
      state += RowsOf(path, "SELECT count(*) || ' of ' || " + file.Column + " FROM " + file.Table +
                                " GROUP BY " + file.Column);
    }
    return state;
  }

 private:
  WorkSources sources_;
};

}  // namespace

std::unique_ptr<Work> MakeRestoreWork(const WorkSources& sources) {
  return std::make_unique<RestoreWork>(sources);
}
