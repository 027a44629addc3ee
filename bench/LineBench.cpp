#include <QApplication>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <optional>
#include <vector>

#include "app/Composition.h"
#include "app/UploadProgress.h"
#include "bench/Goals.h"
#include "bench/RealLine.h"
#include "devices/baseunit/BaseUnitDownload.h"
#include "sim/baseunit/BaseUnit.h"
#include "sim/game/GameMaker.h"

namespace {

using Seconds = std::chrono::duration<double>;

constexpr double Baud = 19200;
constexpr double BitsPerByte = 10;

/// Answers every box at once.
class SilentBoxes : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string&, const std::string&, BoxIcon, BoxButtons) override {
    return BoxAnswer::Cancel;
  }
};

/// One download with the real line, event loop and progress window, and with a transcript where there is a
/// folder for it.
Spent Download(const sim::BaseUnit& unit, const std::string& logFolder = {}) {
  const StringTable strings(Language::English);
  Game game(strings);
  SilentBoxes boxes;
  LinuxFiles files;
  const IniReader ini(files, "/nowhere/tessarine.ini");
  const OneDevice device(unit.DevicePath());
  QtSerialPort port;
  QtEventPump events;
  const QtClock clock;
  std::optional<LoggedPort> logged;
  if (!logFolder.empty()) {
    logged.emplace(port, LoggedPort::Parts{files, logFolder, events, clock}, "line");
  }
  SerialPort& line = logged ? static_cast<SerialPort&>(*logged) : port;
  CommPort commPort(line, ini, device, boxes, strings, [] {});
  UploadProgress progress(strings, nullptr);
  DownloadedGuns guns(game);
  const double processor = ProcessorSeconds(RUSAGE_SELF);
  const auto start = std::chrono::steady_clock::now();
  BaseUnitDownload(line, commPort, events, boxes, clock, progress, guns).GetScores();
  return {Seconds(std::chrono::steady_clock::now() - start).count(),
          ProcessorSeconds(RUSAGE_SELF) - processor};
}

bool MeasureDownload() {
  constexpr int players = 40;
  const sim::BaseUnit unit({.Answer = sim::MakeBaseUnitAnswer(sim::MakeGame(players, 1))});
  const Spent spent = Download(unit);
  const auto exchange = unit.LatestExchange();
  const double bytes = 2.0 + static_cast<double>(exchange.Sent.size() + exchange.Replies.size());
  const double told = bytes * BitsPerByte / Baud + 0.020 + players * 0.050;
  char detail[64];
  std::snprintf(detail, sizeof detail, "%.3f s to %.3f s", spent.Wall, told);
  return ReportGoal("download of 40 players / wire and pauses", spent.Wall / told, 1.02, detail);
}

bool MeasureTimeOut(const char* name, std::size_t silentFrom) {
  const sim::BaseUnit unit(
      {.Answer = sim::MakeBaseUnitAnswer(sim::MakeGame(2, 1), sim::BaseUnitFailure::Silence, silentFrom)});
  const Spent spent = Download(unit);
  char detail[64];
  std::snprintf(detail, sizeof detail, "%.1f ms in %.2f s", spent.Processor * 1000, spent.Wall);
  return ReportGoal(name, spent.Processor / spent.Wall, 0.01, detail);
}

/// Downloads with it and without, in pairs whose order changes, so that whatever else the machine does meets
/// both alike. The ratio is that of the median pair.
bool MeasureTranscript() {
  constexpr int players = 40;
  constexpr int pairs = 15;
  const sim::BaseUnit unit({.Answer = sim::MakeBaseUnitAnswer(sim::MakeGame(players, 1))});
  const std::filesystem::path folder = std::filesystem::temp_directory_path() / "tessarine-bench-logs";
  std::vector<double> with;
  std::vector<double> without;
  std::vector<double> ratios;
  for (int pair = 0; pair < pairs; ++pair) {
    for (const bool logs : {pair % 2 == 0, pair % 2 != 0}) {
      (logs ? with : without).push_back(Download(unit, logs ? folder.string() : "").Processor);
    }
    ratios.push_back(with.back() / without.back());
  }
  const std::uintmax_t logged = std::filesystem::file_size(folder / "base-unit.log");
  std::filesystem::remove_all(folder);
  char detail[80];
  std::snprintf(detail, sizeof detail, "%.2f ms to %.2f ms, %.0f bytes of log each", Median(with) * 1000,
                Median(without) * 1000, static_cast<double>(logged) / pairs);
  return ReportGoal("download with transcript / without, processor time", Median(ratios), 1.01, detail);
}

}  // namespace

int main(int argc, char** argv) {
  QApplication application(argc, argv);
  bool met = MeasureDownload();
  met &= MeasureTimeOut("processor time of a time-out before the count", 1);
  met &= MeasureTimeOut("processor time of a time-out in mid-frame", 20);
  met &= MeasureTranscript();
  return met ? 0 : 1;
}
