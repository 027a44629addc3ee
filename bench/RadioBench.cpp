#include <QApplication>
#include <QPushButton>
#include <QRadioButton>
#include <QTableView>
#include <chrono>
#include <cstdio>
#include <vector>

#include "app/Composition.h"
#include "bench/Goals.h"
#include "bench/RealLine.h"
#include "core/data/IniReader.h"
#include "devices/radio/RemoteManage.h"
#include "devices/radio/XBeeFrameParser.h"
#include "sim/game/GameMaker.h"
#include "sim/radio/RadioModem.h"
#include "ui/Look.h"

namespace {

using Seconds = std::chrono::duration<double>;

constexpr int Who = RUSAGE_THREAD;  // without the simulated modem, which has its own thread
constexpr int Guns = 40;
constexpr std::chrono::milliseconds AnswerTime(5);

/// At least a million bytes of answers that each hold a 90-byte block, as when scores are fetched.
std::vector<std::uint8_t> BlockAnswers() {
  constexpr std::size_t wanted = 1'000'000;
  std::vector<std::uint8_t> bytes;
  for (unsigned int frame = 0; bytes.size() < wanted; ++frame) {
    std::vector<std::uint8_t> body = {
        XBeeApi::Receive64, 0, 0x13, 0xA2, 0, 0x40, 1, 2, 3, 40, 0, 93, 33, 0, 0, 5, 2, 0, 89};
    for (unsigned int i = 0; i < 90; ++i) {
      body.push_back(static_cast<std::uint8_t>(i * 37 + frame));
    }
    unsigned int sum = 0;
    for (const std::uint8_t byte : body) {
      sum += byte;
    }
    bytes.insert(bytes.end(), {FrameStart, 0, static_cast<std::uint8_t>(body.size())});
    bytes.insert(bytes.end(), body.begin(), body.end());
    bytes.push_back(static_cast<std::uint8_t>(255 - (sum & 255)));
  }
  return bytes;
}

bool MeasureParser() {
  constexpr int rounds = 25;
  constexpr double goal = 100;  // MB/s
  const std::vector<std::uint8_t> bytes = BlockAnswers();
  std::vector<double> speeds;
  XBeeFrameParser parser;
  int frames = 0;
  for (int round = 0; round < rounds; ++round) {
    const auto start = std::chrono::steady_clock::now();
    for (const std::uint8_t byte : bytes) {
      frames += parser.Receive(byte) != 0 ? 1 : 0;
    }
    const Seconds time = std::chrono::steady_clock::now() - start;
    speeds.push_back(static_cast<double>(bytes.size()) / 1e6 / time.count());
  }
  const double speed = Median(speeds);
  char detail[64];
  std::snprintf(detail, sizeof detail, "%.0f MB/s, %d frames", speed, frames);
  return ReportGoal("100 MB/s / speed of the radio's frame parser", goal / speed, 1, detail);
}

/// The window on a real line, with 40 guns behind the modem.
class Site {
 public:
  Site() {
    window_.show();
    events_.Sleep(std::chrono::milliseconds(500));
    window_.findChild<QRadioButton*>(QStringLiteral("Guns224"))->setChecked(true);
  }

  Spent Press(const char* button) {
    const double processor = ProcessorSeconds(Who);
    const auto start = std::chrono::steady_clock::now();
    window_.findChild<QPushButton*>(QString::fromLatin1(button))->click();
    return {Seconds(std::chrono::steady_clock::now() - start).count(), ProcessorSeconds(Who) - processor};
  }

  sim::RadioModemTraffic Traffic() const { return modem_.Traffic(); }

  /// Number of guns with this status in the list.
  int CountOf(const QString& status) const {
    const QAbstractItemModel& list = *window_.findChild<QTableView*>(QStringLiteral("DataList"))->model();
    return static_cast<int>(
        list.match(list.index(0, 4), Qt::DisplayRole, status, -1, Qt::MatchExactly).size());
  }

 private:
  sim::RadioModem modem_{{.Guns = sim::MakeRadioGuns(sim::MakeGame(Guns, 1), AnswerTime)}};
  StringTable strings_{Language::English};
  Game game_{strings_};
  QtMessageBoxes boxes_{[this] { return &window_; }};
  LinuxFiles files_;
  IniReader ini_{files_, "/nowhere/tessarine.ini"};
  OneDevice device_{modem_.DevicePath()};
  QtSerialPort port_;
  QtEventPump events_;
  QtClock clock_;
  CommPort commPort_{port_, ini_, device_, boxes_, strings_, [] {}};
  RemoteManage window_{{port_, commPort_, events_, boxes_, clock_, strings_, game_}, nullptr};
};

bool MeasureSite() {
  constexpr double slotsOfSearch = 2 * 224 * 0.012;
  constexpr double baud = 57600;
  constexpr double bitsPerByte = 10;
  Site site;
  const Spent search = site.Press("SearchGunsButton");
  const sim::RadioModemTraffic before = site.Traffic();
  const int found = site.CountOf(QStringLiteral("Scores Pending"));
  char detail[100];
  std::snprintf(detail, sizeof detail, "%.3f s to %.3f s, %d guns", search.Wall, slotsOfSearch, found);
  bool met = ReportGoal("search of 224 ids, 40 guns / its slots", search.Wall / slotsOfSearch, 1.05, detail);
  std::snprintf(detail, sizeof detail, "%.0f ms in %.2f s", search.Processor * 1000, search.Wall);
  met &= ReportGoal("processor time of a search", search.Processor / search.Wall, 0.10, detail);

  const Spent fetch = site.Press("GetScoresButton");
  const sim::RadioModemTraffic after = site.Traffic();
  const double bytes = static_cast<double>(after.BytesFromHost - before.BytesFromHost + after.BytesToHost -
                                           before.BytesToHost);
  const double answers = static_cast<double>(after.Requests.size() - before.Requests.size());
  const double told = bytes * bitsPerByte / baud + answers * Seconds(AnswerTime).count();
  const int fetched = site.CountOf(QStringLiteral("Scores OK"));
  std::snprintf(detail, sizeof detail, "%.3f s to %.3f s, %d guns", fetch.Wall, told, fetched);
  met &= ReportGoal("scores of 40 guns by radio / wire and answers", fetch.Wall / told, 1.1, detail);
  return met && found == Guns && fetched == Guns;
}

}  // namespace

int main(int argc, char** argv) {
  QApplication application(argc, argv);
  PrepareLook();
  bool met = MeasureParser();
  met &= MeasureSite();
  return met ? 0 : 1;
}
