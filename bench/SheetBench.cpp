#include <unistd.h>

#include <QApplication>
#include <QBuffer>
#include <QImage>
#include <algorithm>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <map>

#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "bench/PlainSheets.h"
#include "core/data/Photo.h"
#include "platform/libreoffice/LibreOffice.h"
#include "platform/linux/ChildProcess.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtClock.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/UprightPicture.h"
#include "sheets/ScoreSheets.h"
#include "sheets/SheetProgressWindow.h"
#include "sheets/SheetTexts.h"

namespace {

using Steady = std::chrono::steady_clock;

constexpr int Members = 40;

double MillisecondsSince(Steady::time_point start) {
  return std::chrono::duration<double, std::milli>(Steady::now() - start).count();
}

/// Where a run's time goes, and the longest time without events processed, not counting single calls to the
/// word processor.
struct Times {
  std::map<std::string, double> ByKind;  ///< milliseconds
  double InCalls = 0;                    ///< milliseconds in calls since events were last processed
  double LongestGap = 0;
  Steady::time_point Served = Steady::now();

  template <typename Operation>
  auto Measure(const char* kind, bool isOneCall, Operation&& operation) {
    struct Adder {
      Times& All;
      const char* Kind;
      bool IsOneCall;
      Steady::time_point Start = Steady::now();
      ~Adder() {
        const double time = MillisecondsSince(Start);
        All.ByKind[Kind] += time;
        All.InCalls += IsOneCall ? time : 0;
      }
    } adder{*this, kind, isOneCall};
    return operation();
  }
};

class TimedPump : public QtEventPump {
 public:
  explicit TimedPump(Times& times) : times_(times) {}
  WaitResult WaitFor(const std::function<bool()>& condition, std::chrono::milliseconds limit) override {
    times_.LongestGap = std::max(times_.LongestGap, MillisecondsSince(times_.Served) - times_.InCalls);
    const WaitResult result = QtEventPump::WaitFor(condition, limit);
    times_.Served = Steady::now();
    times_.InCalls = 0;
    return result;
  }

 private:
  Times& times_;
};

class TimedDocument : public WordDocument {
 public:
  TimedDocument(std::unique_ptr<WordDocument> document, Times& times)
      : document_(std::move(document)), times_(times) {}
  void SetBookmark(const std::string& name, const std::string& text) override {
    times_.Measure("bookmarks", false, [&] { document_->SetBookmark(name, text); });
  }
  void WriteCells(int table, int firstRow, int rows, const std::vector<std::string>& texts) override {
    times_.Measure("tables", false, [&] { document_->WriteCells(table, firstRow, rows, texts); });
  }
  void ResizeRows(int table, int firstRow, int rows, const RowSizes& sizes) override {
    times_.Measure("letters", false, [&] { document_->ResizeRows(table, firstRow, rows, sizes); });
  }
  void AddPicture(int table, int row, int column, const std::string& file) override {
    times_.Measure("photographs", false, [&] { document_->AddPicture(table, row, column, file); });
  }
  void SaveAs(const std::string& path) override {
    times_.Measure("saving", true, [&] { document_->SaveAs(path); });
  }
  void ExportPdf(const std::string& path) override {
    times_.Measure("PDF", true, [&] { document_->ExportPdf(path); });
  }
  void PrintOut() override { document_->PrintOut(); }
  void Close() override {
    times_.Measure("closing", true, [&] { document_->Close(); });
  }

 private:
  std::unique_ptr<WordDocument> document_;
  Times& times_;
};

class TimedWord : public WordProcessor {
 public:
  TimedWord(WordProcessor& word, Times& times) : word_(word), times_(times) {}
  void Start() override { word_.Start(); }
  WordState State() override { return word_.State(); }
  std::unique_ptr<WordDocument> Add(const std::string& path) override {
    return std::make_unique<TimedDocument>(times_.Measure("template", true, [&] { return word_.Add(path); }),
                                           times_);
  }
  void JoinPdfs(const std::vector<std::string>& parts, const std::string& target,
                const std::function<void()>& onProgress) override {
    times_.Measure("joining PDFs", false, [&] { word_.JoinPdfs(parts, target, onProgress); });
  }
  void Quit() noexcept override { word_.Quit(); }

 private:
  WordProcessor& word_;
  Times& times_;
};

class SilentBoxes : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string& text, const std::string&, BoxIcon icon, BoxButtons) override {
    Failed = Failed || icon == BoxIcon::Exclamation;
    if (icon == BoxIcon::Exclamation) {
      std::fprintf(stderr, "%s\n", text.c_str());
    }
    return BoxAnswer::Ok;
  }
  bool Failed = false;
};

