#include <fcntl.h>
#include <poll.h>
#include <stdlib.h>
#include <termios.h>
#include <unistd.h>

#include <QApplication>
#include <QComboBox>
#include <QPushButton>
#include <atomic>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <thread>
#include <vector>

#include "app/Composition.h"
#include "bench/Goals.h"
#include "bench/RealLine.h"
#include "core/data/IniReader.h"
#include "sound/ISD_rec.h"
#include "sound/SoundConversion.h"
#include "sound/SoundPages.h"
#include "ui/Look.h"

namespace {

using SteadyTime = std::chrono::steady_clock;
using Seconds = std::chrono::duration<double>;

constexpr int Who = RUSAGE_THREAD;  // without the hardware, which has its own thread
constexpr double BitsPerByte = 10;

/// Sound hardware that acknowledges everything, each byte of which takes its time on the line.
class PacedRecorder {
 public:
  PacedRecorder(Recorder recorder, double baud, Seconds eraseTime)
      : recorder_(recorder),
        byteTime_(std::chrono::duration_cast<SteadyTime::duration>(Seconds(BitsPerByte / baud))),
        eraseTime_(std::chrono::duration_cast<SteadyTime::duration>(eraseTime)),
        line_(::posix_openpt(O_RDWR | O_NOCTTY)) {
    grantpt(line_);
    unlockpt(line_);
    device_ = ptsname(line_);
    own_ = ::open(device_.c_str(), O_RDWR | O_NOCTTY);  // keeps the line alive between two opens
    termios settings{};
    tcgetattr(own_, &settings);
    cfmakeraw(&settings);
    tcsetattr(own_, TCSANOW, &settings);
    thread_ = std::thread([this] { Run(); });
  }
  ~PacedRecorder() {
    ends_ = true;
    thread_.join();
    ::close(own_);
    ::close(line_);
  }
  PacedRecorder(const PacedRecorder&) = delete;
  PacedRecorder& operator=(const PacedRecorder&) = delete;

  const std::string& Device() const { return device_; }
  int Pages() const { return pages_; }

 private:
  void Run() {
    while (!ends_) {
      pollfd waiting{line_, POLLIN, 0};
      std::uint8_t byte = 0;
      if (::poll(&waiting, 1, 20) == 1 && ::read(line_, &byte, 1) == 1) {
        arrived_ = std::max(arrived_, SteadyTime::now()) + byteTime_;
        Take(byte);
      }
    }
  }

  void Take(std::uint8_t byte) {
    command_.push_back(byte);
    if (dataLeft_ > 0) {
      if (command_.size() == 257) {
        --dataLeft_;
        ++pages_;
        Acknowledge();
      }
      return;
    }
    if (countComes_) {
      if (command_.size() == 2) {
        dataLeft_ = command_[0] + 256 * command_[1];
        countComes_ = false;
        command_.clear();
      }
      return;
    }
    const bool standAlone = recorder_ == Recorder::StandAlone;
    const std::size_t length = !standAlone && command_[0] == 1 ? 4 : 2;
    if (command_.size() < length) {
      return;
    }
    const std::uint8_t first = command_[0];
    if (length == 4) {
      dataLeft_ = 1;
      command_.clear();
      return;
    }
    countComes_ = first == 1;
    const bool erases = first == 2 && (!standAlone || started_);
    started_ = first == 2 || first == 10;
    Acknowledge();
    if (erases) {
      std::this_thread::sleep_for(eraseTime_);
      arrived_ = SteadyTime::now();
      Acknowledge();
    }
  }

  void Acknowledge() {
    command_.clear();
    arrived_ += byteTime_;
    std::this_thread::sleep_until(arrived_);
    constexpr std::uint8_t acknowledgement = 0xAA;
    if (::write(line_, &acknowledgement, 1) != 1) {
      std::perror("write");
    }
  }

  const Recorder recorder_;
  const SteadyTime::duration byteTime_;
  const SteadyTime::duration eraseTime_;
  int line_;
  int own_ = -1;
  std::string device_;
  SteadyTime::time_point arrived_;
  std::vector<std::uint8_t> command_;
  int dataLeft_ = 0;
  bool countComes_ = false;
  bool started_ = false;
  std::atomic<int> pages_ = 0;
  std::atomic<bool> ends_ = false;
  std::thread thread_;
};

/// Opens one play list.
class OneFile : public FileDialog {
 public:
  explicit OneFile(std::string path) : path_(std::move(path)) {}
  std::optional<std::string> ShowOpen(const FileRequest&) override { return path_; }
  std::optional<std::string> ShowSave(const FileRequest&) override { return std::nullopt; }
  std::optional<std::string> ShowFolder(const FileRequest&) override { return std::nullopt; }

