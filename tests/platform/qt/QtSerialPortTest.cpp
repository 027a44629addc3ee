#include "platform/qt/QtSerialPort.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <QSocketNotifier>
#include <QTemporaryDir>
#include <QTemporaryFile>
#include <QTimer>
#include <cerrno>
#include <chrono>

#include "tests/platform/qt/SerialPortSite.h"
#include "tests/support/ProcessorTime.h"

using namespace std::chrono_literals;

namespace {

TEST_F(QtSerialPortTest, ReceivesEveryByteValueAsItIs) {
  Open();
  Bytes all;
  for (int value = 0; value < 256; ++value) {
    all.push_back(static_cast<std::uint8_t>(value));
  }
  Line.Write(all);
  EXPECT_EQ(Take(256), all);
  EXPECT_EQ(Port.InBufferCount(), 0U);
}

TEST_F(QtSerialPortTest, SendsEveryByteValueAsItIs) {
  Open();
  Bytes all;
  for (int value = 0; value < 256; ++value) {
    all.push_back(static_cast<std::uint8_t>(value));
    Port.Output(all.back());
  }
  EXPECT_EQ(Line.Read(256), all);
}

TEST_F(QtSerialPortTest, SendsMoreThanTheSystemBuffers) {
  const Bytes all(100000, 85);
  const SecondOpener probe(Line.Device());
  Open();
  Bytes received;
  std::thread farEnd([&] {
    EXPECT_TRUE(probe.AwaitFull());
    received = Line.Read(all.size());
  });
  for (const std::uint8_t byte : all) {
    Port.Output(byte);
  }
  farEnd.join();
  EXPECT_EQ(received, all);
}

TEST_F(QtSerialPortTest, ALineThatTakesNothingIsLost) {
  Open();
  EXPECT_EQ(FailureOf([&] {
              for (int count = 0; count < 1000000; ++count) {
                Port.Output(85);
              }
            }),
            8012);
  EXPECT_EQ(FailureOf([&] { Port.Output(85); }), 8012);
  EXPECT_TRUE(Port.PortOpen());
}

TEST_F(QtSerialPortTest, PutsAByteOnTheLineWithoutTheEventLoop) {
  Open();
  Port.Output(1);
  EXPECT_EQ(Line.Read(1), Bytes{1});
  Port.Output(0);
  EXPECT_EQ(Line.Read(1), Bytes{0});
}

TEST_F(QtSerialPortTest, ReceivesWhileEventsAreServedOnly) {
  const SecondOpener probe(Line.Device());
  Open();
  Line.Write({170});
  ASSERT_TRUE(probe.AwaitInput());
  EXPECT_EQ(Port.InBufferCount(), 0U);
  ASSERT_TRUE(Await(1));
  EXPECT_EQ(Port.Input(), 170);
}

TEST_F(QtSerialPortTest, KeepsMoreInputThanTheSystemBuffers) {
  Open();
  Bytes sent;
  for (std::size_t block = 0; block < 100; ++block) {
    const Bytes part(1000, static_cast<std::uint8_t>(block));
    Line.Write(part);
    sent.insert(sent.end(), part.begin(), part.end());
    ASSERT_TRUE(Await(sent.size()));
  }
  EXPECT_EQ(Take(sent.size()), sent);
}

TEST_F(QtSerialPortTest, DropsWhatWaitedOnTheLineBeforeTheOpen) {
  for (std::uint8_t round = 0; round < 50; ++round) {
    Line.Write({101, 102, 103});
    Open();
    Line.Write({round});
    ASSERT_EQ(Take(1), Bytes{round});
    Port.Close();
  }
}

TEST_F(QtSerialPortTest, DropsWhatWasLeftUnreadAtTheClose) {
  Open();
  Line.Write({1, 2, 3});
  ASSERT_TRUE(Await(3));
  Port.Close();
  Open();
  EXPECT_EQ(Port.InBufferCount(), 0U);
}

TEST_F(QtSerialPortTest, ClearInputDropsWhatWasReceivedAndWhatWaits) {
  const SecondOpener probe(Line.Device());
  Open();
  Line.Write({1, 2});
  ASSERT_TRUE(Await(2));
  Line.Write({3});
  ASSERT_TRUE(probe.AwaitInput());
  Port.ClearInput();
  EXPECT_EQ(Port.InBufferCount(), 0U);
  Line.Write({4});
  EXPECT_EQ(Take(1), Bytes{4});
}

TEST_F(QtSerialPortTest, GoesOnReceivingWhenInputIsClearedAfterTheSystemAnnouncedIt) {
  int trigger[2] = {};
  ASSERT_EQ(::pipe(trigger), 0);
  QSocketNotifier early(trigger[0], QSocketNotifier::Read);
  const SecondOpener probe(Line.Device());
  Open();
  int cleared = 0;
  QObject::connect(&early, &QSocketNotifier::activated, &early, [&] {
    ++cleared;
    Port.ClearInput();
    early.setEnabled(false);
    errno = EAGAIN;  // a leftover value, which an empty read must not be judged by
  });
  Line.Write({1, 2, 3});
  ASSERT_TRUE(probe.AwaitInput());
  ASSERT_EQ(::write(trigger[1], "x", 1), 1);
  EXPECT_EQ(Pump.WaitFor([&] { return cleared > 0; }, 5s), WaitResult::Met);
  EXPECT_EQ(Port.InBufferCount(), 0U);
  Line.Write({4});
  EXPECT_EQ(Take(1), Bytes{4});
  ::close(trigger[0]);
  ::close(trigger[1]);
}

TEST_F(QtSerialPortTest, SendsWhatIsUnderWayBeforeItCloses) {
  Open();
  Port.Output(7);
  Port.Output(8);
  Port.Close();
  EXPECT_EQ(Line.Read(2), (Bytes{7, 8}));
}

TEST_F(QtSerialPortTest, FailsInAllOperationsWhileClosed) {
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_EQ(FailureOf([&] { Port.Drain(); }), 8018);
  EXPECT_EQ(FailureOf([&] { Port.SetSettings("9600,N,8,1"); }), 8018);
  EXPECT_EQ(FailureOf([&] { Port.InBufferCount(); }), 8018);
  EXPECT_EQ(FailureOf([&] { Port.Input(); }), 8018);
  EXPECT_EQ(FailureOf([&] { Port.Output(1); }), 8018);
  EXPECT_EQ(FailureOf([&] { Port.ClearInput(); }), 8018);
  EXPECT_EQ(FailureOf([&] { Port.Close(); }), 0);
}

TEST_F(QtSerialPortTest, ReadingPastTheInputFails) {
  Open();
  EXPECT_EQ(FailureOf([&] { Port.Input(); }), 62);
}

TEST_F(QtSerialPortTest, ALostLineWakesAWaitForInput) {
  Open();
  QTimer::singleShot(30, [&] { Line.Unplug(); });
  EXPECT_EQ(FailureOf([&] { Pump.WaitFor([&] { return Port.InBufferCount() > 0; }, 20s); }), 8012);
  EXPECT_EQ(FailureOf([&] { Port.Input(); }), 8012);
  EXPECT_EQ(FailureOf([&] { Port.Output(1); }), 8012);
  EXPECT_EQ(FailureOf([&] { Port.ClearInput(); }), 0);
}

TEST_F(QtSerialPortTest, WhatCameBeforeTheLossStaysReadable) {
  Open();
  Line.Write({1, 2});
  ASSERT_TRUE(Await(2));
  Line.Unplug();
  Pump.DoEvents();
  EXPECT_EQ(Port.InBufferCount(), 2U);
  EXPECT_EQ(FailureOf([&] { Port.Output(1); }), 8012);
  EXPECT_EQ(Port.Input(), 1);
  EXPECT_EQ(Port.Input(), 2);
  EXPECT_EQ(FailureOf([&] { Port.InBufferCount(); }), 8012);
}

TEST_F(QtSerialPortTest, ALossIsNoticedByAnOutputBeforeAnyEvent) {
  Open();
  Line.Unplug();
  EXPECT_EQ(FailureOf([&] { Port.Output(1); }), 8012);
  EXPECT_EQ(FailureOf([&] { Port.InBufferCount(); }), 8012);
}

TEST_F(QtSerialPortTest, ALossIsNoticedByClearingTheInputBeforeAnyEvent) {
  Open();
  Line.Unplug();
  EXPECT_EQ(FailureOf([&] { Port.ClearInput(); }), 0);
  EXPECT_EQ(FailureOf([&] { Port.InBufferCount(); }), 8012);
}

TEST_F(QtSerialPortTest, ALostLineStaysOpenUntilItIsClosedAndBurnsNoProcessorTime) {
  Open();
  Line.Unplug();
  const auto start = ProcessorTime();
  Pump.WaitFor([] { return false; }, 500ms);
  EXPECT_LT(ProcessorTime() - start, 50ms);
  EXPECT_TRUE(Port.PortOpen());
  EXPECT_EQ(OpenFailure(Line.Device()), 8005);
  Port.Close();
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_EQ(FailureOf([&] { Port.InBufferCount(); }), 8018);
  const PseudoTerminal other;
  Port.Open(other.Device(), "19200,N,8,1");
  EXPECT_EQ(Port.InBufferCount(), 0U);
}

TEST_F(QtSerialPortTest, AnIdleOpenLineBurnsNoProcessorTime) {
  Open();
  Port.Output(1);
  Line.Write({1});
  ASSERT_TRUE(Await(1));
  const auto start = ProcessorTime();
  Pump.WaitFor([] { return false; }, 500ms);
  EXPECT_LT(ProcessorTime() - start, 10ms);
}

}  // namespace
