#include <gmock/gmock.h>

#include "tests/devices/buttons/SerialAdapter.h"

using namespace std::chrono_literals;

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Le;

constexpr const char* LogOfOpen = "Open /dev/ttyS0 9600,N,8,1";

class OneWireSession : public SerialAdapter {
 protected:
  void ExpectNoSession() {
    EXPECT_EQ(wire.TMExtendedStartSession(1, 5, 0), 0);
    EXPECT_FALSE(port.PortOpen());
    adapter.Verify();
  }
};

TEST_F(OneWireSession, OpensTheLineAndResetsTheBus) {
  EXPECT_GT(Start(), 0);
  EXPECT_EQ(port.Log.front(), LogOfOpen);
  adapter.Verify();
}

TEST_F(OneWireSession, ClosesTheLineAtItsEndWithoutAnotherByte) {
  const std::int32_t handle = Start();
  EXPECT_EQ(wire.TMEndSession(handle), 1);
  EXPECT_FALSE(port.PortOpen());
  adapter.Verify();
}

TEST_F(OneWireSession, IsOnTheDeviceOfThePortNumber) {
  adapter.Expect({0xC1}, {0xCD});
  EXPECT_GT(wire.TMExtendedStartSession(2, 5, 0), 0);
  EXPECT_EQ(port.Device, "/dev/ttyUSB0");
}

TEST_F(OneWireSession, IsOnTheDeviceThatTheSettingsNameForThePort) {
  PutIni("[ports]\ncom4=/dev/pts/9\n");
  adapter.Expect({0xC1}, {0xCD});
  EXPECT_GT(wire.TMExtendedStartSession(4, 5, 0), 0);
  EXPECT_EQ(port.Device, "/dev/pts/9");
}

TEST_F(OneWireSession, TakesEveryAnswerToAReset) {
  for (const int answer : {0xCC, 0xCD, 0xCE, 0xCF, 0xEC, 0xED, 0xEE, 0xEF}) {
    const std::int32_t handle = Start(static_cast<std::uint8_t>(answer));
    EXPECT_GT(handle, 0) << answer;
    wire.TMEndSession(handle);
  }
  adapter.Verify();
}

TEST_F(OneWireSession, ResetsAgainAfterTheResetThatSetsTheClockOfAChipJustPowered) {
  adapter.Expect({0xC1}, {});
  EXPECT_GT(Start(), 0);
  adapter.Verify();
  EXPECT_THAT(events.Now(), Le(35ms));
}

TEST_F(OneWireSession, GivesAnAdapterTimeToChargeFromTheLine) {
  adapter.Expect({0xC1}, {});
  adapter.Expect({0xC1}, {});
  EXPECT_GT(Start(), 0);
  adapter.Verify();
}

TEST_F(OneWireSession, DoesNotStartOnASilentLine) {
  adapter.Expect({0xC1, 0xC1, 0xC1}, {});
  ExpectNoSession();
  EXPECT_THAT(events.Now(), Le(270ms));
}

TEST_F(OneWireSession, ServesEventsWhileItWaits) {
  int served = 0;
  for (const auto time : {10ms, 50ms, 90ms, 200ms}) {
    events.At(time, [&served] { ++served; });
  }
  EXPECT_EQ(wire.TMExtendedStartSession(1, 5, 0), 0);
  EXPECT_EQ(served, 4);
}

TEST_F(OneWireSession, DoesNotTakeABusyMachineForAMissingAdapter) {
  port.OnOutput = [this](std::uint8_t) { events.At(150ms, [this] { port.Receive({0xCD}); }); };
  EXPECT_GT(wire.TMExtendedStartSession(1, 5, 0), 0);
}

TEST_F(OneWireSession, WaitsForAnAnswerThatTheLineHoldsBack) {
  port.OnOutput = [this](std::uint8_t) { events.At(25ms, [this] { port.Receive({0xCD}); }); };
  EXPECT_GT(wire.TMExtendedStartSession(1, 5, 0), 0);
  EXPECT_THAT(port.Sent, ElementsAre(0xC1));
  EXPECT_EQ(events.Now(), 25ms);
}

TEST_F(OneWireSession, FindsAChipThatWasLeftInDataMode) {
  adapter.Expect({0xC1}, {0xC1});
  adapter.Expect({0xE3, 0xA1}, {});
  EXPECT_GT(Start(), 0);
  adapter.Verify();
}

TEST_F(OneWireSession, FindsAChipThatWasLeftInTheMiddleOfASearch) {
  adapter.Expect({0xC1}, {0x82});
  adapter.Expect({0xE3, 0xA1}, {});
  EXPECT_GT(Start(), 0);
  adapter.Verify();
}

TEST_F(OneWireSession, DoesNotStartOnALineWithSomethingElse) {
  for (int attempt = 0; attempt < 3; ++attempt) {
    adapter.Expect({0xC1}, {0x41, 0x54});
    adapter.Expect({0xE3, 0xA1}, {});
  }
  ExpectNoSession();
}

TEST_F(OneWireSession, DoesNotTakeAnotherChipsVersionForThisOne) {
  for (int attempt = 0; attempt < 3; ++attempt) {
    adapter.Expect({0xC1}, {0xD1});
    adapter.Expect({0xE3, 0xA1}, {});
  }
  ExpectNoSession();
}

TEST_F(OneWireSession, DoesNotStartWithoutThePort) {
  port.FailNextOpen(8002);
  ExpectNoSession();
}

TEST_F(OneWireSession, DoesNotStartOnAPortInUse) {
  port.FailNextOpen(8005);
  ExpectNoSession();
}

