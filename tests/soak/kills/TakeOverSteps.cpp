#include <stdexcept>
#include <utility>

#include "archive/copies/CopyWork.h"
#include "takeover/TakeOverMark.h"
#include "takeover/TakeOverWork.h"
#include "tests/soak/kills/DatabaseState.h"
#include "tests/soak/kills/Desk.h"
#include "tests/soak/kills/Work.h"

namespace {

constexpr int TakeOvers = 20;

std::string LabelOf(int number) {
  return "Venue " + std::to_string(number);
}

/// Each step takes over the next of several old installations. What a kill has left is finished first, as at
/// the program's start.
class OldInstallations : public Work {
 public:
  explicit OldInstallations(WorkSources sources) : sources_(std::move(sources)) {}

  std::string Name() const override { return "take-overs"; }

  /// Each one leaves copies of what was there before.
  int MostSteps() const override { return TakeOvers; }

  void Prepare(const std::filesystem::path& folder) override {
    for (int number = TakeOvers; number >= 0; --number) {
      const std::filesystem::path old = number == 0 ? folder : folder / ("old" + std::to_string(number));
      std::filesystem::create_directories(old);
      PutDefaultDatabases(sources_, old);
      ChangeDatabase(old / "members.mdb",
                     "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 40) INSERT "
                     "INTO Members (ContactID, City, Photograph) SELECT i, '" +
                         LabelOf(number) + "', randomblob(3000) FROM n");
      ChangeDatabase(old / "scenarios.mdb", "UPDATE Table1 SET TeamRatio = '" + LabelOf(number) + "'");
    }
  }

  void Run(const std::filesystem::path& folder, int first,
           const std::function<void(int step)>& report) override {
    LinuxFiles disk;
    FinishTakeOver(disk, folder);
    Desk desk(sources_, folder);
    SqliteEngine engine;
    JetConverter converter(disk, sources_.ProgramFolder / "tessarine-jet-reader");
    for (int step = first; step <= MostSteps(); ++step) {
      TakeOverWork work({.Engine = engine,
                         .Old = converter,
                         .Disk = disk,
                         .Time = desk.Time,
                         .Strings = desk.Strings,
                         .DataFolder = folder,
                         .Databases = {Taken(OldItem::Members, "members", "Members", desk, engine, folder),
                                       Taken(OldItem::Missions, "scenarios", "Table1", desk, engine, folder)},
                         .Ask = [](const std::string&) { return false; },
                         .HasPort = [](std::int16_t) { return false; }});
      work.Look(FindOldInstallation(disk, folder / ("old" + std::to_string(step))).value(),
                [](OldItem) { return true; });
      const TakenOver taken = work.Take({OldItem::Members, OldItem::Missions}, [](TakeStep) { return true; });
      if (taken.What != TakenOver::Done) {
        throw std::runtime_error("take-over " + std::to_string(step) + ": " + taken.Reason);
      }
      desk.Games.Reopen();
      report(step);
    }
  }

  std::string StateAfter(int steps) override {
    return "40 in " + LabelOf(steps) + "\nmissions of " + LabelOf(steps) + "\n";
  }

  std::string StateIn(const std::filesystem::path& folder) override {
    LinuxFiles disk;
    FinishTakeOver(disk, folder);
    for (const char* left : {"members.mdb-journal", "scenarios.mdb-journal"}) {
      if (std::filesystem::exists(folder / left)) {
        throw std::runtime_error(std::string(left) + " was left");
      }
    }
    return RowsOf(folder / "members.mdb", "SELECT count(*) || ' in ' || City FROM Members GROUP BY City") +
           RowsOf(folder / "scenarios.mdb", "SELECT DISTINCT 'missions of ' || TeamRatio FROM Table1");
  }

 private:
  TakenDatabase Taken(OldItem what, const std::string& name, const std::string& table, Desk& desk,
                      SqliteEngine& engine, const std::filesystem::path& folder) const {
    const bool isMembers = what == OldItem::Members;
    const CopiedDatabase copied{.Name = name,
                                .Table = table,
                                .DefaultPath = sources_.ProgramFolder / (name + "_default.mdb"),
                                .Title = OwnText::CopiedMembers,
                                .InUse = [&desk, isMembers]() -> Database& {
                                  return isMembers ? desk.Games.DbMembers() : desk.Games.DbScenarios();
                                }};
    const CopyWork work({.Engine = engine,
                         .Disk = desk.Disk,
                         .Time = desk.Time,
                         .Strings = desk.Strings,
                         .Folder = folder / "backups"});
    return {.What = what,
            .Table = table,
            .DefaultPath = copied.DefaultPath,
            .InUse = copied.InUse,
            .KeepCopy = [copied, work](const KeepOn& keepOn) {
              return work.KeepPresent(copied, [&keepOn](CopyStep) { return keepOn(); });
            }};
  }

  WorkSources sources_;
};

}  // namespace

std::unique_ptr<Work> MakeTakeOverSteps(const WorkSources& sources) {
  return std::make_unique<OldInstallations>(sources);
}
