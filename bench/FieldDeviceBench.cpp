#include <QApplication>
#include <algorithm>
#include <chrono>
#include <cstdio>
#include <vector>

#include "bench/Goals.h"
#include "bench/PacedTerminal.h"
#include "bench/RealLine.h"
#include "devices/box/BoxConfig.h"
#include "devices/buttons/SerialOneWire.h"
#include "devices/charging/ChargeiButton.h"
#include "platform/qt/QtClock.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"
#include "tests/devices/buttons/ModelAdapter.h"
#include "tests/devices/charging/ButtonsBehindChip.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "ui/Look.h"

namespace {

using std::chrono::microseconds;
using Clock = std::chrono::steady_clock;
using Milliseconds = std::chrono::duration<double, std::milli>;

constexpr int Who = RUSAGE_THREAD;  // without the far end, which has its own thread

/// A button of which no byte has to be sent twice, with an Ammo Mag's block.
constexpr MemoryButton::Rom ButtonRom = {0x0C, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0x00, 0x9B};

/// Bytes of a tick that meets a button: session and search, then the told sequence in blocks, then the
/// reading back. One answer more or less than the told figures comes from where data mode ends.
constexpr std::size_t SearchBytes = 24;
constexpr std::size_t ChargeBytes = 126;
constexpr std::size_t ReadBackBytes = 48;

class SilentBoxes : public MessageBoxes {
 public:
  BoxAnswer Show(const std::string&, const std::string&, BoxIcon, BoxButtons) override {
    return BoxAnswer::Ok;
  }
};

class SilentDisplay : public ChargingDisplay {
 public:
  int Charged = 0;
  void SetStatus(const std::string&) override {}
  void BeginButton() override {}
  void ButtonsLeft() override {}
  void SetReader(bool) override {}
  void Note(const ChargedButton& button) override {
    Charged += button.Result == ChargeResult::Charged ? 1 : 0;
  }
  bool Closing() const override { return false; }
};

/// A real line that notes when each byte is handed over.
class TimedPort : public SerialPort {
 public:
  std::vector<Clock::time_point> HandOvers;

  void Output(std::uint8_t byte) override {
    HandOvers.push_back(Clock::now());
    port_.Output(byte);
  }

  void Open(const std::string& device, const std::string& settings) override { port_.Open(device, settings); }
  void Close() override { port_.Close(); }
  bool PortOpen() const override { return port_.PortOpen(); }
  void SetSettings(const std::string& settings) override { port_.SetSettings(settings); }
  std::size_t InBufferCount() override { return port_.InBufferCount(); }
  std::uint8_t Input() override { return port_.Input(); }
  void Drain() override { port_.Drain(); }
  void ClearInput() override { port_.ClearInput(); }