TEST_F(OneWireSession, DoesNotStartOnANumberWithoutADevice) {
  EXPECT_EQ(wire.TMExtendedStartSession(3, 5, 0), 0);
  EXPECT_THAT(port.Log, IsEmpty());
}

TEST_F(OneWireSession, DoesNotStartOnAnotherKindOfAdapter) {
  EXPECT_EQ(wire.TMExtendedStartSession(1, 6, 0), 0);
  EXPECT_THAT(port.Log, IsEmpty());
}

TEST_F(OneWireSession, DoesNotStartOnAnAdapterThatIsPulledOutMeanwhile) {
  port.OnOutput = [this](std::uint8_t) { port.Lose(); };
  EXPECT_EQ(wire.TMExtendedStartSession(1, 5, 0), 0);
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(OneWireSession, StartsAgainOnceTheAdapterIsBack) {
  port.FailNextOpen(8002);
  ASSERT_EQ(wire.TMExtendedStartSession(1, 5, 0), 0);
  EXPECT_GT(Start(), 0);
}

TEST_F(OneWireSession, KeepsASecondOneOut) {
  const std::int32_t handle = Start();
  EXPECT_EQ(wire.TMExtendedStartSession(1, 5, 0), 0);
  EXPECT_TRUE(port.PortOpen());
  EXPECT_EQ(wire.TMSetup(handle), 1);
  adapter.Verify();
}

TEST_F(OneWireSession, HasAHandleOfItsOwn) {
  const std::int32_t old = Start();
  ASSERT_EQ(wire.TMEndSession(old), 1);
  const std::int32_t handle = Start();
  EXPECT_NE(handle, old);
  EXPECT_EQ(wire.TMSetup(old), 0);
  EXPECT_EQ(wire.TMEndSession(old), 0);
  EXPECT_TRUE(port.PortOpen());
  EXPECT_EQ(wire.TMSetup(handle), 1);
}

TEST_F(OneWireSession, DoesNothingOnceEnded) {
  const std::int32_t handle = Start();
  wire.TMEndSession(handle);
  OneWireRom rom{};
  Bytes block = {1, 2};
  EXPECT_EQ(wire.TMSetup(handle), 0);
  EXPECT_EQ(wire.TMNext(handle, state), OneWire::BadRead);
  EXPECT_EQ(wire.TMRom(handle, state, rom), 0);
  EXPECT_EQ(wire.TMAccess(handle, state), 0);
  EXPECT_EQ(wire.TMTouchByte(handle, 0x33), 255);
  EXPECT_EQ(wire.TMBlockStream(handle, block), 0);
  EXPECT_EQ(wire.TMEndSession(handle), 0);
  adapter.Verify();
}

/// The window that polls has no fault to tell of then.
TEST_F(OneWireSession, StartsOnAnEmptyBusWhenTheProgramCloses) {
  events.EndWaits();
  const std::int32_t handle = wire.TMExtendedStartSession(1, 5, 0);
  EXPECT_GT(handle, 0);
  EXPECT_THAT(port.Sent, ElementsAre(0xC1));
  EXPECT_EQ(wire.TMNext(handle, state), OneWire::BadRead);
  EXPECT_EQ(wire.TMEndSession(handle), 1);
  EXPECT_FALSE(port.PortOpen());
  EXPECT_EQ(events.Now(), 0ms);
}

class DefaultPort : public SerialAdapter {
 protected:
  /// "result port type" with 9 and 9 before the call.
  std::string Read() {
    std::int16_t portNumber = 9;
    std::int16_t type = 9;
    const std::int16_t result = wire.TMReadDefaultPort(portNumber, type);
    return std::to_string(result) + ' ' + std::to_string(portNumber) + ' ' + std::to_string(type);
  }
};

TEST_F(DefaultPort, ComesFromTheSettings) {
  PutIni("[onewire]\nport=3\ntype=6\n");
  EXPECT_EQ(Read(), "1 3 6");
}

TEST_F(DefaultPort, IsReadAtEachUse) {
  PutIni("[onewire]\nport=3\ntype=5\n");
  ASSERT_EQ(Read(), "1 3 5");
  PutIni("[onewire]\nport=12\ntype=5\n");
  EXPECT_EQ(Read(), "1 12 5");
}

TEST_F(DefaultPort, IsASerialAdapterWithoutAType) {
  PutIni("[onewire]\nport=3\n");
  EXPECT_EQ(Read(), "1 3 5");
}

TEST_F(DefaultPort, IsNotKnownWithoutTheFileOrTheSection) {
  EXPECT_EQ(Read(), "0 9 9");
  PutIni("[comm]\ncommport=3\n");
  EXPECT_EQ(Read(), "0 9 9");
}

TEST_F(DefaultPort, IsNotKnownWithoutAPort) {
  PutIni("[onewire]\ntype=5\n");
  EXPECT_EQ(Read(), "0 9 9");
}

TEST_F(DefaultPort, IsNotKnownWhenAValueIsNoNumberOfAPort) {
  for (const char* text : {"", "0", "-1", "abc", "1.5", "1e3", "32768", "100000", "0x1"}) {
    PutIni(std::string("[onewire]\nport=") + text + "\ntype=5\n");
    EXPECT_EQ(Read(), "0 9 9") << text;
  }
  PutIni("[onewire]\nport=1\ntype=serial\n");
  EXPECT_EQ(Read(), "0 9 9");
}

TEST_F(DefaultPort, CanBeTheHighestNumber) {
  PutIni("[onewire]\nport=32767\ntype=0\n");
  EXPECT_EQ(Read(), "1 32767 0");
}

}  // namespace
