#include <QApplication>
#include <QLabel>
#include <QPushButton>
#include <QTimer>
#include <array>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include "bench/Goals.h"
#include "bench/PacedBootCode.h"
#include "bench/RealLine.h"
#include "core/data/IniReader.h"
#include "firmware/download/FirmwareFlash.h"
#include "firmware/files/FirmwareImage.h"
#include "firmware/files/HexConvert.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtClock.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeWakeLock.h"
#include "tests/support/TemporaryFolder.h"
#include "ui/Look.h"

namespace {

using Seconds = std::chrono::duration<double>;
using Clock = std::chrono::steady_clock;

/// A QVM2 file of `pages` pages from page 0 on, in lines of 64 bytes.
std::string Qvm2File(int pages) {
  std::string file;
  std::array<char, 8> text{};
  for (int page = 0; page < pages; ++page) {
    std::snprintf(text.data(), text.size(), "%X,", static_cast<unsigned int>(page));
    file += text.data();
  }
  file += "\r\n0\r\n";
  for (int byte = 0; byte < pages * 1536; ++byte) {
    std::snprintf(text.data(), text.size(), byte % 64 == 63 ? "%02X\r\n" : "%02X",
                  static_cast<unsigned int>(byte * 37 % 256));
    file += text.data();
  }
  return file;
}

/// Reads the file and converts its digits with a table, the least that any reader must do.
int ConvertAll(const LinuxFiles& files, const std::string& path, std::vector<std::uint8_t>& image) {
  const std::string bytes = files.Read(path);
  std::size_t stored = 0;
  for (std::size_t at = bytes.find('\n', bytes.find('\n') + 1) + 1; at + 1 < bytes.size(); at += 2) {
    if (bytes[at] != '\r') {
      image[stored++] = static_cast<std::uint8_t>(HexDigit(bytes[at]) * 16 + HexDigit(bytes[at + 1]));
    }
  }
  return image[stored - 1];
}

bool MeasureLoad(const TemporaryFolder& folder) {
  constexpr int rounds = 31;
  const LinuxFiles files;
  const std::string path = folder / "full.qvm2";
  WriteFile(path, Qvm2File(512));
  const auto image = std::make_unique<FirmwareImage>();
  std::vector<std::uint8_t> plain(image->ImageBuffer.size());
  std::vector<double> loads;
  std::vector<double> conversions;
  int sum = 0;
  for (int round = 0; round < rounds; ++round) {
    const auto start = Clock::now();
    image->LoadQvm2File(files.Read(path));
    const auto loaded = Clock::now();
    sum += ConvertAll(files, path, plain);
    conversions.push_back(Seconds(Clock::now() - loaded).count() * 1e6);
    loads.push_back(Seconds(loaded - start).count() * 1e6);
  }
  const bool same = std::equal(plain.begin(), plain.end() - 1, image->ImageBuffer.begin()) && sum > 0;
  const double load = Median(loads);
  const double conversion = Median(conversions);
  return ReportGoal("full QVM2 file / reading it and its digits by a table", load / conversion, 2,
                    TimesText(load, conversion)) &&
         same;
}

constexpr int LargeBytes = 200 << 20;

/// A file of 200 MB: ten of data, then nothing but zeros.
void WriteLargeFile(const std::string& path) {
  std::string lines = "0\r\n0\r\n";
  while (lines.size() < LargeBytes / 20) {
    lines += ":" + std::string(102, 'A') + "\r\n";
  }
  WriteFile(path, lines);
  std::filesystem::resize_file(path, LargeBytes);
}

/// The window on a real line.
class Site {
 public:
  Site(const TemporaryFolder& folder, const PacedBootCode& boot, const std::string& file)
      : folder_(folder), device_(boot.DevicePath()) {
    WriteFile(folder_ / "tessarine.ini", "[Paths]\nfirmware_path=" + (folder_ / file) + "\n");
    window_ = std::make_unique<FirmwareFlash>(FirmwareFlash::Parts{.MSComm1 = port_,
                                                                   .Devices = device_,
                                                                   .Ini = ini_,
                                                                   .Events = events_,
                                                                   .Boxes = boxes_,
                                                                   .Cd1 = dialog_,
                                                                   .Disk = files_,
                                                                   .Time = clock_,
                                                                   .Elapsed = events_,
                                                                   .Strings = strings_,
                                                                   .Awake = awake_,
                                                                   .LogFolder = folder_ / "logs"},
                                              nullptr);
    window_->show();
    events_.Sleep(std::chrono::milliseconds(500));
  }

