#include <benchmark/benchmark.h>
#include <sqlite3.h>
#include <unistd.h>

#include <QApplication>
#include <QBuffer>
#include <QFile>
#include <QImageReader>
#include <QPushButton>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <memory>

#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "core/data/Photo.h"
#include "core/game/CommitGame.h"
#include "members/MemberListView.h"
#include "members/MemberQueries.h"
#include "members/Members.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtClock.h"

namespace {

constexpr int ManyMembers = 100'000;
constexpr int VenueMembers = 1000;  ///< 224 of them play

class NoBoxes : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string& text, const std::string&, BoxIcon, BoxButtons) override {
    std::fprintf(stderr, "%s\n", text.c_str());
    std::abort();
  }
};

class NoDialog : public FileDialog {
 public:
  std::optional<std::string> ShowOpen(const FileRequest&) override { return std::nullopt; }
  std::optional<std::string> ShowSave(const FileRequest&) override { return std::nullopt; }
  std::optional<std::string> ShowFolder(const FileRequest&) override { return std::nullopt; }
};

/// The files used by one run of this benchmark.
class Folder {
 public:
  Folder() {
    std::string pattern = (std::filesystem::temp_directory_path() / "tessarine-bench-XXXXXX").string();
    path_ = mkdtemp(pattern.data());
    MakeMembers(Members(), ManyMembers);
    MakeMembers(Venue(), VenueMembers);
  }
  ~Folder() { std::filesystem::remove_all(path_); }
  Folder(const Folder&) = delete;
  Folder& operator=(const Folder&) = delete;

  std::string Members() const { return path_ / "members.mdb"; }
  std::string Venue() const { return path_ / "venue.mdb"; }
  std::string Photo() const { return path_ / "photo.jpg"; }

 private:
  std::filesystem::path path_;
};

/// SQLite used directly, as durable as our own layer.
class Engine {
 public:
  explicit Engine(const std::string& path) {
    sqlite3_open(path.c_str(), &handle_);
    Run("PRAGMA synchronous = EXTRA");
  }
  ~Engine() { sqlite3_close(handle_); }
  Engine(const Engine&) = delete;
  Engine& operator=(const Engine&) = delete;

  void Run(const std::string& sql) {
    if (sqlite3_exec(handle_, sql.c_str(), nullptr, nullptr, nullptr) != SQLITE_OK) {
      std::fprintf(stderr, "%s\n", sqlite3_errmsg(handle_));
      std::abort();
    }
  }

  int RowsOf(const std::string& sql) {
    sqlite3_stmt* statement = nullptr;
    sqlite3_prepare_v2(handle_, sql.c_str(), -1, &statement, nullptr);
    int rows = 0;
    for (; sqlite3_step(statement) == SQLITE_ROW; ++rows) {
      benchmark::DoNotOptimize(sqlite3_column_text(statement, 2));
    }
    sqlite3_finalize(statement);
    return rows;
  }

 private:
  sqlite3* handle_ = nullptr;
};

void Search(benchmark::State& state, const Folder& folder, const std::string& text) {
  SqliteEngine engine;
  const auto database = engine.OpenDatabase(folder.Members());
  while (state.KeepRunning()) {
    const auto rows = database->OpenRecordset(SearchQuery(text));
    ReadDetails(*rows);
  }
}

void SearchInEngine(benchmark::State& state, const Folder& folder, const std::string& text) {
  Engine engine(folder.Members());
  std::string sql = SearchQuery(text);
  for (std::size_t at = sql.find("*'"); at != std::string::npos; at = sql.find("*'")) {
    sql[at] = '%';
  }
  while (state.KeepRunning()) {
    const int rows = engine.RowsOf(sql);
    if (rows == 0) {
      std::abort();
    }
  }
}

void Commit(benchmark::State& state, const Folder& folder) {
  const StringTable strings(Language::English);
  Game game(strings);
  FillCompletely(game);
  NoBoxes boxes;
  const QtClock clock;
  SqliteEngine engine;
  const auto database = engine.OpenDatabase(folder.Venue());
  const auto rows = database->OpenRecordset("Members");
  MemberLookup members(*rows, boxes);
  while (state.KeepRunning()) {
    for (int index = 1; index <= PlayerCount; ++index) {
      game.Players(index).MemberIndex = index * (VenueMembers / PlayerCount);
      game.Players(index).Committed = false;
    }
    if (CommitPlayers(game, *database, *rows, members, clock) != CommitResult::Committed) {
      std::abort();
    }
  }
}

void DurableTransaction(benchmark::State& state, const Folder& folder) {
  Engine engine(folder.Venue());
  int member = 0;
  while (state.KeepRunning()) {
    member = member % VenueMembers + 1;
    engine.Run("UPDATE Members SET TotalGamesPlayed = TotalGamesPlayed + 1 WHERE ContactID = " +
               std::to_string(member));
  }
}

/// Creates a photograph of about 100 KB, like one from a camera.
void MakePhoto(const std::string& path) {
  QImage image(900, 700, QImage::Format_RGB32);
  unsigned noise = 1;
  for (int y = 0; y < image.height(); ++y) {
    for (int x = 0; x < image.width(); ++x) {
      noise = noise * 1664525 + 1013904223;
      const int grain = static_cast<int>(noise >> 28U);
      image.setPixelColor(x, y, QColor(x * 200 / 900 + grain, y * 200 / 700 + grain, 120 + grain));
    }
  }
  QByteArray bytes;
  for (int quality = 95; quality > 5; --quality) {
    bytes.clear();
    QBuffer buffer(&bytes);
    image.save(&buffer, "JPG", quality);
    constexpr qsizetype largest = 100'000;
    if (bytes.size() <= largest) {
      break;
    }
  }
  LinuxFiles().Write(path, bytes.toStdString());
}

