#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>

#include "core/line/Checksum.h"
#include "devices/buttons/SerialOneWire.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
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
  Answers(const std::uint8_t* data, std::size_t size, FakeSerialPort& port) : next_(data), left_(size) {
    port.OnOutput = [this, &port](std::uint8_t) {
      const std::uint8_t count = Take();
      if (count == 255) {
        port.Lose();
      }
      for (int i = 0; i < count % 18 && left_ > 0; ++i) {
        port.Receive({Take()});
      }
    };
  }

 private:
  std::uint8_t Take() {
    if (left_ == 0) {
      return 0;
    }
    --left_;
    return *next_++;
  }

  const std::uint8_t* next_;
  std::size_t left_;
};

/// All operations of one tick, with checks that hold whatever the adapter answers.
void RunTick(SerialOneWire& wire, FakeSerialPort& port, OneWireState& state) {
  const std::int32_t handle = wire.TMExtendedStartSession(1, 5, 0);
  Require((handle > 0) == port.PortOpen());
  if (handle <= 0) {
    return;
  }
  const bool found = wire.TMNext(handle, state) == 1;
  Require(found == state.Found);
  Require(!found || (Crc8(state.Rom) == 0 && state.Rom[0] != 0));
  Require(state.Branch >= OneWireState::None && state.Branch < 64);
  wire.TMAccess(handle, state);
  const std::int16_t byte = wire.TMTouchByte(handle, 0xE3);
  Require(byte >= 0 && byte <= 255);
  std::array<std::uint8_t, 8> block{};
  wire.TMBlockStream(handle, block);
  wire.TMEndSession(handle);
  Require(!port.PortOpen());
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  FakeFiles files;
  const IniReader ini(files, "/tessarine.ini");
  FakeSerialDevices devices;
  devices.Ports = {"/dev/ttyS0"};
  FakeSerialPort port;
  FakeEventPump events;
  SerialOneWire wire(port, events, ini, devices);
  const Answers answers(data, size, port);
  OneWireState state;
  constexpr int ticks = 4;
  for (int tick = 0; tick < ticks; ++tick) {
    RunTick(wire, port, state);
  }
  constexpr std::chrono::milliseconds longestTick(300);
  Require(events.Now() <= ticks * longestTick);
  return 0;
}
