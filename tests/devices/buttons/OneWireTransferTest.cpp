#include <gmock/gmock.h>

#include "tests/devices/buttons/SerialAdapter.h"

using namespace std::chrono_literals;

namespace {

using testing::Each;
using testing::ElementsAre;

class OneWireTransfer : public SerialAdapter {
 protected:
  OneWireTransfer() {
    state.Found = true;
    state.Rom = {0x81, 0xE3, 0x10, 0x20, 0x30, 0x00, 0x00, 0x08};
  }

  /// What selects that device, after the reset: its number, with the byte twice that would end data mode.
  void ExpectSelection() {
    adapter.Expect({0xE1, 0x55, 0x81, 0xE3, 0xE3, 0x10, 0x20, 0x30, 0x00, 0x00, 0x08},
                   {0x55, 0x81, 0xE3, 0x10, 0x20, 0x30, 0x00, 0x00, 0x08});
  }
};

TEST_F(OneWireTransfer, SelectsADeviceByItsNumber) {
  const std::int32_t handle = Start();
  ExpectSelection();
  EXPECT_EQ(wire.TMAccess(handle, state), 1);
  adapter.Expect({0xE3}, {});
  wire.TMEndSession(handle);
  adapter.Verify();
}

TEST_F(OneWireTransfer, ResetsTheBusBeforeEachSelectionButTheFirst) {
  const std::int32_t handle = Start();
  ExpectSelection();
  ASSERT_EQ(wire.TMAccess(handle, state), 1);
  adapter.Expect({0xE3, 0xC1}, {0xCD});
  ExpectSelection();
  EXPECT_EQ(wire.TMAccess(handle, state), 1);
  adapter.Verify();
}

TEST_F(OneWireTransfer, SelectsNothingOnAnEmptyOrShortedBus) {
  for (const int answer : {0xCF, 0xCC}) {
    const std::int32_t handle = Start(static_cast<std::uint8_t>(answer));
    EXPECT_EQ(wire.TMAccess(handle, state), 0);
    wire.TMEndSession(handle);
  }
  adapter.Verify();
}

TEST_F(OneWireTransfer, SelectsNothingBeforeADeviceWasFound) {
  const std::int32_t handle = Start();
  state = {};
  EXPECT_EQ(wire.TMAccess(handle, state), 0);
  adapter.Verify();
}

TEST_F(OneWireTransfer, SelectsNothingWhenTheBusDoesNotTakeTheNumber) {
  const std::int32_t handle = Start();
  adapter.Expect({0xE1, 0x55, 0x81, 0xE3, 0xE3, 0x10, 0x20, 0x30, 0x00, 0x00, 0x08}, Bytes(9, 0x00));
  EXPECT_EQ(wire.TMAccess(handle, state), 0);
}

TEST_F(OneWireTransfer, TellsWhatTheBusAnsweredToAByte) {
  const std::int32_t handle = Start();
  adapter.Expect({0xE1, 0xF0}, {0xF0});
  adapter.Expect({0xFF}, {0x3A});
  EXPECT_EQ(wire.TMTouchByte(handle, 0xF0), 0xF0);
  EXPECT_EQ(wire.TMTouchByte(handle, 0xFF), 0x3A);
  adapter.Expect({0xE3}, {});
  wire.TMEndSession(handle);
  adapter.Verify();
}

TEST_F(OneWireTransfer, SendsTheByteThatEndsDataModeTwice) {
  const std::int32_t handle = Start();
  adapter.Expect({0xE1, 0xE3, 0xE3}, {0xE3});
  EXPECT_EQ(wire.TMTouchByte(handle, 0xE3), 0xE3);
  adapter.Expect({0xE1}, {0xE1});
  EXPECT_EQ(wire.TMTouchByte(handle, 0xE1), 0xE1);
  adapter.Verify();
}

TEST_F(OneWireTransfer, ReplacesABlockByTheAnswer) {
  const std::int32_t handle = Start();
  adapter.Expect({0xE1, 0x0F, 0xE3, 0xE3, 0xFF}, {0x0F, 0xE3, 0x12});
  Bytes block = {0x0F, 0xE3, 0xFF};
  EXPECT_EQ(wire.TMBlockStream(handle, block), 1);
  EXPECT_THAT(block, ElementsAre(0x0F, 0xE3, 0x12));
  adapter.Verify();
}

TEST_F(OneWireTransfer, SendsAnEmptyBlockWithoutAByte) {
  const std::int32_t handle = Start();
  EXPECT_EQ(wire.TMBlockStream(handle, {}), 1);
  adapter.Verify();
}

TEST_F(OneWireTransfer, GoesOnWithTheDeviceThatASearchSelected) {
  const std::int32_t handle = Start();
  state = {};
  ExpectSearch(zeroPath, buttonAlone);
  ASSERT_EQ(wire.TMNext(handle, state), 1);
  adapter.Expect({0xE1, 0xF0}, {0xF0});
  EXPECT_EQ(wire.TMTouchByte(handle, 0xF0), 0xF0);
  adapter.Verify();
}

TEST_F(OneWireTransfer, ReadsAnIdleBusFromASilentChipAfterOneWait) {
  const std::int32_t handle = Start();
  adapter.Expect({0xE1, 0xFF}, {});
  EXPECT_EQ(wire.TMTouchByte(handle, 0xFF), 255);
  const auto waited = events.Now();
  EXPECT_LE(waited, 210ms);
  Bytes block(32, 0x00);
  EXPECT_EQ(wire.TMBlockStream(handle, block), 0);
  EXPECT_THAT(block, Each(0x00));
  EXPECT_EQ(wire.TMAccess(handle, state), 0);
  EXPECT_EQ(events.Now(), waited);
  adapter.Verify();
}

TEST_F(OneWireTransfer, LeavesABlockAsItWasWhenTheLineIsPulledOut) {
  const std::int32_t handle = Start();
  port.Lose();
  Bytes block = {0x01, 0x02};
  EXPECT_EQ(wire.TMBlockStream(handle, block), 0);
  EXPECT_THAT(block, ElementsAre(0x01, 0x02));
  EXPECT_EQ(wire.TMTouchByte(handle, 0x01), 255);
  EXPECT_EQ(wire.TMAccess(handle, state), 0);
  EXPECT_EQ(wire.TMEndSession(handle), 1);
}

TEST_F(OneWireTransfer, ReadsTheNumberOnlyWhenAskedTo) {
  const std::int32_t handle = Start();
  OneWireRom rom{1, 2, 3, 4, 5, 6, 7, 8};
  EXPECT_EQ(wire.TMRom(handle, state, rom), 0);
  EXPECT_THAT(rom, ElementsAre(1, 2, 3, 4, 5, 6, 7, 8));
  rom[0] = 0;
  EXPECT_EQ(wire.TMRom(handle, state, rom), 1);
  EXPECT_THAT(rom, ElementsAre(0x81, 0xE3, 0x10, 0x20, 0x30, 0x00, 0x00, 0x08));
}

}  // namespace
