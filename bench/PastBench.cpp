#include <benchmark/benchmark.h>
#include <unistd.h>

#include <QApplication>
#include <QDialog>
#include <QTableView>
#include <QWindow>
#include <cstdlib>
#include <filesystem>
#include <memory>

#include "archive/past/PastGames.h"
#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "bench/ManyGames.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtClock.h"
#include "tests/fakes/FakeOldDatabases.h"

namespace {

constexpr int PastGameCount = 100'000;
constexpr int MemberCount = 1000;

class NoBoxesHere : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string& text, const std::string&, BoxIcon, BoxButtons) override {
    std::fprintf(stderr, "%s\n", text.c_str());
    std::abort();
  }
};

class NoFileDialog : public FileDialog {
 public:
  std::optional<std::string> ShowOpen(const FileRequest&) override { return std::nullopt; }
  std::optional<std::string> ShowSave(const FileRequest&) override { return std::nullopt; }
  std::optional<std::string> ShowFolder(const FileRequest& /*request*/) override { return std::nullopt; }
};

/// A data folder with many past games, the latest of which has a file, and an open session on it.
class Site {
 public:
  Site() {
    std::string pattern = (std::filesystem::temp_directory_path() / "tessarine-bench-XXXXXX").string();
    path_ = mkdtemp(pattern.data());
    MakeMembers(path_ / "members.mdb", MemberCount);
    std::filesystem::copy_file(TESSARINE_PROGRAM_FOLDER "/scenarios_default.mdb", path_ / "scenarios.mdb");
    MakeArchive(path_ / "games.mdb");
    AddGames(path_ / "games.mdb", PastGameCount);
    if (!Session.Open({engine_, old_, Disk, path_.string(), TESSARINE_PROGRAM_FOLDER})) {
      std::abort();
    }
    Game game(Strings);
    FillCompletely(game);
    Archive->Archive().Keep({.Game = game, .Mission = "None", .Played = "2025-12-31 20:15:30"});
    Archive->Close();
  }
  ~Site() {
    Archive.reset();
    std::filesystem::remove_all(path_);
  }
  Site(const Site&) = delete;
  Site& operator=(const Site&) = delete;

  PastGames::Parts Parts() {
    return {.Archive = *Archive,
            .Time = Time,
            .Boxes = boxes_,
            .CommonDialog1 = dialog_,
            .Disk = Disk,
            .Strings = Strings,
            .NameOf = Archive->Names(),
            .MembersCalled = [](const std::string&) { return std::vector<std::int32_t>(); },
            .BoardIsUnsaved = [] { return false; },
            .Busy = [] { return std::optional<OwnText>(); },
            .ShowCharts = [](const PastGame&) {},
            .Export = [](const std::vector<std::int64_t>&) {}};
  }

 private:
  std::filesystem::path path_;
  SqliteEngine engine_;
  FakeOldDatabases old_;
  NoBoxesHere boxes_;
  NoFileDialog dialog_;

 public:
  const StringTable Strings{Language::English};
  const QtClock Time;
  LinuxFiles Disk;
  ::Session Session{Strings, Time, boxes_};
  std::unique_ptr<ArchiveAccess> Archive =
      std::make_unique<ArchiveAccess>(ArchiveAccess::Parts{.Session = Session,
                                                           .Disk = Disk,
                                                           .Engine = engine_,
                                                           .Strings = Strings,
                                                           .UserDataFolder = path_.string(),
                                                           .ProgramFolder = TESSARINE_PROGRAM_FOLDER});
};

/// Until the window is painted and nothing more is to do.
void ShowCompletely(QWidget& window) {
  window.show();
  while (window.windowHandle() == nullptr || !window.windowHandle()->isExposed()) {
    QApplication::processEvents();
  }
  QApplication::processEvents();
  window.repaint();
  QApplication::processEvents();
}

void ShowPast(benchmark::State& state, Site& site) {
  while (state.KeepRunning()) {
    PastGames window(site.Parts(), nullptr);
    ShowCompletely(window);
    if (window.findChild<QTableView*>(QStringLiteral("BoardTable"))->model()->rowCount() != PlayerCount) {
      std::abort();
    }
  }
}

void ShowEmpty(benchmark::State& state, Site& /*site*/) {
  while (state.KeepRunning()) {
    QDialog window;
    window.resize(1000, 680);
    ShowCompletely(window);
  }
}

}  // namespace

/// bench-past: the window of past games with 100,000 of them.
int main(int argc, char** argv) {
  const QApplication application(argc, argv);
  Site site;
  const auto add = [&site](const char* name, void (*run)(benchmark::State&, Site&)) {
    benchmark::RegisterBenchmark(name, [run, &site](benchmark::State& state) { run(state, site); });
  };
  add("Past", ShowPast);
  add("Empty", ShowEmpty);
  auto times = MedianTimes(argc, argv);
  constexpr double milliseconds = 1000;
  const double shown = times["Past"] - times["Empty"];
  const bool met = ReportGoal("Past Games of 100,000 after an empty window / 100 ms",
                              shown / (100 * milliseconds), 1, TimesText(shown, 100 * milliseconds));
  return met ? 0 : 1;
}
