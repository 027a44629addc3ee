#include <map>
#include <thread>

#include "platform/libreoffice/LibreOffice.h"
#include "sheets/ScoreSheets.h"
#include "tests/fakes/FakeSheetProgress.h"
#include "tests/soak/kills/DatabaseState.h"
#include "tests/soak/kills/Desk.h"
#include "tests/soak/kills/Work.h"

namespace {

/// Has no events to serve.
class SleepingPump : public EventPump {
 public:
  void DoEvents() override {}
  WaitResult WaitFor(const std::function<bool()>& condition, std::chrono::milliseconds limit) override {
    const auto end = std::chrono::steady_clock::now() + limit;
    while (!condition()) {
      if (std::chrono::steady_clock::now() >= end) {
        return WaitResult::TimedOut;
      }
      std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return WaitResult::Met;
  }
  void Sleep(std::chrono::milliseconds time) override { std::this_thread::sleep_for(time); }
  void EndWaits() override {}
};

/// Step numbers have three digits, so that sheets sort by them.
std::string MissionOf(int number) {
  const std::string digits = std::to_string(number);
  return "Step " + std::string(3 - digits.size(), '0') + digits;
}

/// The sheet of step `number`, as it is named for Red 0 without a member.
std::string SheetOf(int number) {
  return "Red 0-Guest-21 May 2013-" + MissionOf(number) + ".doc";
}

/// Each step is a run for one player, whose sheet is printed into a file.
class SheetWork : public Work {
 public:
  explicit SheetWork(WorkSources sources) : sources_(std::move(sources)) {}

  std::string Name() const override { return "sheet runs"; }
  std::chrono::milliseconds LongestLife() const override { return std::chrono::seconds(8); }
  int Share() const override { return 20; }
  int MostSteps() const override { return 200; }

  void Prepare(const std::filesystem::path& folder) override {
    PutDefaultDatabases(sources_, folder);
    std::filesystem::copy_file(sources_.ProgramFolder / "score_card_default.doc", folder / "score_card.doc");
  }

  void Run(const std::filesystem::path& folder, int first,
           const std::function<void(int step)>& report) override {
    Desk desk(sources_, folder, desk_.Text(131));
    desk.Games.Game().GameDate = "21/05/2013 14:30";
    desk.Games.Game().Players(1).Active = true;
    LibreOffice office(sources_.ProgramFolder);
    for (int number = first; number <= MostSteps(); ++number) {
      MakeSheet(desk, office, folder, number);
      report(number);
    }
  }

  std::string StateAfter(int steps) override {
    std::string sheets;
    for (int number = 1; number <= steps; ++number) {
      sheets += SheetOf(number) + "\n";
    }
    return sheets;
  }

  std::string StateIn(const std::filesystem::path& folder) override {
    std::map<std::string, bool> whole;
    if (std::filesystem::exists(folder / "scores")) {
      for (const auto& entry : std::filesystem::directory_iterator(folder / "scores")) {
        if (entry.path().extension() == ".doc") {
          whole[entry.path().filename()] = IsWhole(BytesOf(entry.path()));
        }
      }
    }
    std::string sheets;
    for (const auto& [name, isWhole] : whole) {
      if (!isWhole) {
        throw std::runtime_error("the sheet " + name + " is cut short in " + folder.string());
      }
      sheets += name + "\n";
    }
    return sheets;
  }

 private:
  void MakeSheet(Desk& desk, WordProcessor& office, const std::filesystem::path& folder, int number) {
    SleepingPump events;
    FakeSheetProgress progress;
    const SheetParts parts{.Game = desk.Games.Game(),
                           .RsMembers = desk.Games.RsMembers(),
                           .Members = desk.Games.Members(),
                           .Strings = desk.Strings,
                           .Time = desk.Time,
                           .Events = events,
                           .Disk = desk.Disk,
                           .Boxes = desk.Boxes,
                           .WordApp = office,
                           .UprightPicture = [](const std::string& photo) { return photo; },
                           .Progress = progress,
                           .UserDataFolder = folder,
                           .MissionName = MissionOf(number)};
    PrintChoice choice;
    choice.SheetSelection = SheetSelection::Active;
    choice.OutputTarget = OutputTarget::Files;
    ScoreSheets(parts, choice).GenerateScoreSheets();
    if (desk.Boxes.LatestText.find(desk.Strings.Text(OwnText::PdfOfSheetsFailed)) != std::string::npos) {
      throw std::runtime_error("the PDF of the sheet failed");
    }
  }

  /// The parts of such a file lie in any order, its directory often last; so its length must be what the
  /// table of its sectors says.
  static bool IsWhole(const std::string& bytes) {
    constexpr std::size_t sector = 512;
    constexpr std::size_t smallest = 8 * sector;
    return bytes.starts_with("\xD0\xCF\x11\xE0\xA1\xB1\x1A\xE1") && bytes.size() >= smallest &&
           bytes.size() % sector == 0 && DirectoryLiesInside(bytes, sector);
  }

  static bool DirectoryLiesInside(const std::string& bytes, std::size_t sector) {
    constexpr std::size_t placeOfDirectory = 48;
    std::size_t number = 0;
    for (std::size_t i = 4; i-- > 0;) {
      number = number * 256 + static_cast<unsigned char>(bytes[placeOfDirectory + i]);
    }
    const std::size_t start = (number + 1) * sector;
    // The first entry of the directory is always named so, two bytes a letter.
    return start + sector <= bytes.size() && bytes.substr(start, 8) == std::string("R\0o\0o\0t\0", 8);
  }

  WorkSources sources_;
  StringTable desk_{Language::English};
};

}  // namespace

std::unique_ptr<Work> MakeSheetWork(const WorkSources& sources) {
  return std::make_unique<SheetWork>(sources);
}
