#pragma once

#include <gtest/gtest.h>

#include "devices/buttons/SerialOneWire.h"
#include "tests/devices/buttons/ScriptedAdapter.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSerialDevices.h"

/// The driver on a scripted line, port 1.
class SerialAdapter : public testing::Test {
 protected:
  using Bytes = ScriptedAdapter::Bytes;

  SerialAdapter() { devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB0"}; }

  void PutIni(const std::string& text) { files.Put("/tessarine.ini", text); }

  /// Begins a session whose first reset is answered by `resetAnswer`.
  std::int32_t Start(std::uint8_t resetAnswer = 0xCD) {
    adapter.Expect({0xC1}, {resetAnswer});
    return wire.TMExtendedStartSession(1, 5, 0);
  }

  /// A search along `path` that `answer` comes back for.
  void ExpectSearch(const Bytes& path, const Bytes& answer) {
    adapter.Expect({0xE1, 0xF0}, {0xF0});
    adapter.Expect({0xE3, 0xB1, 0xE1}, {});
    adapter.Expect(path, answer);
    adapter.Expect({0xE3, 0xA1}, {});
  }

  /// One tick of a poll: a session with one step of the walk.
  std::int16_t NextInATick(std::uint8_t resetAnswer = 0xCD) {
    const std::int32_t handle = Start(resetAnswer);
    EXPECT_GT(handle, 0);
    const std::int16_t result = wire.TMNext(handle, state);
    EXPECT_EQ(wire.TMEndSession(handle), 1);
    return result;
  }

  /// One tick of a poll whose search takes `path` and is answered with `answer`.
  std::int16_t SearchInATick(const Bytes& path, const Bytes& answer) {
    const std::int32_t handle = Start();
    ExpectSearch(path, answer);
    const std::int16_t result = wire.TMNext(handle, state);
    EXPECT_EQ(wire.TMEndSession(handle), 1);
    return result;
  }

  FakeFiles files;
  IniReader ini{files, "/tessarine.ini"};
  FakeSerialDevices devices;
  FakeSerialPort port;
  FakeEventPump events;
  SerialOneWire wire{port, events, ini, devices};
  ScriptedAdapter adapter{port};
  OneWireState state;

  // Button 01-00CDAB896745-A3 and the reader's own device 81-0000302010E3-08, which part in bit 7.
  const Bytes zeroPath = Bytes(16, 0x00);
  const Bytes pathToReader = {0x02, 0x80, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0};
  const Bytes buttonAlone = {0x02, 0x00, 0x22, 0x20, 0x2A, 0x28, 0x82, 0x80,
                             0x8A, 0x88, 0xA2, 0xA0, 0x00, 0x00, 0x0A, 0x88};
  const Bytes buttonBesideReader = {0x02, 0x40, 0x22, 0x20, 0x2A, 0x28, 0x82, 0x80,
                                    0x8A, 0x88, 0xA2, 0xA0, 0x00, 0x00, 0x0A, 0x88};
  const Bytes readerBesideButton = {0x02, 0xC0, 0x0A, 0xA8, 0x00, 0x02, 0x00, 0x08,
                                    0x00, 0x0A, 0x00, 0x00, 0x00, 0x00, 0x80, 0x00};
  const Bytes readerAlone = {0x02, 0x80, 0x0A, 0xA8, 0x00, 0x02, 0x00, 0x08,
                             0x00, 0x0A, 0x00, 0x00, 0x00, 0x00, 0x80, 0x00};
  const std::array<std::uint8_t, 8> button = {0x01, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0x00, 0xA3};
  const std::array<std::uint8_t, 8> reader = {0x81, 0xE3, 0x10, 0x20, 0x30, 0x00, 0x00, 0x08};
};
