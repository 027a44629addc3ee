#include <map>

#include "missions/MissionRecord.h"
#include "tests/soak/kills/DatabaseState.h"
#include "tests/soak/kills/Desk.h"
#include "tests/soak/kills/Work.h"

namespace {

constexpr int Kept = 10;

std::string NameOf(int mission) {
  return "Soak " + std::to_string(mission);
}

/// Three steps a mission: it is added, it gets a longer description, and the one of ten missions ago goes.
struct Step {
  enum { Add, Change, Remove } What;
  int Mission;
};

Step StepOf(int number) {
  const int mission = (number - 1) / 3;
  switch ((number - 1) % 3) {
    case 0:
      return {Step::Add, mission};
    case 1:
      return {Step::Change, mission};
    default:
      return {Step::Remove, mission - Kept};
  }
}

/// Up to 509 characters, so that it is spread over columns; the 510th would be lost, as the window loses it.
std::string DescriptionAfter(int number) {
  return "Step " + std::to_string(number) + std::string(static_cast<std::size_t>(number % 3) * 240, 'x');
}

class MissionWork : public Work {
 public:
  explicit MissionWork(WorkSources sources) : sources_(std::move(sources)) {}

  std::string Name() const override { return "mission saves"; }
  int Share() const override { return 20; }

  void Prepare(const std::filesystem::path& folder) override { PutDefaultDatabases(sources_, folder); }

  void Run(const std::filesystem::path& folder, int first,
           const std::function<void(int step)>& report) override {
    Desk desk(sources_, folder);
    for (int number = first;; ++number) {
      Do(number, desk.Games.RsScenarios());
      report(number);
    }
  }

  std::string StateAfter(int steps) override {
    std::map<int, std::string> missions;
    for (int number = 1; number <= steps; ++number) {
      const Step step = StepOf(number);
      if (step.What == Step::Remove) {
        missions.erase(step.Mission);
      } else {
        missions[step.Mission] = DescriptionAfter(number);
      }
    }
    std::string rows;
    for (const auto& [mission, description] : missions) {
      rows += NameOf(mission) + ": " + std::to_string(description.size()) + " " + description.substr(0, 20) +
              "\n";
    }
    return rows;
  }

  std::string StateIn(const std::filesystem::path& folder) override {
    CheckBackups(folder);
    return RowsOf(
        folder / "scenarios.mdb",
        "SELECT MissionName || ': ' || (length(MissionDescription) + ifnull(length(MissionDescription2), 0)"
        " + ifnull(length(MissionDescription3), 0)) || ' ' || substr(MissionDescription, 1, 20) FROM Table1 "
        "WHERE MissionName LIKE 'Soak %' ORDER BY ID");
  }

 private:
  static void Do(int number, Recordset& rows) {
    const Step step = StepOf(number);
    if (step.What != Step::Add && !rows.WalkTo("MissionName", NameOf(step.Mission))) {
      if (step.What == Step::Remove && step.Mission < 0) {
        return;
      }
      throw std::runtime_error("the mission of step " + std::to_string(number) + " is gone");
    }
    if (step.What == Step::Remove) {
      rows.Delete();
      return;
    }
    if (step.What == Step::Add) {
      rows.AddNew();
    } else {
      rows.Edit();
    }
    MissionRecord mission;
    mission.Name = NameOf(step.Mission);
    mission.Description = DescriptionAfter(number);
    WriteMission(rows, mission);
    rows.Update();
  }

  WorkSources sources_;
};

}  // namespace

std::unique_ptr<Work> MakeMissionWork(const WorkSources& sources) {
  return std::make_unique<MissionWork>(sources);
}