  void Press(const char* button) { window_->findChild<QPushButton*>(QString::fromLatin1(button))->click(); }
  bool Refused() const { return boxes_.Boxes.size() == 1 && !port_.PortOpen(); }
  bool Complete() const {
    return window_->findChild<QLabel*>(QStringLiteral("lblDownload"))->text() ==
           QStringLiteral("Download Complete!");
  }

 private:
  const TemporaryFolder& folder_;
  StringTable strings_{Language::English};
  FakeMessageBoxes boxes_;
  FakeFileDialog dialog_;
  FakeWakeLock awake_;
  LinuxFiles files_;
  IniReader ini_{files_, folder_ / "tessarine.ini"};
  OneDevice device_;
  QtSerialPort port_;
  QtEventPump events_;
  QtClock clock_;
  std::unique_ptr<FirmwareFlash> window_;
};

/// A download from the announcement to its end, to the time that the wire and the answers take.
bool MeasureDownload(const char* name, double goal, const TemporaryFolder& folder, PacedBootCode& boot,
                     const std::string& file) {
  Site site(folder, boot, file);
  auto start = Clock::now();
  QTimer::singleShot(300, [&] {
    start = Clock::now();
    boot.Announce();
  });
  site.Press("cmdDownload");
  const double time = Seconds(Clock::now() - start).count();
  const double told = boot.ToldSeconds();
  std::array<char, 64> detail{};
  std::snprintf(detail.data(), detail.size(), "%.3f s to %.3f s", time, told);
  return ReportGoal(name, time / told, goal, detail.data()) && site.Complete();
}

/// How long the window does not answer while it refuses a file of 200 MB.
bool MeasureRefusal(const char* name, const TemporaryFolder& folder, const std::string& file) {
  constexpr double longestStall = 0.1;
  WriteLargeFile(folder / file);
  const PacedBootCode boot(0);
  Site site(folder, boot, file);
  const auto start = Clock::now();
  site.Press("cmdDownload");
  const double stall = Seconds(Clock::now() - start).count();
  std::array<char, 64> detail{};
  std::snprintf(detail.data(), detail.size(), "%.0f ms to %.0f ms", stall * 1e3, longestStall * 1e3);
  return ReportGoal(name, stall / longestStall, 1, detail.data()) && site.Refused();
}

bool MeasureWait(const TemporaryFolder& folder) {
  constexpr int waitMilliseconds = 5000;
  PacedBootCode boot(0);
  Site site(folder, boot, "four.qvm2");
  double processor = 0;
  auto start = Clock::now();
  QTimer::singleShot(300, [&] {  // the buttons have been painted
    start = Clock::now();
    processor = ProcessorSeconds(RUSAGE_THREAD);
  });
  double share = 1;
  QTimer::singleShot(waitMilliseconds, [&] {
    share = (ProcessorSeconds(RUSAGE_THREAD) - processor) / Seconds(Clock::now() - start).count();
    site.Press("cmdBreak");
  });
  site.Press("cmdDownload");
  return ReportGoal("processor time while a device is awaited", share, 0.01, "");
}

}  // namespace

int main(int argc, char** argv) {
  QApplication application(argc, argv);
  PrepareLook();
  const TemporaryFolder folder;
  std::filesystem::create_directory(folder / "logs");
  WriteFile(folder / "four.qvm2", Qvm2File(4));
  std::string lines;
  for (int line = 0; line < 60; ++line) {
    lines += ":" + std::string(102, 'A') + "\r\n";
  }
  WriteFile(folder / "sixty.qvm", lines);
  bool met = MeasureLoad(folder);
  PacedBootCode pages(0);
  met &= MeasureDownload("four pages of QVM2 / wire and answers", 1.02, folder, pages, "four.qvm2");
  PacedBootCode buffers(51);
  met &= MeasureDownload("60 lines of QVM / wire and answers", 1.05, folder, buffers, "sixty.qvm");
  met &= MeasureWait(folder);
  met &= MeasureRefusal("a QVM file of 200 MB, refused / 100 ms", folder, "large.qvm");
  met &= MeasureRefusal("a QVM2 file of 200 MB, refused / 100 ms", folder, "large.qvm2");
  return met ? 0 : 1;
}