 private:
  const std::string path_;
};

class NoWakeLock : public WakeLock {
 public:
  void Hold(const std::string&) override {}
  void Release() override {}
};

/// A folder for the sounds.
class Scratch {
 public:
  Scratch() { std::filesystem::create_directories(folder_); }
  ~Scratch() { std::filesystem::remove_all(folder_); }
  Scratch(const Scratch&) = delete;
  Scratch& operator=(const Scratch&) = delete;

  std::string Write(const std::string& name, const std::string& bytes) const {
    std::ofstream(folder_ / name, std::ios::binary) << bytes;
    return (folder_ / name).string();
  }
  std::string Path(const std::string& name) const { return (folder_ / name).string(); }

 private:
  const std::filesystem::path folder_ = std::filesystem::temp_directory_path() / "tessarine-bench-sounds";
};

std::string WaveOf(std::size_t samples) {
  return WaveBytes(std::vector<std::uint8_t>(samples, 100));
}

/// Time and processor time of a recording in the window, on a real line.
Spent Record(const Scratch& scratch, PacedRecorder& hardware, Recorder recorder, std::size_t pages) {
  const std::string sound = scratch.Write("sound.wav", WaveOf(pages * SoundChip::PageBytes));
  OneFile dialog(scratch.Write("list.txt", pages > 0 ? "\"" + sound + "\"\r\n" : ""));
  const StringTable strings(Language::English);
  LinuxFiles files;
  IniReader ini(files, "/nowhere/tessarine.ini");
  const OneDevice device(hardware.Device());
  QtSerialPort port;
  QtEventPump events;
  QtMessageBoxes boxes([] { return nullptr; });
  QtSoundPlayer player;
  const SndfileConverter converter;
  NoWakeLock awake;
  ISD_rec window({.MSComm1 = port,
                  .Ini = ini,
                  .Devices = device,
                  .Events = events,
                  .Elapsed = events,
                  .Boxes = boxes,
                  .CD = dialog,
                  .Disk = files,
                  .Player = player,
                  .Converter = converter,
                  .Awake = awake,
                  .Strings = strings,
                  .ProgramFolder = QCoreApplication::applicationDirPath().toStdString()},
                 nullptr);
  window.show();
  events.Sleep(std::chrono::milliseconds(500));
  window.findChild<QComboBox*>(QStringLiteral("RecorderSelect"))->setCurrentIndex(static_cast<int>(recorder));
  window.findChild<QPushButton*>(QStringLiteral("OpenList"))->click();
  const double processor = ProcessorSeconds(Who);
  const auto start = SteadyTime::now();
  window.findChild<QPushButton*>(QStringLiteral("RecordButton"))->click();
  return {Seconds(SteadyTime::now() - start).count(), ProcessorSeconds(Who) - processor};
}

bool MeasureStandAlone(const Scratch& scratch) {
  constexpr int pages = 100;
  constexpr double baud = 115200;
  PacedRecorder hardware(Recorder::StandAlone, baud, Seconds(0));
  const Spent spent = Record(scratch, hardware, Recorder::StandAlone, pages);
  const double bytes = 2 + 2 + 2 + 2 + pages * 257.0 + 2 + (5 + pages);
  const double told = bytes * BitsPerByte / baud + 0.010 + 0.010 + 0.030 + 0.040 + pages * 0.060 + 0.010;
  char detail[100];
  std::snprintf(detail, sizeof detail, "%.3f s to %.3f s, %d pages", spent.Wall, told, hardware.Pages());
  bool met = ReportGoal("100 pages stand alone / wire and pauses", spent.Wall / told, 1.03, detail);
  std::snprintf(detail, sizeof detail, "%.0f ms in %.2f s", spent.Processor * 1000, spent.Wall);
  met &= ReportGoal("processor time of a transfer, stand alone", spent.Processor / spent.Wall, 0.10, detail);
  return met && hardware.Pages() == pages;
}

bool MeasureInProduct(const Scratch& scratch) {
  constexpr int pages = 30;
  constexpr double baud = 19200;
  PacedRecorder hardware(Recorder::InProduct, baud, Seconds(0));
  const Spent spent = Record(scratch, hardware, Recorder::InProduct, pages);
  const double bytes = 2 + 2 + 4 + 1 + pages * 5.0 + 2 + (5 + pages);
  const double pauses = 0.010 + 0.010 + (0.020 + 0.040 + 0.256 + 0.020 + 0.020) + 0.040 +
                        pages * (0.020 + 0.040 + 0.256 + 0.020 + 0.020) + 0.010;
  const double told = bytes * BitsPerByte / baud + pauses;
  char detail[100];
  std::snprintf(detail, sizeof detail, "%.3f s to %.3f s, %d pages", spent.Wall, told, hardware.Pages() - 1);
  bool met = ReportGoal("30 pages in a product / wire and pauses", spent.Wall / told, 1.12, detail);
  std::snprintf(detail, sizeof detail, "%.0f ms in %.2f s", spent.Processor * 1000, spent.Wall);
  met &= ReportGoal("processor time of a transfer, in a product", spent.Processor / spent.Wall, 0.10, detail);
  return met && hardware.Pages() == pages + 1;
}

bool MeasureErase(const Scratch& scratch) {
  PacedRecorder hardware(Recorder::StandAlone, 115200, Seconds(10));
  const Spent spent = Record(scratch, hardware, Recorder::StandAlone, 0);
  char detail[64];
  std::snprintf(detail, sizeof detail, "%.1f ms in %.2f s", spent.Processor * 1000, spent.Wall);
  return ReportGoal("processor time of an erase", spent.Processor / spent.Wall, 0.01, detail);
}

template <typename Work>
double MedianSeconds(int rounds, const Work& work) {
  std::vector<double> times;
  for (int round = 0; round < rounds; ++round) {
    const auto start = SteadyTime::now();
    work();
    times.push_back(Seconds(SteadyTime::now() - start).count());
  }
  return Median(times);
}

bool MeasureUtilisation(const Scratch& scratch) {
  constexpr int rounds = 101;
  constexpr std::size_t rows = 60;
  const LinuxFiles files;
  QtMessageBoxes boxes([] { return nullptr; });
  WaveFile wave(files, boxes);
  SoundList list(files, wave);
  list.Fill(std::vector<std::string>(rows, "Event"));
  std::vector<std::string> paths;
  for (std::size_t row = 0; row < rows; ++row) {
    paths.push_back(scratch.Write(std::to_string(row) + ".wav", WaveOf(30'000)));
    list.AddSoundToList(paths.back(), row);
  }
  const double reckoning = MedianSeconds(rounds, [&] { list.Reckon(); });
  const double reading = MedianSeconds(rounds, [&] {
    for (const std::string& path : paths) {
      char bytes[64];
      const int file = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
      if (::read(file, bytes, sizeof bytes) != sizeof bytes) {
        std::perror("read");
      }
      ::close(file);
    }
  });
  return ReportGoal("utilisation of 60 files / opening and reading them", reckoning / reading, 3,
                    TimesText(reckoning * 1e6, reading * 1e6));
}

/// 60 seconds of a sweep in stereo, 16 bits at 48 kHz.
std::string StereoWave() {
  constexpr int rate = 48000;
  constexpr int seconds = 60;
  std::string samples;
  double phase = 0;
  for (int i = 0; i < rate * seconds; ++i) {
    phase += 0.01 + 2.5 * i / (rate * seconds);
    const auto value = static_cast<std::int16_t>(20000 * std::sin(phase));
    for (int channel = 0; channel < 2; ++channel) {
      samples.append(reinterpret_cast<const char*>(&value), sizeof value);
    }
  }
  const auto little = [](std::uint32_t value) {
    return std::string(reinterpret_cast<const char*>(&value), 4);
  };
  return "RIFF" + little(static_cast<std::uint32_t>(36 + samples.size())) + "WAVEfmt " + little(16) +
         little(0x0002'0001) + little(rate) + little(rate * 4) + little(0x0010'0004) + "data" +
         little(static_cast<std::uint32_t>(samples.size())) + samples;
}

bool MeasureConversion(const Scratch& scratch) {
  constexpr int rounds = 3;
  const std::string path = scratch.Write("stereo.wav", StereoWave());
  const SndfileConverter converter;
  const double ours = MedianSeconds(
      rounds, [&] { converter.Convert(path, SoundChip::SamplesPerSecond, [](double) { return true; }); });
  const std::string command =
      "sndfile-resample -to 22050 -c 0 '" + path + "' '" + scratch.Path("other.wav") + "' > /dev/null";
  int failed = 0;
  const double others = MedianSeconds(rounds, [&] { failed |= std::system(command.c_str()); });
  return ReportGoal("conversion of a minute / sndfile-resample", ours / others, 3,
                    TimesText(ours * 1e6, others * 1e6)) &&
         failed == 0;
}

}  // namespace

int main(int argc, char** argv) {
  QApplication application(argc, argv);
  PrepareLook();
  const Scratch scratch;
  bool met = MeasureStandAlone(scratch);
  met &= MeasureInProduct(scratch);
  met &= MeasureErase(scratch);
  met &= MeasureUtilisation(scratch);
  met &= MeasureConversion(scratch);
  return met ? 0 : 1;
}
