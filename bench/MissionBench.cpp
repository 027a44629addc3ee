#include <QApplication>
#include <QListWidget>
#include <QPushButton>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <vector>

#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "missions/Scenarios.h"
#include "platform/sqlite/SqliteDatabase.h"

namespace {

using Clock = std::chrono::steady_clock;

double MicrosecondsSince(Clock::time_point start) {
  return std::chrono::duration<double, std::micro>(Clock::now() - start).count();
}

class SilentBoxes : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string& text, const std::string& /*title*/, BoxIcon icon,
                 BoxButtons /*buttons*/) override {
    if (icon != BoxIcon::Information) {
      std::fprintf(stderr, "%s\n", text.c_str());
      std::abort();
    }
    return BoxAnswer::Ok;
  }
};

/// Median time of a save in the editor with that many missions: row written, list rebuilt, last mission
/// shown.
double SaveTime(const std::string& file, int missions) {
  MakeMissions(file, missions);
  SqliteEngine engine;
  const StringTable strings(Language::English);
  SilentBoxes boxes;
  const auto database = engine.OpenDatabase(file);
  const auto rows = database->OpenRecordset("Table1");
  Scenarios window(*database, *rows, boxes, strings, nullptr);
  window.show();
  auto* save = window.findChild<QPushButton*>(QStringLiteral("Save"));
  std::vector<double> times;
  for (int run = 0; run < 9; ++run) {
    QApplication::processEvents();
    const auto start = Clock::now();
    save->click();
    times.push_back(MicrosecondsSince(start));
  }
  return Median(times);
}

/// Median time for reading the names of that many missions into a list.
double FillTime(const std::string& file, int missions) {
  MakeMissions(file, missions);
  SqliteEngine engine;
  const auto database = engine.OpenDatabase(file);
  const auto rows = database->OpenRecordset("Table1");
  QListWidget list;
  list.show();
  std::vector<double> times;
  for (int run = 0; run < 9; ++run) {
    QApplication::processEvents();
    const auto start = Clock::now();
    const ReadScope scope(*database);
    list.clear();
    for (rows->MoveFirst(); !rows->Eof(); rows->MoveNext()) {
      auto entry = std::make_unique<QListWidgetItem>(
          QString::fromStdString(std::get<std::string>(rows->Fields("MissionName"))));
      entry->setData(Qt::UserRole, QVariant::fromValue(std::get<std::int64_t>(rows->Fields("ID"))));
      list.addItem(entry.release());
    }
    times.push_back(MicrosecondsSince(start));
  }
  return Median(times);
}

}  // namespace

/// bench-missions: saving must not become slow when there are many missions.
int main(int argc, char** argv) {
  QApplication application(argc, argv);
  const std::string file = (std::filesystem::temp_directory_path() / "tessarine-bench-missions.mdb").string();
  const double few = SaveTime(file, 100);
  const double many = SaveTime(file, 10'000);
  const double linear = FillTime(file, 100) * 100;
  std::filesystem::remove(file);
  return ReportGoal("save among 10,000 missions, less 100 x the filling of 100 / 100", (many - linear) / few,
                    3, TimesText(many - linear, few))
             ? 0
             : 1;
}
