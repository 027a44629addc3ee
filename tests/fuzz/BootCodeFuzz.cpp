#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <memory>
#include <string>

#include "firmware/download/FirmwareDownload.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/fakes/FakeWakeLock.h"

namespace {

using namespace std::chrono_literals;

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

/// Shows nothing, but knows what must hold at the end.
class NoDisplay : public FirmwareDisplay {
 public:
  bool Running = false;
  bool Complete = false;
  int Busy = 0;

  void SetStatus(const std::string&) override {}
  void SetDownload(const std::string& text) override { Complete = text == "Download Complete!"; }
  void SetCurrentBuffer(const std::string&) override {}
  void SetDigits(const std::string&) override {}
  void SetBar(double share) override { Require(share >= 0 && share <= 1); }
  void SetLamps(bool, bool) override {}
  void SetBreakCaption(const std::string&) override {}
  void EnableButtons(bool running) override { Running = running; }
  void SetBusy(bool busy) override { Busy += busy ? 1 : -1; }
  void SetSent(std::uint64_t sent, std::uint64_t all) override { Require(sent <= all); }
  void SetAdvice(const std::string&) override {}
};

constexpr std::array<const char*, 3> Names = {"/a.qvm", "/a.qvm2", "/a"};

/// The device: each byte of the input is an answer, or something that happens; they come one after the other
/// as long as the program sends. 0 is silence, 1 the operator's stop, 2 a closed window, 3 a lost line.
class Device {
 public:
  Device(const std::uint8_t* data, std::size_t size, FakeSerialPort& port, FakeEventPump& events,
         FirmwareDownload& download)
      : next_(data), left_(size), port_(port), events_(events), download_(download) {}

  void Act() {
    if (left_ == 0) {
      return;
    }
    --left_;
    switch (const std::uint8_t byte = *next_++) {
      case 0:
        break;
      case 1:
        download_.RequestAbort();
        break;
      case 2:
        download_.Close();
        break;
      case 3:
        port_.Lose();
        break;
      default:
        port_.Receive({byte});
    }
  }

  /// Acts again and again, as events do.
  void ActEvery(std::chrono::milliseconds time) {
    events_.At(time, [this, time] {
      Act();
      if (left_ > 0) {
        ActEvery(time);
      }
    });
  }

 private:
  const std::uint8_t* next_;
  std::size_t left_;
  FakeSerialPort& port_;
  FakeEventPump& events_;
  FirmwareDownload& download_;
};

}  // namespace

/// Whatever the device answers: the download ends, tells it by one box or the pair of a run-time failure, and
/// the next one works.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size == 0) {
    return 0;
  }
  FakeFiles files;
  files.Put("/a.qvm", ":0102\r\n:03\r\n:\r\n");
  files.Put("/a.qvm2", "1\r\n8\r\n0102\r\n");
  FakeEventPump events;
  FakeClock clock;
  FakeMessageBoxes boxes;
  FakeSerialPort port;
  FakeWakeLock awake;
  NoDisplay display;
  const StringTable strings(Language::English);
  FirmwareDownload download({.MSComm1 = port,
                             .Events = events,
                             .Boxes = boxes,
                             .Strings = strings,
                             .Awake = awake,
                             .Record = {.Disk = files, .Folder = "/logs", .Elapsed = events, .Time = clock}},
                            display);
  Device device(data + 1, size - 1, port, events, download);
  device.ActEvery(1ms);
  events.At(1h,
            [&download] { download.RequestAbort(); });  // from waiting for an announcement that never comes
  download.Run(Names[data[0] % Names.size()], [] { return "/dev/ttyS0"; });
  Require(boxes.Boxes.size() <= 2 && awake.Held == 0 && display.Busy == 0);
  Require(display.Complete == boxes.Boxes.empty());

  download.Close();
  events.Sleep(2h);
  boxes.Boxes.clear();
  port.OnOutput = [&port](std::uint8_t byte) {
    if (byte == 'X') {
      port.Receive({'x'});
    }
  };
  events.At(1ms, [&port] { port.Receive({'B', 'O', 'O', 'T'}); });
  download.Run("/a", [] { return "/dev/ttyS0"; });
  Require(display.Complete && !display.Running && boxes.Boxes.empty() && !port.PortOpen());
  return 0;
}
