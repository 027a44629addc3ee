#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <span>

#include "devices/buttons/SerialOneWire.h"
#include "devices/charging/ButtonCharger.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

/// An adapter whose answers come from the fuzzer: for each byte sent to it, one byte gives the number of
/// bytes that follow as the answer (modulo 18); 255 also loses the line.
class Answers {
 public:
  Answers(std::span<const std::uint8_t> input, FakeSerialPort& port) : input_(input) {
    port.OnOutput = [this, &port](std::uint8_t) {
      const std::uint8_t count = Take();
      if (count == 255) {
        port.Lose();
      }
      for (int i = 0; i < count % 18 && !input_.empty(); ++i) {
        port.Receive({Take()});
      }
    };
  }

 private:
  std::uint8_t Take() {
    if (input_.empty()) {
      return 0;
    }
    const std::uint8_t byte = input_.front();
    input_ = input_.subspan(1);
    return byte;
  }

  std::span<const std::uint8_t> input_;
};

/// Checks that each touch ends in one way only, and that one whose button was read ends at all.
class Checks : public ChargingDisplay {
 public:
  std::string Status;
  int Begun = 0;
  int Read = 0;

  void SetStatus(const std::string& text) override { Status = text; }
  void BeginButton() override { ++Begun; }
  void ButtonsLeft() override {}
  void SetReader(bool) override {}
  void Note(const ChargedButton& button) override {
    Read += button.Result == ChargeResult::NotRead ? 0 : 1;
    const bool written = button.Result != ChargeResult::NotRead && button.Result != ChargeResult::Unknown;
    Require(written == !Status.empty());
    Require(button.DallasID.size() == 16);
  }
  bool Closing() const override { return false; }
};

}  // namespace

/// Some ticks of the charging. The first byte answers the question about an invalid button.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::span input(data, size);
  FakeFiles files;
  const IniReader ini(files, "/tessarine.ini");
  FakeSerialDevices devices;
  devices.Ports = {"/dev/ttyS0"};
  FakeSerialPort port;
  FakeEventPump events;
  SerialOneWire wire(port, events, ini, devices);
  FakeMessageBoxes boxes;
  const FakeClock clock;
  Checks display;
  const bool isMag = !input.empty() && input.front() % 2 == 0;
  boxes.Answers.assign(8, isMag ? BoxAnswer::Yes : BoxAnswer::No);
  const Answers answers(input.empty() ? input : input.subspan(1), port);
  ButtonCharger charger({.Wire = wire, .Events = events, .Boxes = boxes, .Time = clock, .Display = display});
  constexpr int ticks = 4;
  for (int tick = 0; tick < ticks; ++tick) {
    charger.Tick();
    Require(!port.PortOpen());
    Require(display.Begun == display.Read);
  }
  constexpr std::chrono::milliseconds longestTick(2000);
  Require(events.Now() <= ticks * longestTick);
  return 0;
}
