#include <gmock/gmock.h>

#include "tests/devices/buttons/SerialAdapter.h"

using namespace std::chrono_literals;

namespace {

using testing::Each;
using testing::ElementsAre;
using testing::Le;

class OneWireSearch : public SerialAdapter {
 protected:
  /// A further step of the walk in a session that is open.
  std::int16_t NextStep(std::int32_t handle, const Bytes& path, const Bytes& answer) {
    adapter.Expect({0xC1}, {0xCD});
    ExpectSearch(path, answer);
    return wire.TMNext(handle, state);
  }

  /// The bus answers the search with `answer`, which holds no number.
  void ExpectBadRead(const Bytes& answer) {
    ExpectSearch(zeroPath, answer);
    EXPECT_EQ(NextInATick(), OneWire::BadRead);
    EXPECT_FALSE(state.Found);
    adapter.Verify();
  }
};

TEST_F(OneWireSearch, FindsTheOnlyDevice) {
  const std::int32_t handle = Start();
  ExpectSearch(zeroPath, buttonAlone);
  EXPECT_EQ(wire.TMNext(handle, state), 1);
  OneWireRom rom{};
  EXPECT_EQ(wire.TMRom(handle, state, rom), 1);
  EXPECT_THAT(rom, ElementsAre(0x01, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0x00, 0xA3));
  adapter.Verify();
}

/// Reset, data mode, Search ROM, command mode, accelerator on, data mode, 16 bytes of path, command mode,
/// accelerator off: the search of the data sheet. The reset that finds the adapter is the one of the search.
TEST_F(OneWireSearch, TakesNoByteMoreInATickThanTheDataSheetsSearch) {
  constexpr std::size_t searchBytes = 1 + 2 + 3 + 16 + 2;
  constexpr std::size_t answerBytes = 1 + 1 + 16;
  std::size_t answered = 0;
  const auto script = port.OnOutput;
  port.OnOutput = [&](std::uint8_t byte) {
    const std::size_t before = port.InBufferCount();
    script(byte);
    answered += port.InBufferCount() - before;
  };
  ASSERT_EQ(SearchInATick(zeroPath, buttonAlone), 1);
  EXPECT_EQ(port.Sent.size(), searchBytes);
  EXPECT_EQ(searchBytes, 24U);
  EXPECT_EQ(answered, answerBytes);
  EXPECT_EQ(answerBytes, 18U);
}

TEST_F(OneWireSearch, TakesOneByteInATickOnAnEmptyBus) {
  EXPECT_EQ(NextInATick(0xCF), 0);
  EXPECT_THAT(port.Sent, ElementsAre(0xC1));
}

TEST_F(OneWireSearch, StopsAtAShortCircuit) {
  EXPECT_EQ(NextInATick(0xCC), OneWire::BadRead);
  EXPECT_THAT(port.Sent, ElementsAre(0xC1));
}

TEST_F(OneWireSearch, FindsADeviceWithAnAlarm) {
  adapter.Expect({0xC1}, {0xCE});
  const std::int32_t handle = wire.TMExtendedStartSession(1, 5, 0);
  ExpectSearch(zeroPath, buttonAlone);
  EXPECT_EQ(wire.TMNext(handle, state), 1);
}

TEST_F(OneWireSearch, GoesOnFromSessionToSessionAndTellsTheEnd) {
  EXPECT_EQ(SearchInATick(zeroPath, buttonBesideReader), 1);
  EXPECT_EQ(state.Rom, button);

  EXPECT_EQ(SearchInATick(pathToReader, readerBesideButton), 1);
  EXPECT_EQ(state.Rom, reader);

  EXPECT_EQ(SearchInATick(readerAlone, readerBesideButton), 0);

  EXPECT_EQ(SearchInATick(zeroPath, readerAlone), 1);
  EXPECT_EQ(state.Rom, reader);
  adapter.Verify();
}

TEST_F(OneWireSearch, ResetsTheBusBeforeASecondStepInOneSession) {
  const std::int32_t handle = Start();
  ExpectSearch(zeroPath, buttonBesideReader);
  ASSERT_EQ(wire.TMNext(handle, state), 1);
  EXPECT_EQ(NextStep(handle, pathToReader, readerBesideButton), 1);
  EXPECT_EQ(state.Rom, reader);
  adapter.Verify();
}

/// Button 0C-0A0504030201-26 parts from the two others in bit 0.
TEST_F(OneWireSearch, FindsTwoButtonsAndTheReader) {
  const std::int32_t handle = Start();
  ExpectSearch(zeroPath, {0xA1, 0x00, 0x02, 0x00, 0x08, 0x00, 0x0A, 0x00, 0x20, 0x00, 0x22, 0x00, 0x88, 0x00,
                          0x28, 0x08});
  ASSERT_EQ(wire.TMNext(handle, state), 1);
  EXPECT_THAT(state.Rom, ElementsAre(0x0C, 0x01, 0x02, 0x03, 0x04, 0x05, 0x0A, 0x26));

  Bytes answer = buttonBesideReader;
  answer[0] = 0x03;
  Bytes path = zeroPath;
  path[0] = 0x02;
  ASSERT_EQ(NextStep(handle, path, answer), 1);
  EXPECT_EQ(state.Rom, button);

  answer = readerBesideButton;
  answer[0] = 0x03;
  ASSERT_EQ(NextStep(handle, pathToReader, answer), 1);
  EXPECT_EQ(state.Rom, reader);
  EXPECT_EQ(NextStep(handle, readerAlone, answer), 0);
  adapter.Verify();
}

/// The walk stands on the reader's device, the last one, when a button comes: one look tells the end, and the
/// next one finds it.
TEST_F(OneWireSearch, FindsANewButtonInTheSecondLookAtTheLatest) {
  ASSERT_EQ(SearchInATick(zeroPath, readerAlone), 1);
  EXPECT_EQ(SearchInATick(readerAlone, readerBesideButton), 0);
  EXPECT_EQ(SearchInATick(zeroPath, buttonBesideReader), 1);
  EXPECT_EQ(state.Rom, button);
}

/// The path to the second device still works when the first one has gone in the meantime.
TEST_F(OneWireSearch, GoesOnWithoutTheDeviceThatLeft) {
  const std::int32_t handle = Start();
  ExpectSearch(zeroPath, buttonBesideReader);
  ASSERT_EQ(wire.TMNext(handle, state), 1);
  EXPECT_EQ(NextStep(handle, pathToReader, readerAlone), 1);
  EXPECT_EQ(state.Rom, reader);
  EXPECT_EQ(NextStep(handle, readerAlone, readerAlone), 0);
}

/// A bit that told of devices left got lost on the way.
TEST_F(OneWireSearch, IsNotAtTheEndWhenTheLastDeviceParts) {
  ASSERT_EQ(SearchInATick(zeroPath, buttonAlone), 1);
  EXPECT_EQ(SearchInATick(buttonAlone, buttonBesideReader), OneWire::BadRead);
  EXPECT_FALSE(state.Found);
  adapter.Verify();
}

TEST_F(OneWireSearch, IsAtTheEndOnceTheLastDeviceHasLeft) {
  ASSERT_EQ(SearchInATick(zeroPath, buttonAlone), 1);
  EXPECT_EQ(NextInATick(0xCF), 0);
  EXPECT_FALSE(state.Found);
  adapter.Verify();
}

TEST_F(OneWireSearch, DoesNotKnowTheEndFromABadReadOfTheLastDevice) {
  const Bytes nobody(16, 0xFF);
  for (const Bytes& answer : {nobody, zeroPath}) {
    ASSERT_EQ(SearchInATick(zeroPath, buttonAlone), 1);
    EXPECT_EQ(SearchInATick(buttonAlone, answer), OneWire::BadRead);
    EXPECT_FALSE(state.Found);
  }
}

TEST_F(OneWireSearch, BeginsAnewAfterABusWithoutDevices) {
  ASSERT_EQ(SearchInATick(zeroPath, buttonBesideReader), 1);
  EXPECT_EQ(NextInATick(0xCF), OneWire::BadRead);  // it stood on the first of two
  EXPECT_EQ(NextInATick(0xCF), 0);
  EXPECT_FALSE(state.Found);
  EXPECT_EQ(state.Branch, OneWireState::None);
  EXPECT_THAT(state.Rom, Each(0));
}

TEST_F(OneWireSearch, ReadsNothingFromAButtonThatLeavesInTheMiddle) {
  const std::int32_t handle = Start();
  Bytes answer = buttonAlone;
  std::fill(answer.begin() + 9, answer.end(), std::uint8_t{0xFF});
  ExpectSearch(zeroPath, answer);
  EXPECT_EQ(wire.TMNext(handle, state), OneWire::BadRead);
  EXPECT_FALSE(state.Found);
  EXPECT_EQ(NextStep(handle, zeroPath, buttonAlone), 1);
  adapter.Verify();
}

TEST_F(OneWireSearch, ReadsNothingWithAWrongCheckByte) {
  const std::int32_t handle = Start();
  Bytes answer = buttonAlone;
  answer[15] = 0x08;
  ExpectSearch(zeroPath, answer);
  EXPECT_EQ(wire.TMNext(handle, state), OneWire::BadRead);
}

TEST_F(OneWireSearch, ReadsNothingFromABusThatIsShortedMeanwhile) {
  const std::int32_t handle = Start();
  ExpectSearch(zeroPath, zeroPath);
  EXPECT_EQ(wire.TMNext(handle, state), OneWire::BadRead);
}

TEST_F(OneWireSearch, ReadsNothingWhenNobodyAnswersIt) {
  const std::int32_t handle = Start();
  ExpectSearch(zeroPath, Bytes(16, 0xFF));
  EXPECT_EQ(wire.TMNext(handle, state), OneWire::BadRead);
}

/// After the session the chip is back in command mode with the accelerator off, whatever it was sent.
TEST_F(OneWireSearch, GivesUpOnAChipThatFallsSilent) {
  const std::int32_t handle = Start();
  adapter.Expect({0xE1, 0xF0, 0xE3, 0xB1, 0xE1}, {});
  adapter.Expect(zeroPath, {});
  adapter.Expect({0xE3, 0xA1}, {});
  EXPECT_EQ(wire.TMNext(handle, state), OneWire::BadRead);
  EXPECT_THAT(events.Now(), Le(230ms));
  const auto given = events.Now();
  EXPECT_EQ(wire.TMNext(handle, state), OneWire::BadRead);
  EXPECT_EQ(wire.TMTouchByte(handle, 0xFF), 255);
  EXPECT_EQ(events.Now(), given);
  adapter.Expect({0xE3, 0xA1}, {});
  EXPECT_EQ(wire.TMEndSession(handle), 1);
  adapter.Verify();
}

TEST_F(OneWireSearch, ReadsNothingFromAnAnswerThatIsCutShort) {
  const std::int32_t handle = Start();
  ExpectSearch(zeroPath, Bytes(buttonAlone.begin(), buttonAlone.end() - 1));
  EXPECT_EQ(wire.TMNext(handle, state), OneWire::BadRead);
}

TEST_F(OneWireSearch, ReadsNothingFromAnAnswerThatIsOutOfStep) {
  const std::int32_t handle = Start();
  adapter.Expect({0xE1, 0xF0}, {0x0F, 0xF0});
  adapter.Expect({0xE3, 0xB1, 0xE1}, {});
  adapter.Expect(zeroPath, buttonAlone);
  adapter.Expect({0xE3, 0xA1}, {});
  EXPECT_EQ(wire.TMNext(handle, state), OneWire::BadRead);
  adapter.Expect({0xE3, 0xA1}, {});
  wire.TMEndSession(handle);
  adapter.Verify();
}

TEST_F(OneWireSearch, IsNotDisturbedByInputFromBeforeTheSession) {
  adapter.Expect({0xC1}, {0xCD, 0xCD});
  const std::int32_t handle = wire.TMExtendedStartSession(1, 5, 0);
  ExpectSearch(zeroPath, buttonAlone);
  EXPECT_EQ(wire.TMNext(handle, state), 1);
}

TEST_F(OneWireSearch, FindsNothingOnALineThatIsPulledOutAtAnyByte) {
  for (std::size_t left = 1; left <= 24; ++left) {
    FakeSerialPort line;
    ScriptedAdapter script(line);
    SerialOneWire driver(line, events, ini, devices);
    script.Expect({0xC1}, {0xCD});
    script.Expect({0xE1, 0xF0}, {0xF0});
    script.Expect({0xE3, 0xB1, 0xE1}, {});
    script.Expect(zeroPath, buttonAlone);
    const auto onOutput = line.OnOutput;
    line.OnOutput = [&](std::uint8_t byte) {
      onOutput(byte);
      if (line.Sent.size() == left) {
        line.Lose();
      }
    };
    const std::int32_t handle = driver.TMExtendedStartSession(1, 5, 0);
    ASSERT_GT(handle, 0);
    state = {};
    // All answers are here once the path was sent, so only the two last bytes do not matter any more.
    EXPECT_EQ(driver.TMNext(handle, state), left == 24 ? OneWire::DeviceFound : OneWire::BadRead) << left;
    EXPECT_EQ(driver.TMEndSession(handle), 1);
    EXPECT_FALSE(line.PortOpen());
    line.FailNextOpen(8002);
    EXPECT_EQ(driver.TMExtendedStartSession(1, 5, 0), 0);
  }
}

}  // namespace