/// Stores the photograph for the first members.
void StorePhotos(const Folder& folder) {
  NoBoxes boxes;
  SqliteEngine engine;
  const auto database = engine.OpenDatabase(folder.Members());
  const auto rows = database->OpenRecordset("Members");
  WriteScope group(*database);
  for (int member = 0; member < 10; ++member, rows->MoveNext()) {
    rows->Edit();
    StorePhoto(folder.Photo(), *rows, "Photograph", "PhotographLength", LinuxFiles(), boxes);
    rows->Update();
  }
  group.Commit();
}

/// A window that has just opened still reads the small pictures of its list.
void LetListSettle() {
  constexpr std::chrono::milliseconds enough{800};
  const auto end = std::chrono::steady_clock::now() + enough;
  while (std::chrono::steady_clock::now() < end) {
    QApplication::processEvents();
  }
}

/// Moves to the next member and back; each is painted.
void NextMember(benchmark::State& state, const Folder& folder) {
  const StringTable strings(Language::English);
  NoBoxes boxes;
  NoDialog dialog;
  const LinuxFiles disk;
  const QtClock clock;
  SqliteEngine engine;
  const auto database = engine.OpenDatabase(folder.Members());
  Members window({.DbMembers = *database,
                  .Boxes = boxes,
                  .CommonDialog1 = dialog,
                  .Disk = disk,
                  .Time = clock,
                  .Strings = strings},
                 nullptr);
  window.show();
  LetListSettle();
  auto* next = window.findChild<QPushButton*>(QStringLiteral("DataNext"));
  auto* previous = window.findChild<QPushButton*>(QStringLiteral("DataPrevious"));
  next->setFocus();
  for (bool forth = true; state.KeepRunning(); forth = !forth) {
    (forth ? next : previous)->click();
    QApplication::processEvents();
  }
}

/// Lists the members found for a text, as after a pause in typing, and paints the list.
void ListMembers(benchmark::State& state, const Folder& folder, const std::string& text) {
  const StringTable strings(Language::English);
  SqliteEngine engine;
  const auto database = engine.OpenDatabase(folder.Members());
  MemberListView list(nullptr);
  list.SetUp(*database, strings);
  list.resize(320, 900);
  list.show();
  QApplication::processEvents();
  while (state.KeepRunning()) {
    list.Search(text);
    list.ShowMember(1);
    QApplication::processEvents();
  }
}

void DecodeFile(benchmark::State& state, const Folder& folder) {
  const QString path = QString::fromStdString(folder.Photo());
  while (state.KeepRunning()) {
    QFile file(path);
    file.open(QIODevice::ReadOnly);
    QByteArray bytes = file.readAll();
    QBuffer buffer(&bytes);
    if (QImageReader(&buffer).read().isNull()) {
      std::abort();
    }
  }
}

}  // namespace

/// bench-members: the members' window and the commit with 100,000 members.
int main(int argc, char** argv) {
  QApplication application(argc, argv);
  const Folder folder;
  MakePhoto(folder.Photo());
  StorePhotos(folder);
  const auto add = [&folder](const char* name, auto* run, auto... arguments) {
    benchmark::RegisterBenchmark(
        name, [run, &folder, arguments...](benchmark::State& state) { run(state, folder, arguments...); });
  };
  add("Search/many", Search, "last9");
  add("SearchInEngine/many", SearchInEngine, "last9");
  add("Search/few", Search, "nick777");
  add("SearchInEngine/few", SearchInEngine, "nick777");
  add("Commit", Commit);
  add("DurableTransaction", DurableTransaction);
  add("NextMember", NextMember);
  add("DecodeFile", DecodeFile);
  add("ListMembers/all", ListMembers, "");
  add("ListMembers/many", ListMembers, "l");
  add("ListMembers/scan", ListMembers, "é");
  auto times = MedianTimes(argc, argv);
  const auto report = [&times](const char* name, const char* what, const char* limit, double goal) {
    return ReportGoal(name, times[what] / times[limit], goal, TimesText(times[what], times[limit]));
  };
  bool met =
      report("search with 11,111 hits in 100,000 members / engine", "Search/many", "SearchInEngine/many", 3);
  met &= report("  with 56 hits / engine", "Search/few", "SearchInEngine/few", 3);
  met &= report("commit of 224 members / one durable transaction", "Commit", "DurableTransaction", 5);
  met &= report("next member with a photo of 100 KB / from a file", "NextMember", "DecodeFile", 2);
  constexpr double listLimit = 100'000;  // microseconds
  for (const auto& [what, name] : {std::pair{"ListMembers/all", "list of 100,000 members / 100 ms"},
                                   {"ListMembers/many", "  of those found by one letter / 100 ms"},
                                   {"ListMembers/scan", "  without an index / 100 ms"}}) {
    met &= ReportGoal(name, times[what] / listLimit, 1, TimesText(times[what], listLimit));
  }
  return met ? 0 : 1;
}
