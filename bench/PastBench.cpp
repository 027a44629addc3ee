#include <benchmark/benchmark.h>
#include <unistd.h>

#include <QApplication>
#include <QClipboard>
#include <QDialog>
#include <QKeyEvent>
#include <QPushButton>
#include <QShortcut>
#include <QTableView>
#include <QWindow>
#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <map>
#include <memory>
#include <numeric>

#include "archive/history/Rankings.h"
#include "archive/past/PastGames.h"
#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "bench/ManyGames.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtClock.h"
#include "tests/fakes/FakeOldDatabases.h"
#include "tests/support/RandomGame.h"

namespace {

constexpr int PastGameCount = 100'000;
/// Those that have files: the others are rows alone.
constexpr int WholeGameCount = 500;
constexpr int MemberCount = 1000;
constexpr std::size_t ManyMembers = 1000;
constexpr const char* Year = "2023";

/// Whoever deletes is asked, and means it.
class BoxesThatAgree : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string& /*text*/, const std::string& /*title*/, BoxIcon, BoxButtons) override {
    return BoxAnswer::Ok;
  }
};

using SteadyClock = std::chrono::steady_clock;

double MicrosecondsSince(SteadyClock::time_point start) {
  return std::chrono::duration<double, std::micro>(SteadyClock::now() - start).count();
}

/// Notes the longest time in which no events were processed.
class WatchedPump : public EventPump {
 public:
  void DoEvents() override {
    Note();
    QApplication::processEvents();
    last_ = SteadyClock::now();
  }
  WaitResult WaitFor(const std::function<bool()>& /*condition*/, std::chrono::milliseconds) override {
    return WaitResult::Ended;
  }
  void Sleep(std::chrono::milliseconds /*time*/) override {}
  void EndWaits() override {}

  /// The longest such time of `act`, until the window is painted again, in microseconds.
  double LongestOf(const std::function<void()>& act) {
    longest_ = 0;
    last_ = SteadyClock::now();
    act();
    DoEvents();
    return longest_;
  }

 private:
  void Note() { longest_ = std::max(longest_, MicrosecondsSince(last_)); }

  SteadyClock::time_point last_;
  double longest_ = 0;
};

class NoFileDialog : public FileDialog {
 public:
  std::optional<std::string> ShowOpen(const FileRequest&) override { return std::nullopt; }
  std::optional<std::string> ShowSave(const FileRequest&) override { return std::nullopt; }
  std::optional<std::string> ShowFolder(const FileRequest& /*request*/) override { return std::nullopt; }
};

void Require(bool held, const char* what) {
  if (!held) {
    std::fprintf(stderr, "%s\n", what);
    std::abort();
  }
}

/// A data folder with many past games, the latest of which has a file, and an open session on it.
class Site {
 public:
  Site() {
    std::string pattern = (std::filesystem::temp_directory_path() / "tessarine-bench-XXXXXX").string();
    path_ = mkdtemp(pattern.data());
    MakeMembers(path_ / "members.mdb", MemberCount);
    BareSqlite(path_ / "members.mdb").Run("UPDATE Members SET TotalGamesPlayed = 3, TotalSoldiering = 5");
    std::filesystem::copy_file(TESSARINE_PROGRAM_FOLDER "/scenarios_default.mdb", path_ / "scenarios.mdb");
    MakeArchive(path_ / "games.mdb");
    AddGames(path_ / "games.mdb", PastGameCount);
    if (!Session.Open({engine_, old_, Disk, path_.string(), TESSARINE_PROGRAM_FOLDER})) {
      std::abort();
    }
    Archive =
        std::make_unique<ArchiveAccess>(ArchiveAccess::Parts{.Session = Session,
                                                             .Disk = Disk,
                                                             .Engine = engine_,
                                                             .Strings = Strings,
                                                             .UserDataFolder = path_.string(),
                                                             .ProgramFolder = TESSARINE_PROGRAM_FOLDER});
    Game game(Strings);
    FillCompletely(game);
    Archive->Archive().Keep({.Game = game, .Mission = "None", .Played = "2025-12-31 20:15:30"});
    KeepWholeGames();
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
            .Events = Events,
            .Strings = Strings,
            .MembersCalled = [](const std::string&) { return std::vector<std::int32_t>(); },
            .BoardIsUnsaved = [] { return false; },
            .Busy = [] { return std::optional<OwnText>(); },
            .ShowCharts = [](const PastGame&) {},
            .Export = [](const std::vector<std::int64_t>&) {}};
  }

 private:
  /// Games of 40 players, 20 a day.
  void KeepWholeGames() {
    constexpr int players = 40;
    constexpr int gamesOfADay = 20;
    Game game(Strings);
    FillRandomly(game, players, 7);
    for (int number = 1; number < WholeGameCount; ++number) {
      const int day = 10 + number / gamesOfADay % 18;
      const int month = 1 + number / gamesOfADay / 18;
      game.GameDate = "2025-0" + std::to_string(month);
      game.GameDate.append("-").append(std::to_string(day)).append(" 20:");
      game.GameDate.append(std::to_string(10 + number % gamesOfADay)).append(":00");
      Archive->Archive().Keep({.Game = game, .Mission = "None", .Played = game.GameDate});
    }
  }

  std::filesystem::path path_;
  SqliteEngine engine_;
  FakeOldDatabases old_;
  BoxesThatAgree boxes_;
  NoFileDialog dialog_;

 public:
  const StringTable Strings{Language::English};
  const QtClock Time;
  WatchedPump Events;
  LinuxFiles Disk;
  ::Session Session{Strings, Time, boxes_};
  std::unique_ptr<ArchiveAccess> Archive;
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

