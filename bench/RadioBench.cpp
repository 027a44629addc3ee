#include <fcntl.h>
#include <sys/resource.h>
#include <termios.h>
#include <unistd.h>

#include <QApplication>
#include <QPushButton>
#include <QRadioButton>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <stdexcept>
#include <vector>

#include "app/Composition.h"
#include "bench/Goals.h"
#include "core/IniReader.h"
#include "devices/FrameParser.h"
#include "devices/RemoteManage.h"

namespace {

using Seconds = std::chrono::duration<double>;

double ProcessorSeconds() {
  rusage usage{};
  getrusage(RUSAGE_SELF, &usage);
  return static_cast<double>(usage.ru_utime.tv_sec + usage.ru_stime.tv_sec) +
         static_cast<double>(usage.ru_utime.tv_usec + usage.ru_stime.tv_usec) / 1e6;
}

/// Answers with a block of 90 bytes, as fetching scores brings them, a million bytes or a little more.
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
  FrameParser parser;
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

/// A pseudo terminal at whose far end nobody answers.
class SilentLine {
 public:
  SilentLine() : master_(::posix_openpt(O_RDWR | O_NOCTTY | O_NONBLOCK)) {
    if (master_ < 0 || ::grantpt(master_) != 0 || ::unlockpt(master_) != 0) {
      throw std::runtime_error("No pseudo terminal");
    }
  }
  ~SilentLine() { ::close(master_); }
  SilentLine(const SilentLine&) = delete;
  SilentLine& operator=(const SilentLine&) = delete;

  std::string Device() const { return ::ptsname(master_); }

  void Drain() const {
    char bytes[4096];
    while (::read(master_, bytes, sizeof bytes) > 0) {
    }
  }

 private:
  int master_;
};

class OneDevice : public SerialDevices {
 public:
  explicit OneDevice(std::string device) : device_(std::move(device)) {}
  std::vector<std::string> Names() const override { return {device_}; }
  bool Exists(const std::string& device) const override { return device == device_; }

 private:
  std::string device_;
};

bool MeasureSearch() {
  constexpr double told = 2 * 224 * 0.012;
  const SilentLine line;
  const StringTable strings(Language::English);
  Game game(strings);
  QtMessageBoxes boxes;
  LinuxFiles files;
  const IniReader ini(files, "/nowhere/tessarine.ini");
  const OneDevice device(line.Device());
  QtSerialPort port;
  QtEventPump events;
  const QtClock clock;
  CommPort commPort(port, ini, device, boxes, strings, [] {});
  RemoteManage window({port, commPort, events, boxes, clock, strings, game}, nullptr);
  window.show();
  events.Sleep(std::chrono::milliseconds(500));
  window.findChild<QRadioButton*>(QStringLiteral("Guns224"))->setChecked(true);
  const double processor = ProcessorSeconds();
  const auto start = std::chrono::steady_clock::now();
  window.findChild<QPushButton*>(QStringLiteral("SearchGunsButton"))->click();
  const double wall = Seconds(std::chrono::steady_clock::now() - start).count();
  const double used = ProcessorSeconds() - processor;
  line.Drain();
  char detail[64];
  std::snprintf(detail, sizeof detail, "%.3f s to %.3f s", wall, told);
  bool met = ReportGoal("search of 224 ids without a gun / its slots", wall / told, 1.05, detail);
  std::snprintf(detail, sizeof detail, "%.0f ms in %.2f s", used * 1000, wall);
  met &= ReportGoal("processor time of that search", used / wall, 0.10, detail);
  return met;
}

}  // namespace

int main(int argc, char** argv) {
  QApplication application(argc, argv);
  PrepareApplication();
  bool met = MeasureParser();
  met &= MeasureSearch();
  return met ? 0 : 1;
}
