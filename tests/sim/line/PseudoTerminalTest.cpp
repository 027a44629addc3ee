#include "sim/line/PseudoTerminal.h"

#include <gtest/gtest.h>

#include <numeric>
#include <thread>

#include "tests/support/RawHost.h"

namespace sim {
namespace {

using SteadyClock = std::chrono::steady_clock;
using std::chrono::milliseconds;

Bytes AllByteValues() {
  Bytes bytes(256);
  std::iota(bytes.begin(), bytes.end(), std::uint8_t{0});
  return bytes;
}

// Ten bits a byte.
std::chrono::duration<double> WireTime(std::size_t bytes, int baud) {
  return std::chrono::duration<double>(static_cast<double>(bytes) * 10.0 / baud);
}

TEST(PseudoTerminal, CarriesEveryByteValueToTheClient) {
  PseudoTerminal line(19200, Pace::Fast);
  RawHost host(line.SlavePath());
  EXPECT_EQ(line.Write(AllByteValues()), 256U);
  EXPECT_EQ(host.Read(256), AllByteValues());
}

TEST(PseudoTerminal, CarriesEveryByteValueFromTheClientAndEchoesNone) {
  PseudoTerminal line(19200, Pace::Fast);
  RawHost host(line.SlavePath());
  host.Write(AllByteValues());
  for (const std::uint8_t value : AllByteValues()) {
    EXPECT_EQ(line.ReadByte(Limit), value);
  }
  EXPECT_TRUE(host.IsSilent());
}

TEST(PseudoTerminal, SurvivesAClientThatClosesAndComesBack) {
  PseudoTerminal line(19200, Pace::Fast);
  RawHost(line.SlavePath()).Write({1});
  EXPECT_EQ(line.ReadByte(Limit), 1);
  EXPECT_EQ(line.ReadByte(milliseconds(20)), std::nullopt);
  RawHost host(line.SlavePath());
  host.Write({2});
  EXPECT_EQ(line.ReadByte(Limit), 2);
  line.Write(Bytes{3});
  EXPECT_EQ(host.Read(1), Bytes{3});
}

TEST(PseudoTerminal, WaitsForAByteAsLongAsToldAndNoShorter) {
  PseudoTerminal line(19200, Pace::Fast);
  const SteadyClock::time_point start = SteadyClock::now();
  EXPECT_EQ(line.ReadByte(milliseconds(30)), std::nullopt);
  EXPECT_GE(SteadyClock::now() - start, milliseconds(30));
}

TEST(PseudoTerminal, NeverSendsAByteBeforeItsLastBitIsThrough) {
  for (const int baud : {19200, 57600, 115200}) {
    PseudoTerminal line(baud, Pace::AsWired);
    RawHost host(line.SlavePath());
    const SteadyClock::time_point start = SteadyClock::now();
    std::thread device([&] { line.Write(AllByteValues()); });
    for (std::size_t i = 1; i <= 256; ++i) {
      EXPECT_EQ(host.ReadByte(), static_cast<std::uint8_t>(i - 1));
      EXPECT_GE(SteadyClock::now() - start, WireTime(i, baud)) << "byte " << i << " at " << baud;
    }
    device.join();
  }
}

TEST(PseudoTerminal, KeepsToANewSpeedFromItsChangeOn) {
  PseudoTerminal line(115200, Pace::AsWired);
  RawHost host(line.SlavePath());
  line.SetBaud(1200);
  const SteadyClock::time_point start = SteadyClock::now();
  line.Write(Bytes(6, 0x55));
  EXPECT_GE(SteadyClock::now() - start, WireTime(6, 1200));
  host.Speak({.Baud = 1200});
  host.Write(Bytes(6, 0x55));
  for (std::size_t i = 7; i <= 12; ++i) {
    EXPECT_EQ(line.ReadByte(Limit), 0x55);
    EXPECT_GE(SteadyClock::now() - start, WireTime(i, 1200)) << "byte " << i;
  }
}

TEST(PseudoTerminal, ReceivesNoFasterThanTheLineCarries) {
  PseudoTerminal line(19200, Pace::AsWired);
  RawHost host(line.SlavePath());
  const SteadyClock::time_point start = SteadyClock::now();
  host.Write(Bytes(40, 0x55));
  for (std::size_t i = 1; i <= 40; ++i) {
    EXPECT_EQ(line.ReadByte(Limit), 0x55);
    EXPECT_GE(SteadyClock::now() - start, WireTime(i, 19200)) << "byte " << i;
  }
}

TEST(PseudoTerminal, HoldsAByteBackUntilItsLastBitIsThroughHoweverOftenAsked) {
  PseudoTerminal line(300, Pace::AsWired);
  RawHost host(line.SlavePath());
  const SteadyClock::time_point start = SteadyClock::now();
  host.Write({1});
  std::optional<std::uint8_t> byte;
  while (!byte && SteadyClock::now() - start < Limit) {
    byte = line.ReadByte(std::chrono::microseconds(100));
  }
  EXPECT_EQ(byte, 1);
  EXPECT_GE(SteadyClock::now() - start, WireTime(1, 300));
}

TEST(PseudoTerminal, LetsBytesOfOneWriteFollowWithoutGapsHoweverLateTheyAreAskedFor) {
  PseudoTerminal line(19200, Pace::AsWired);
  RawHost host(line.SlavePath());
  host.Write(AllByteValues());
  EXPECT_EQ(line.ReadByte(Limit), 0);
  std::this_thread::sleep_for(WireTime(256, 19200));
  for (std::size_t i = 1; i < 256; ++i) {
    EXPECT_EQ(line.ReadByte(std::chrono::nanoseconds(0)), static_cast<std::uint8_t>(i));
  }
}

TEST(PseudoTerminal, LosesWhatAClientThatDoesNotReadHasNoRoomFor) {
  PseudoTerminal line(19200, Pace::Fast);
  RawHost host(line.SlavePath());
  std::size_t taken = 0;
  std::size_t given = 0;
  while (taken == given && given < 10'000'000) {
    taken += line.Put(AllByteValues());
    given += 256;
  }
  EXPECT_LT(taken, given);
  EXPECT_EQ(host.Read(taken).size(), taken);
  EXPECT_EQ(line.Put(Bytes{7}), 1U);
  EXPECT_EQ(host.Read(1), Bytes{7});
}

TEST(PseudoTerminal, NeedsNoTimeForBytesOfALineThatIsNotPaced) {
  EXPECT_EQ(PseudoTerminal(19200, Pace::Fast).DurationOf(5), std::chrono::nanoseconds(0));
  EXPECT_EQ(PseudoTerminal(57600, Pace::AsWired).DurationOf(144), std::chrono::milliseconds(25));
}

TEST(PseudoTerminal, WaitsForAClientThatReadsSlowerThanItSends) {
  PseudoTerminal line(19200, Pace::Fast);
  RawHost host(line.SlavePath());
  const Bytes flood(200'000, 0xA5);
  std::size_t sent = 0;
  std::thread device([&] { sent = line.Write(flood); });
  EXPECT_EQ(host.Read(flood.size()), flood);
  device.join();
  EXPECT_EQ(sent, flood.size());
}

TEST(PseudoTerminal, TearsAWriteIntoPiecesWithPauses) {
  PseudoTerminal line(19200, Pace::Fast);
  RawHost host(line.SlavePath());
  const SteadyClock::time_point start = SteadyClock::now();
  std::thread device([&] { line.WriteTorn(AllByteValues()); });
  EXPECT_EQ(host.Read(256), AllByteValues());
  // At most three bytes between two pauses of 3 ms.
  EXPECT_GE(SteadyClock::now() - start, milliseconds(3 * (256 / 3 - 1)));
  device.join();
}

TEST(PseudoTerminal, HangsUpOnTheClient) {
  PseudoTerminal line(19200, Pace::Fast);
  RawHost host(line.SlavePath());
  line.HangUp();
  EXPECT_EQ(host.ReadByte(), std::nullopt);
  EXPECT_TRUE(host.HungUp());
  EXPECT_EQ(line.ReadByte(), std::nullopt);
  EXPECT_EQ(line.Write(Bytes{1}), 0U);
  EXPECT_EQ(line.Put(Bytes{1}), 0U);
  EXPECT_FALSE(line.IsUp());
}

TEST(PseudoTerminal, LetsTheClientCloseFirst) {
  PseudoTerminal line(19200, Pace::Fast);
  std::optional<RawHost> host(line.SlavePath());
  EXPECT_FALSE(line.WaitForClientToClose(milliseconds(20)));
  host.reset();
  EXPECT_TRUE(line.WaitForClientToClose(Limit));
}

TEST(PseudoTerminal, AnInterruptionEndsAWaitForAByte) {
  PseudoTerminal line(19200, Pace::Fast);
  std::thread device([&] { EXPECT_EQ(line.ReadByte(), std::nullopt); });
  line.Interrupt();
  device.join();
  EXPECT_EQ(line.ReadByte(), std::nullopt);
}

TEST(PseudoTerminal, ANudgeEndsOneWaitForAByteAndNoOther) {
  PseudoTerminal line(19200, Pace::Fast);
  RawHost host(line.SlavePath());
  std::thread device([&] { EXPECT_EQ(line.ReadByte(), std::nullopt); });
  line.Nudge();
  device.join();
  EXPECT_TRUE(line.IsUp());
  line.Nudge();
  host.Write({7});
  EXPECT_EQ(line.ReadByte(Limit), std::nullopt);
  EXPECT_EQ(line.ReadByte(Limit), 7);
}

TEST(PseudoTerminal, AnInterruptionEndsAWriteInTheMiddle) {
  PseudoTerminal line(300, Pace::AsWired);
  RawHost host(line.SlavePath());
  std::size_t sent = 0;
  std::thread device([&] { sent = line.Write(AllByteValues()); });
  EXPECT_EQ(host.Read(2), (Bytes{0, 1}));
  line.Interrupt();
  device.join();
  EXPECT_GE(sent, 2U);
  EXPECT_LT(sent, 256U);
}

TEST(PseudoTerminal, AnInterruptionEndsAWriteThatNobodyReads) {
  PseudoTerminal line(19200, Pace::Fast);
  RawHost host(line.SlavePath());
  std::size_t sent = 0;
  const Bytes flood(10'000'000, 1);
  std::thread device([&] { sent = line.Write(flood); });
  EXPECT_EQ(host.Read(1).size(), 1U);
  line.Interrupt();
  device.join();
  EXPECT_LT(sent, flood.size());
}

}  // namespace
}  // namespace sim