/// A photograph like one from a camera: 480 x 640, about 60 kB.
Blob Photograph(int member) {
  QImage image(480, 640, QImage::Format_RGB32);
  unsigned noise = static_cast<unsigned>(member);
  for (int y = 0; y < image.height(); ++y) {
    for (int x = 0; x < image.width(); ++x) {
      noise = noise * 1664525 + 1013904223;
      image.setPixel(x, y,
                     qRgb((x / 2 + static_cast<int>(noise >> 28)) % 256, (y / 3) % 256, (member * 6) % 256));
    }
  }
  QByteArray bytes;
  QBuffer buffer(&bytes);
  image.save(&buffer, "JPG", 90);
  return {bytes.begin(), bytes.end()};
}

/// A data folder with the template and forty members, and a game of 224 players who each hit `hitsPerPlayer`
/// others.
struct Evening {
  Evening(const std::filesystem::path& bin, int hitsPerPlayer) {
    std::string pattern = (std::filesystem::temp_directory_path() / "tessarine-bench-XXXXXX").string();
    Folder = mkdtemp(pattern.data());
    std::filesystem::copy_file(std::string(TESSARINE_RESOURCES) + "/score_card_default.doc",
                               Folder + "/score_card.doc");
    std::filesystem::create_directory(Folder + "/scores");
    std::filesystem::copy_file(bin / "members_default.mdb", Folder + "/members.mdb");
    AddMembers();
    for (int index = 1; index <= PlayerCount; ++index) {
      Player& player = Game.Players(index);
      player.Active = true;
      player.MemberIndex = 1 + index % Members;
      player.ShotCount = 1000 + index;
      for (int hit = 1; hit <= hitsPerPlayer; ++hit) {
        Game.Players(1 + (index + hit * 5) % PlayerCount).HitByPlayer(index) = 10 * hit;
      }
    }
    Game.GameDate = "15 November 2026";
  }
  ~Evening() { std::filesystem::remove_all(Folder); }
  Evening(const Evening&) = delete;
  Evening& operator=(const Evening&) = delete;

  StringTable Strings{Language::English};
  ::Game Game{Strings};
  std::string Folder;
  SilentBoxes Boxes;
  std::unique_ptr<Database> DbMembers;
  std::unique_ptr<Recordset> RsMembers;

 private:
  void AddMembers() {
    DbMembers = engine_.OpenDatabase(Folder + "/members.mdb");
    RsMembers = DbMembers->OpenRecordset("Members");
    for (int member = 1; member <= Members; ++member) {
      const Blob photo = Photograph(member);
      RsMembers->AddNew();
      RsMembers->SetField("FirstName", "First" + std::to_string(member));
      RsMembers->SetField("LastName", "Last" + std::to_string(member));
      RsMembers->SetField("NickName", "Nick" + std::to_string(member));
      RsMembers->SetField("PhotographLength", static_cast<std::int64_t>(photo.size()));
      RsMembers->AppendChunk("Photograph", photo);
      RsMembers->Update();
    }
  }

  SqliteEngine engine_;
};

/// Time for all 224 sheets made by the program, in milliseconds.
double OwnRun(Evening& evening, LibreOffice& office, std::int16_t target, Times& times) {
  MemberLookup members(*evening.RsMembers, evening.Boxes);
  const QtClock clock;
  TimedPump pump(times);
  LinuxFiles files;
  TimedWord word(office, times);
  SheetProgressWindow progress(evening.Strings, nullptr);
  const SheetParts parts{.Game = evening.Game,
                         .RsMembers = *evening.RsMembers,
                         .Members = members,
                         .Strings = evening.Strings,
                         .Time = clock,
                         .Events = pump,
                         .Disk = files,
                         .Boxes = evening.Boxes,
                         .WordApp = word,
                         .UprightPicture = UprightPicture,
                         .Progress = progress,
                         .UserDataFolder = evening.Folder,
                         .MissionName = "Bench"};
  const PrintChoice choice{SheetSelection::All, false, target, 0, 0};
  const auto start = Steady::now();
  times.Served = start;
  ScoreSheets(parts, choice).GenerateScoreSheets();
  return MillisecondsSince(start);
}

/// A separate LibreOffice for PlainSheets.
class PlainOffice {
 public:
  explicit PlainOffice(const std::string& host)
      : process_({host, LIBREOFFICE_PROGRAM "/soffice.bin", Name}, {.Input = leash_.ReadEnd.Number()}) {
    leash_.ReadEnd.Close();
  }
  ~PlainOffice() {
    leash_.WriteEnd.Close();
    process_.Wait();
  }
  PlainOffice(const PlainOffice&) = delete;
  PlainOffice& operator=(const PlainOffice&) = delete;