 private:
  QtSerialPort port_;
};

bool MeasureFrame() {
  constexpr int frames = 40;
  constexpr std::size_t frameBytes = 10;
  constexpr int baud = 19200;
  std::size_t taken = 0;
  const PacedTerminal box(baud, microseconds(500), [&taken](std::uint8_t) {
    return ++taken % frameBytes == 0 ? std::vector<std::uint8_t>{0xAA} : std::vector<std::uint8_t>{};
  });
  FakeFiles files;
  const IniReader ini(files, "/tessarine.ini");
  const OneDevice device(box.Path());
  const StringTable strings(Language::English);
  SilentBoxes boxes;
  TimedPort port;
  QtEventPump events;
  const CommPort commPort(port, ini, device, boxes, strings, [] {});
  int accepted = 0;
  BoxProgrammer programmer(
      {.MSComm1 = port,
       .Port = commPort,
       .Events = events,
       .Boxes = boxes,
       .Stopped = [] { return false; },
       .OnResult = [&accepted](const BoxEntries&,
                               BoxResult result) { accepted += result == BoxResult::Accepted ? 1 : 0; }});
  std::vector<double> gaps;
  std::vector<double> wholes;
  for (int frame = 0; frame < frames; ++frame) {
    port.HandOvers.clear();
    programmer.Program({});
    for (std::size_t i = 1; i < port.HandOvers.size(); ++i) {
      gaps.push_back(Milliseconds(port.HandOvers[i] - port.HandOvers[i - 1]).count());
    }
    wholes.push_back(Milliseconds(port.HandOvers.back() - port.HandOvers.front()).count());
  }
  double sum = 0;
  for (const double gap : gaps) {
    sum += gap;
  }
  const double least = *std::min_element(gaps.begin(), gaps.end());
  const double mean = sum / static_cast<double>(gaps.size());
  char detail[100];
  std::snprintf(detail, sizeof detail, "%.3f ms, %d of %d frames accepted", least, accepted, frames);
  bool met = ReportGoal("1 ms / least gap in the frame of a box", 1 / least, 1, detail);
  std::snprintf(detail, sizeof detail, "%.3f ms", mean);
  met &= ReportGoal("mean gap in the frame of a box / 1 ms", mean, 1.3, detail);
  std::snprintf(detail, sizeof detail, "%.2f ms", Median(wholes));
  met &= ReportGoal("frame of a box / 14 ms", Median(wholes) / 14, 1, detail);
  met &= ReportGoal("9 ms / frame of a box", 9 / Median(wholes), 1, detail);
  return met && accepted == frames;
}

void FillMag(MemoryButton& button) {
  for (std::size_t i = 2; i < 31; ++i) {
    button.Memory[32 + i] = static_cast<std::uint8_t>(i);
  }
  button.Memory[63] = 0xDE;
}

bool MeasureBytes() {
  FakeFiles files;
  const IniReader ini(files, "/tessarine.ini");
  FakeSerialDevices devices;
  devices.Ports = {"/dev/ttyS0"};
  FakeSerialPort port;
  FakeEventPump events;
  SerialOneWire wire(port, events, ini, devices);
  ModelAdapter adapter(port);
  ButtonsBehindChip bus(adapter);
  SilentBoxes boxes;
  const FakeClock clock;
  SilentDisplay display;
  ButtonCharger charger({.Wire = wire, .Events = events, .Boxes = boxes, .Time = clock, .Display = display});
  charger.Tick();
  const double searched = static_cast<double>(adapter.Sent() + adapter.Answered());
  constexpr double searchNeeds = 24 + 18;
  char detail[100];
  std::snprintf(detail, sizeof detail, "%.0f bytes; session and search take %.0f", searched, searchNeeds);
  bool met = ReportGoal("charging without a button, bytes of a tick", searched / searchNeeds, 1, detail);
  charger.Tick();
  FillMag(bus.Put(ButtonRom));
  std::size_t copied = 0;
  events.OnSleep = [&](FakeEventPump::Time) { copied = port.Sent.size(); };
  port.Sent.clear();
  charger.Tick();
  const std::size_t charge = copied - SearchBytes;
  const std::size_t readBack = port.Sent.size() - copied;
  std::snprintf(detail, sizeof detail, "%zu bytes to %zu", charge, ChargeBytes);
  met &= ReportGoal("charge of a button, bytes", double(charge) / ChargeBytes, 1.1, detail);
  std::snprintf(detail, sizeof detail, "%zu bytes to %zu", readBack, ReadBackBytes);
  met &= ReportGoal("reading a button back, bytes", double(readBack) / ReadBackBytes, 1.1, detail);
  return met && display.Charged == 1;
}

/// A paced adapter with its chip and bus.
class PacedAdapter {
 public:
  const std::string& Path() const { return terminal_.Path(); }
  ButtonsBehindChip& Bus() { return bus_; }
  std::vector<Clock::time_point> Arrivals() const { return terminal_.Arrivals(); }

 private:
  static constexpr int Baud = 9600;
  static constexpr microseconds ByteOnBus{600};