/// Asked for rows that come into view, and painted: the longest of many steps, in microseconds.
double LongestStepThrough(QTableView& list) {
  double longest = 0;
  const auto press = [&](Qt::Key key) {
    const auto start = SteadyClock::now();
    QKeyEvent down(QEvent::KeyPress, key, Qt::NoModifier);
    QApplication::sendEvent(&list, &down);
    list.window()->repaint();
    QApplication::processEvents();
    longest = std::max(longest, MicrosecondsSince(start));
  };
  constexpr int pages = 60;
  for (int page = 0; page < pages; ++page) {
    press(Qt::Key_PageDown);
  }
  for (const Qt::Key key : {Qt::Key_End, Qt::Key_PageUp, Qt::Key_Home, Qt::Key_Down}) {
    press(key);
  }
  return longest;
}

/// All games in the list, and what is done with all of them at once.
std::map<std::string, double> TimesOfAll(Site& site) {
  std::map<std::string, double> times;
  PastGames window(site.Parts(), nullptr);
  ShowCompletely(window);
  auto& months = *window.findChild<QTableView*>(QStringLiteral("MonthTable"));
  auto& games = *window.findChild<QTableView*>(QStringLiteral("GameTable"));
  times["All"] = site.Events.LongestOf([&] { months.selectRow(0); });
  Require(games.model()->rowCount() == PastGameCount + WholeGameCount, "not all games");
  times["Paging"] = LongestStepThrough(games);
  games.selectAll();
  const auto copy = games.findChildren<QShortcut*>().last();
  times["Copy"] = site.Events.LongestOf([&] { emit copy->activated(); });
  Require(QGuiApplication::clipboard()->text().count(QLatin1Char('\n')) == PastGameCount + WholeGameCount + 1,
          "not all rows copied");
  const auto click = [&](const char* button) {
    window.findChild<QPushButton*>(QString::fromLatin1(button))->click();
  };
  times["Export"] = site.Events.LongestOf([&] { click("Export"); });
  times["Delete"] = site.Events.LongestOf([&] { click("Delete"); });
  months.selectRow(months.model()->rowCount() - 1);
  games.selectAll();
  times["BringBack"] = site.Events.LongestOf([&] { click("BringBack"); });
  months.selectRow(0);
  Require(games.model()->rowCount() == PastGameCount + WholeGameCount, "not all games");
  return times;
}

/// The longest time between two steps of what is read.
template <typename Read>
double LongestStepOf(const Read& read) {
  auto last = SteadyClock::now();
  double longest = 0;
  const auto step = [&](double) {
    longest = std::max(longest, MicrosecondsSince(last));
    last = SteadyClock::now();
    return true;
  };
  Require(read(step).has_value(), "no ranking");
  step(1);
  return longest;
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
  bool met = ReportGoal("Past Games of 100,000 after an empty window / 100 ms", shown / (100 * milliseconds),
                        1, TimesText(shown, 100 * milliseconds));
  const auto within = [&times](const char* name, const char* what) {
    constexpr double limit = 100 * milliseconds;
    return ReportGoal(name, times[what] / limit, 1, TimesText(times[what], limit));
  };
  times.merge(TimesOfAll(site));
  met &= within("choosing all of 100,500 games / 100 ms", "All");
  met &= within("longest step of paging through them / 100 ms", "Paging");
  met &= within("longest pause of copying them / 100 ms", "Copy");
  met &= within("handing them to an export / 100 ms", "Export");
  met &= within("longest pause of deleting them / 100 ms", "Delete");
  met &= within("longest pause of bringing them back / 100 ms", "BringBack");
  times["Year"] = LongestStepOf(
      [&site](const RankingStep& goOn) { return FiguresInSteps(site.Archive->Statements(), Year, goOn); });
  met &= within("longest step of a year's ranking / 100 ms", "Year");
  times["AllTime"] = LongestStepOf([&site](const RankingStep& goOn) {
    return LifetimeInSteps(site.Session.DbMembers().Statements(), site.Archive->Statements(), goOn);
  });
  met &= within("longest step of the bests of all time / 100 ms", "AllTime");
  std::vector<std::int32_t> many(ManyMembers);
  std::iota(many.begin(), many.end(), 1);
  times["Search"] = LongestStepOf([&](const RankingStep& goOn) {
    return std::optional(site.Archive->Queries().Games({.Members = many}, goOn));
  });
  met &= within("longest step of a search for 1,000 members / 100 ms", "Search");
  return met ? 0 : 1;
}
