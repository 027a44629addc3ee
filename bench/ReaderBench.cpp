#include <cstdio>
#include <map>

#include "bench/Goals.h"
#include "devices/buttons/SerialOneWire.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"

namespace {

/// The search from the DS2480B data sheet: reset, data mode, Search ROM, command mode, accelerator on, data
/// mode, 16 bytes of path, command mode, accelerator off. The chip answers the reset, Search ROM and the
/// path.
constexpr int SearchBytesSent = 24;
constexpr int SearchBytesAnswered = 18;

/// Answers by the index of the byte that they answer, for a search that finds button 01-00CDAB896745-A3.
const std::map<std::size_t, std::uint8_t> Answers = {
    {0, 0xCD},  {2, 0xF0},  {6, 0x02},  {7, 0x00},  {8, 0x22},  {9, 0x20},
    {10, 0x2A}, {11, 0x28}, {12, 0x82}, {13, 0x80}, {14, 0x8A}, {15, 0x88},
    {16, 0xA2}, {17, 0xA0}, {18, 0x00}, {19, 0x00}, {20, 0x0A}, {21, 0x88}};

}  // namespace

/// bench-reader: counts the bytes on the reader's line in one poll that finds a button.
int main() {
  FakeFiles files;
  const IniReader ini(files, "/tessarine.ini");
  FakeSerialDevices devices;
  devices.Ports = {"/dev/ttyS0"};
  FakeSerialPort port;
  FakeEventPump events;
  SerialOneWire wire(port, events, ini, devices);
  int answered = 0;
  port.OnOutput = [&](std::uint8_t) {
    const auto answer = Answers.find(port.Sent.size() - 1);
    if (answer != Answers.end()) {
      port.Receive({answer->second});
      ++answered;
    }
  };
  OneWireState state;
  const std::int32_t handle = wire.TMExtendedStartSession(1, 5, 0);
  const bool found = wire.TMNext(handle, state) == 1;
  wire.TMEndSession(handle);
  if (!found) {
    std::puts("the reader found nothing");
    return 1;
  }
  const int sent = static_cast<int>(port.Sent.size());
  char detail[100];
  std::snprintf(detail, sizeof detail, "%d bytes to the adapter and %d from it; the search takes %d and %d",
                sent, answered, SearchBytesSent, SearchBytesAnswered);
  const double ratio = double(sent + answered) / (SearchBytesSent + SearchBytesAnswered);
  return ReportGoal("polling the reader, bytes of a tick", ratio, 1, detail) ? 0 : 1;
}
