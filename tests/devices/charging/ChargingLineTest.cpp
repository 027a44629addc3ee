#include <gmock/gmock.h>

#include "devices/buttons/SerialOneWire.h"
#include "devices/charging/ButtonCharger.h"
#include "tests/devices/buttons/ModelAdapter.h"
#include "tests/devices/charging/ButtonsBehindChip.h"
#include "tests/devices/charging/ChargingSite.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/support/Bytes.h"

// What the charging puts on the line of a serial adapter.

namespace {

using testing::ElementsAre;

class ChargingLine : public testing::Test {
 protected:
  // Its CRC is right, and none of its bytes has to be sent twice.
  static constexpr MemoryButton::Rom ButtonRom = {0x0C, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0x00, 0x9B};

  ChargingLine() { devices.Ports = {"/dev/ttyS0"}; }

  /// A tick; returns what it put on the line.
  Bytes Tick() {
    port.Sent.clear();
    charger.Tick();
    return port.Sent;
  }

  static void Append(Bytes& bytes, const Bytes& more) { bytes.insert(bytes.end(), more.begin(), more.end()); }

  FakeFiles files;
  IniReader ini{files, "/tessarine.ini"};
  FakeSerialDevices devices;
  FakeSerialPort port;
  FakeEventPump events;
  SerialOneWire wire{port, events, ini, devices};
  ModelAdapter adapter{port};
  ButtonsBehindChip bus{adapter};
  FakeMessageBoxes boxes;
  FakeClock clock;
  FakeChargingDisplay display;
  ButtonCharger charger{{.Wire = wire, .Events = events, .Boxes = boxes, .Time = clock, .Display = display}};
};

TEST_F(ChargingLine, CarriesTheToldSequenceInBlocks) {
  MemoryButton& mag = bus.Put(ButtonRom);
  for (std::size_t i = 0; i < 29; ++i) {
    mag.Memory[34 + i] = static_cast<std::uint8_t>(i);
  }
  mag.Memory[63] = CheckByteOf(BlockOf(mag));
  const Bytes sent = Tick();

  const Bytes select = {0xE1, 0x55, 0x0C, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0x00, 0x9B};
  const Bytes reset = {0xE3, 0xC1};
  Bytes told = {0xC1, 0xE1, 0xF0, 0xE3, 0xB1, 0xE1};  // session and search
  Append(told, Bytes(16, 0));
  Append(told, {0xE3, 0xA1});
  const std::size_t searchEnd = told.size();
  Append(told, {0xC1});
  Append(told, select);
  Append(told, {0xF0, 0x20, 0x00});
  Append(told, Bytes(32, 0xFF));
  Append(told, reset);
  Append(told, select);
  Append(told, {0x0F, 0x20, 0x00, 0, 1});
  for (int i = 0; i < 29; ++i) {
    told.push_back(static_cast<std::uint8_t>(i));
  }
  told.push_back(mag.Memory[63]);
  Append(told, reset);
  Append(told, select);
  Append(told, {0xAA, 0xFF, 0xFF, 0xFF});
  Append(told, reset);
  Append(told, select);
  Append(told, {0x55, 0x20, 0x00, 0x1F});
  const std::size_t copyEnd = told.size();
  Append(told, reset);
  Append(told, select);
  Append(told, {0xF0, 0x20, 0x00});
  Append(told, Bytes(32, 0xFF));
  EXPECT_EQ(copyEnd - searchEnd, 125U);
  EXPECT_EQ(told.size() - copyEnd, 47U);
  Append(told, {0xE3});
  EXPECT_EQ(sent, told);
  EXPECT_EQ(mag.Memory[33], 1);
  ASSERT_EQ(display.Notes.size(), 1U);
  EXPECT_EQ(display.Notes[0].Result, ChargeResult::Charged);
}

TEST_F(ChargingLine, CarriesNoMoreThanSessionAndSearchInATickWithoutAButton) {
  for (int tick = 0; tick < 4; ++tick) {
    const std::size_t answeredBefore = adapter.Answered();
    const Bytes sent = Tick();
    EXPECT_EQ(sent.size(), 24U) << tick;
    EXPECT_EQ(adapter.Answered() - answeredBefore, 18U) << tick;
    EXPECT_FALSE(port.PortOpen());
  }
}

TEST_F(ChargingLine, IsClosedAfterATickWithAButton) {
  bus.Put(ButtonRom);
  Tick();
  EXPECT_FALSE(port.PortOpen());
}

/// Any single byte on the line disturbed: the block is the old one or the full one, or one that was written
/// as it is told, and then the list says so.
TEST_F(ChargingLine, DisturbedInAnyByteIsNotedUnlessTheButtonIsFull) {
  MemoryButton& mag = bus.Put(ButtonRom);
  const auto fresh = [&mag] {
    mag.Memory.fill(0);
    mag.Memory[34] = 0x5A;
    mag.Memory[63] = CheckByteOf(BlockOf(mag));
  };
  ChargeBlock full{};
  full[1] = 1;
  full[2] = 0x5A;
  full[31] = CheckByteOf(full);
  for (const bool fromHost : {true, false}) {
    for (std::size_t place = 0; place < 200; ++place) {
      fresh();
      display.Notes.clear();
      ButtonCharger another(
          {.Wire = wire, .Events = events, .Boxes = boxes, .Time = clock, .Display = display});
      adapter.Disturbance = 0x04;
      (fromHost ? adapter.DisturbSent : adapter.DisturbAnswered) =
          (fromHost ? adapter.Sent() : adapter.Answered()) + place;
      another.Tick();
      adapter.DisturbSent = adapter.DisturbAnswered = ModelAdapter::Never;
      if (!display.Notes.empty() && display.Notes.back().Result == ChargeResult::Charged) {
        EXPECT_EQ(BlockOf(mag), full) << fromHost << ' ' << place;
      }
      another.Tick();
      another.Tick();
    }
  }
}

}  // namespace