  std::vector<std::uint8_t> answers_;
  ChipModel chip_{[this](std::uint8_t byte) { answers_.push_back(byte); }};
  ButtonsBehindChip bus_{chip_};
  PacedTerminal terminal_{Baud, ByteOnBus, [this](std::uint8_t byte) {
                            answers_.clear();
                            chip_.Take(byte);
                            return answers_;
                          }};
};

bool MeasureChargeTime() {
  constexpr int rounds = 9;
  constexpr double wireTime = ChargeBytes * 10 / 9600.0 * 1000;
  std::vector<double> times;
  int charged = 0;
  for (int round = 0; round < rounds; ++round) {
    PacedAdapter adapter;
    FillMag(adapter.Bus().Put(ButtonRom));
    FakeFiles files;
    const IniReader ini(files, "/tessarine.ini");
    const OneDevice device(adapter.Path());
    QtSerialPort port;
    QtEventPump events;
    SerialOneWire wire(port, events, ini, device);
    SilentBoxes boxes;
    const FakeClock clock;
    SilentDisplay display;
    ButtonCharger({.Wire = wire, .Events = events, .Boxes = boxes, .Time = clock, .Display = display}).Tick();
    charged += display.Charged;
    const auto arrivals = adapter.Arrivals();
    constexpr std::size_t last = SearchBytes + ChargeBytes - 2;
    if (arrivals.size() > last) {
      times.push_back(Milliseconds(arrivals[last] - arrivals[SearchBytes - 1]).count());
    }
  }
  const double time = times.empty() ? 1e6 : Median(times);
  char detail[100];
  std::snprintf(detail, sizeof detail, "%.1f ms to %.1f ms, %d of %d charged", time, wireTime, charged,
                rounds);
  return ReportGoal("charge of a button / its wire time", time / wireTime, 1.3, detail) && charged == rounds;
}

template <typename Window>
bool MeasureIdle(const char* name, Window& window, QtEventPump& events) {
  constexpr std::chrono::milliseconds settle(1000);
  constexpr std::chrono::milliseconds idle(8000);
  window.show();
  events.Sleep(settle);
  const double before = ProcessorSeconds(Who);
  events.Sleep(idle);
  const double spent = ProcessorSeconds(Who) - before;
  const double seconds = std::chrono::duration<double>(idle).count();
  char detail[100];
  std::snprintf(detail, sizeof detail, "%.1f ms in %.0f s", spent * 1000, seconds);
  return ReportGoal(name, spent / seconds, 0.01, detail);
}

bool MeasureWindows() {
  const PacedAdapter adapter;
  FakeFiles files;
  IniReader ini(files, "/tessarine.ini");
  const OneDevice device(adapter.Path());
  const StringTable strings(Language::English);
  const Game game(strings);
  SilentBoxes boxes;
  QtSerialPort port;
  QtSerialPort readerPort;
  QtEventPump events;
  const QtClock clock;
  const CommPort commPort(port, ini, device, boxes, strings, [] {});
  SerialOneWire wire(readerPort, events, ini, device);
  ProgrammedBoxes programmed;
  ChargedButtons charged;
  bool met = true;
  {
    BoxConfig window(
        {port, commPort, events, boxes, clock, strings, game, programmed, {ini, nullptr, strings}}, nullptr);
    met &= MeasureIdle("processor time of the window of boxes", window, events);
  }
  ChargeiButton window({wire, events, boxes, clock, strings, charged, {ini, nullptr, strings}}, nullptr);
  met &= MeasureIdle("processor time of the window of charging", window, events);
  return met;
}

}  // namespace

/// bench-field: programming of utility boxes and charging of buttons.
int main(int argc, char** argv) {
  QApplication application(argc, argv);
  PrepareLook();
  bool met = MeasureFrame();
  met &= MeasureBytes();
  met &= MeasureChargeTime();
  met &= MeasureWindows();
  return met ? 0 : 1;
}
