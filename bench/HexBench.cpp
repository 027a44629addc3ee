#include <QCoreApplication>
#include <atomic>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <functional>
#include <string>
#include <thread>
#include <vector>

#include "bench/Goals.h"
#include "bench/PacedLoader.h"
#include "firmware/hex/HexImport.h"
#include "firmware/pic24f/PicComms.h"
#include "firmware/pic24f/PicFrame.h"
#include "firmware/pic24f/SerialPicBoot.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"

namespace {

using Seconds = std::chrono::duration<double>;

class NoBoxes : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string&, const std::string&, BoxIcon, BoxButtons) override {
    return BoxAnswer::Ok;
  }
};

/// A program of `bytes` bytes in records of 16.
std::string HexProgram(std::size_t bytes) {
  std::string text;
  const auto record = [&text](unsigned int type, unsigned int address,
                              const std::vector<unsigned int>& data) {
    unsigned int sum = static_cast<unsigned int>(data.size()) + address / 256 + address % 256 + type;
    char field[16];
    std::snprintf(field, sizeof field, ":%02X%04X%02X", static_cast<unsigned int>(data.size()), address,
                  type);
    text += field;
    for (const unsigned int byte : data) {
      sum += byte;
      std::snprintf(field, sizeof field, "%02X", byte);
      text += field;
    }
    std::snprintf(field, sizeof field, "%02X\r\n", (256 - sum % 256) % 256);
    text += field;
  };
  for (std::size_t at = 0; at < bytes; at += 16) {
    const auto address = static_cast<unsigned int>(at);
    if (address % 65536 == 0) {
      record(4, 0, {address >> 24U, address >> 16U & 255U});
    }
    std::vector<unsigned int> data(16);
    for (unsigned int i = 0; i < 16; ++i) {
      data[i] = i % 4 == 3 ? 0 : (address * 7 + i * 31) / 16 % 256;
    }
    record(0, address % 65536, data);
  }
  record(1, 0, {});
  return text;
}

double MedianOf(int runs, const std::function<void()>& action) {
  std::vector<double> times;
  for (int run = 0; run < runs; ++run) {
    const auto start = std::chrono::steady_clock::now();
    action();
    times.push_back(Seconds(std::chrono::steady_clock::now() - start).count());
  }
  return Median(times);
}

class Imports {
 public:
  explicit Imports(std::string folder) : folder_(std::move(folder)) {}

  double Time(std::size_t bytes) {
    files_.Write(Path("new.hex"), HexProgram(bytes));
    return MedianOf(7, [this] {
      ImportHexFile(files_, boxes_, Path("new.hex"),
                    {Path("progmem.img"), Path("eedata.img"), Path("config.img")});
    });
  }

  /// The tool that reads the same file and writes a text of its bytes; 0 where it is not installed.
  double TimeOfOtherTool() {
    const std::string command =
        "srec_cat " + Path("new.hex") + " -Intel -o " + Path("other.txt") + " -HEX_Dump";
    if (std::system((command + " 2>/dev/null").c_str()) != 0) {
      return 0;
    }
    return MedianOf(7, [&] { [[maybe_unused]] const int result = std::system(command.c_str()); });
  }

 private:
  std::string Path(const std::string& name) const { return folder_ + "/" + name; }

  std::string folder_;
  LinuxFiles files_;
  NoBoxes boxes_;
};

bool MeasureImport(const std::string& folder) {
  constexpr std::size_t program = std::size_t{256} * 1024;
  Imports imports(folder);
  const double ten = imports.Time(10 * program);
  const double one = imports.Time(program);
  const double other = imports.TimeOfOtherTool();
  char detail[80];
  std::snprintf(detail, sizeof detail, "%.1f ms to %.1f ms", ten * 1000, one * 1000);
  bool met = ReportGoal("import of ten times the HEX file / of one", ten / one, 12, detail);
  if (other > 0) {
    std::snprintf(detail, sizeof detail, "%.1f ms to %.1f ms", one * 1000, other * 1000);
    met &= ReportGoal("import of 256 KB / srec_cat", one / other, 3, detail);
  } else {
    std::puts("import of 256 KB / srec_cat: srec_cat is not installed");
  }
  return met;
}

bool MeasureWrite(const std::string& folder) {
  constexpr int baud = 115'200;
  constexpr double bitsOfByte = 10;
  PacedLoader loader(baud);
  LinuxFiles files;
  QtEventPump events;
  QtSerialPort port;
  NoBoxes boxes;
  files.Write(folder + "/new.hex", HexProgram(std::size_t{64} * 1024));
  ImportHexFile(files, boxes, folder + "/new.hex",
                {folder + "/progmem.img", folder + "/eedata.img", folder + "/config.img"});
  SerialPicBoot library(
      {.Port = port, .Events = events, .DeviceOf = [](const std::string& name) { return name; }});
  PicComms comms({.Library = library,
                  .Disk = files,
                  .Events = events,
                  .Folder = {folder, folder},
                  .ShowStatus = [](const std::string&) {}});
  comms.Settings.ErrorLog = "verify.log";
  comms.Device.ReadBlock = 4;
  comms.PortHandle = library.OpenPIC(loader.Device(), baud, 1000);
  const auto start = std::chrono::steady_clock::now();
  const std::int32_t code = comms.WriteRangeDevice(256, 2, PicCommand::WriteFlash, "progmem.img");
  const double time = Seconds(std::chrono::steady_clock::now() - start).count();
  library.ClosePIC(comms.PortHandle);
  const double wire = static_cast<double>(loader.BytesOnTheLine()) * bitsOfByte / baud;
  char detail[80];
  std::snprintf(detail, sizeof detail, "%.2f s to %.2f s, code %d", time, wire, code);
  return ReportGoal("write and verify 64 KB / wire", time / wire, 1.05, detail) && code == PicCode::Done;
}

}  // namespace

int main(int argc, char** argv) {
  const QCoreApplication application(argc, argv);
  const std::filesystem::path folder = std::filesystem::temp_directory_path() / "tessarine-bench-hex";
  std::filesystem::create_directories(folder);
  bool met = MeasureImport(folder.string());
  met &= MeasureWrite(folder.string());
  std::filesystem::remove_all(folder);
  return met ? 0 : 1;
}