  std::string Name = "tessarine-plain-" + std::to_string(getpid());  ///< of the pipe on which it listens

 private:
  Pipe leash_;
  ChildProcess process_;
};

/// Time for all 224 sheets made by PlainSheets, in milliseconds, extrapolated from some of them.
double PlainRun(Evening& evening, const std::string& host) {
  const PlainOffice office(host);
  PlainSheets plain(office.Name);
  MemberLookup members(*evening.RsMembers, evening.Boxes);
  LinuxFiles files;
  const auto start = Steady::now();
  constexpr int step = 4;
  for (int index = 1; index <= PlayerCount; index += step) {
    PlainSheets::Sheet sheet;
    const auto add = [&sheet](const BookmarkTexts& texts) {
      sheet.Bookmarks.insert(sheet.Bookmarks.end(), texts.begin(), texts.end());
    };
    add(ResultTexts(evening.Game, index, WinningTeam(evening.Game)));
    const std::int32_t contactId = evening.Game.Players(index).MemberIndex;
    const std::optional<Member> member = members.LoadMember(contactId);
    add(MemberTexts(*member, members.LoadHistory(contactId)));
    sheet.Photo = files.MakeTempFileName();
    ExportPhoto(*evening.RsMembers, "Photograph", "PhotographLength", sheet.Photo, files);
    add(GameTexts(evening.Game.Players(index), "Bench", "15 November 2026", " 1"));
    sheet.Scored = HitsScored(evening.Game, index, members);
    sheet.Taken = HitsTaken(evening.Game, index, members);
    sheet.Target = evening.Folder + "/scores/plain " + std::to_string(index) + ".doc";
    plain.Make(evening.Folder + "/score_card.doc", sheet);
    files.Delete(sheet.Photo);
  }
  const double time = MillisecondsSince(start) * step;
  plain.Quit();
  return time;
}

/// Starts the word processor while processing events; returns the longest time without events processed, in
/// milliseconds.
double StartOffice(LibreOffice& office) {
  const auto start = Steady::now();
  double longest = 0;
  QtEventPump pump;
  for (bool ready = false; !ready;) {
    const auto step = Steady::now();
    office.Start();
    ready = office.State() == WordState::Ready;
    longest = std::max(longest, MillisecondsSince(step));
    pump.WaitFor([] { return false; }, std::chrono::milliseconds(50));
  }
  std::printf("The word processor is ready after %.1f s.\n", MillisecondsSince(start) / 1000);
  return longest;
}

}  // namespace

/// bench-sheets: needs LibreOffice.
int main(int argc, char** argv) {
  QApplication application(argc, argv);
  const std::filesystem::path bin = std::filesystem::canonical(argv[0]).parent_path();
  LibreOffice office(bin);
  Times times;
  times.LongestGap = StartOffice(office);
  bool met = true;
  double own = 0;
  double plain = 0;
  constexpr int usual = 40;
  for (const int hits : {usual, PlayerCount}) {
    Evening evening(bin, hits);
    times.ByKind.clear();
    constexpr std::int16_t neitherPrinterNorPdf = 0;
    own = OwnRun(evening, office, neitherPrinterNorPdf, times);
    plain = PlainRun(evening, bin / "tessarine-office-host");
    std::printf("%d hits dealt and taken: %.1f ms a sheet, in the plain way %.1f ms (ratio %.3f)\n", hits,
                own / PlayerCount, plain / PlayerCount, own / plain);
    for (const auto& [kind, time] : times.ByKind) {
      std::printf("  %-12s %6.1f ms a sheet\n", kind.c_str(), time / PlayerCount);
    }
    met &= !evening.Boxes.Failed;
  }
  Evening evening(bin, usual);
  const double toFiles = OwnRun(evening, office, OutputTarget::Files, times);
  std::printf("With a PDF of all: %.1f ms a sheet\n", toFiles / PlayerCount);
  constexpr double longestAllowed = 100;
  constexpr double thousand = 1000;
  met &= ReportGoal("224 sheets of the fullest game / a call per cell", own / plain, 0.5,
                    TimesText(own * thousand, plain * thousand));
  met &= ReportGoal("longest gap of the event loop / 100 ms", times.LongestGap / longestAllowed, 1,
                    TimesText(times.LongestGap * thousand, longestAllowed * thousand));
  return met ? 0 : 1;
}
