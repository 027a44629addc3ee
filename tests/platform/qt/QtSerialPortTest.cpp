#include "platform/qt/QtSerialPort.h"

#include <gtest/gtest.h>
#include <sys/file.h>
#include <sys/ioctl.h>
#include <sys/stat.h>

#include <QSocketNotifier>
#include <QTemporaryDir>
#include <QTemporaryFile>
#include <QTimer>
#include <cerrno>
#include <chrono>
#include <thread>

#include "platform/qt/QtEventPump.h"
#include "tests/platform/qt/PseudoTerminal.h"
#include "tests/support/FailureOf.h"
#include "tests/support/ProcessorTime.h"

using namespace std::chrono_literals;

namespace {

using Bytes = std::vector<std::uint8_t>;

/// A second descriptor for a terminal's near end.
class SecondOpener {
 public:
  explicit SecondOpener(const std::string& device)
      : descriptor_(::open(device.c_str(), O_RDWR | O_NOCTTY | O_NONBLOCK | O_CLOEXEC)) {}
  ~SecondOpener() { ::close(descriptor_); }
  SecondOpener(const SecondOpener&) = delete;
  SecondOpener& operator=(const SecondOpener&) = delete;

  bool SetExclusive(bool on) const { return ::ioctl(descriptor_, on ? TIOCEXCL : TIOCNXCL) == 0; }
  bool IsExclusive() const {
    int exclusive = 0;
    return ::ioctl(descriptor_, TIOCGEXCL, &exclusive) == 0 && exclusive != 0;
  }
  bool Lock() const { return ::flock(descriptor_, LOCK_EX | LOCK_NB) == 0; }
  /// True once the line has accepted no more bytes for 100 ms.
  bool AwaitFull() const {
    pollfd writable{descriptor_, POLLOUT, 0};
    const auto limit = std::chrono::steady_clock::now() + 2s;
    while (::poll(&writable, 1, 100) != 0) {
      if (std::chrono::steady_clock::now() > limit) {
        return false;
      }
      std::this_thread::yield();
    }
    return true;
  }

  bool AwaitInput() const {
    pollfd readable{descriptor_, POLLIN, 0};
    return ::poll(&readable, 1, 2000) == 1;
  }

 private:
  int descriptor_;
};

class QtSerialPortTest : public testing::Test {
 protected:
  void Open(const std::string& settings = "19200,N,8,1") { Port.Open(Line.Device(), settings); }

  int OpenFailure(const std::string& device, const std::string& settings = "19200,N,8,1") {
    return FailureOf([&] { Port.Open(device, settings); });
  }

  void PutOut(int count) {
    for (int i = 0; i < count; ++i) {
      Port.Output(85);
    }
  }

  bool Await(std::size_t count) {
    return Pump.WaitFor([&] { return Port.InBufferCount() >= count; }, 5s) == WaitResult::Met;
  }

  Bytes Take(std::size_t count) {
    Bytes bytes;
    for (; count > 0 && Await(1); --count) {
      bytes.push_back(Port.Input());
    }
    return bytes;
  }

  QtEventPump Pump;
  PseudoTerminal Line;
  QtSerialPort Port;
};

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

TEST_F(QtSerialPortTest, AppliesTheSettingsToTheLine) {
  const std::vector<std::pair<std::string, speed_t>> speeds{
      {"19200,N,8,1", B19200}, {"19200,n,8,1", B19200}, {"57600,N,8,1", B57600}, {"115200,N,8,1", B115200}};
  for (const auto& [settings, speed] : speeds) {
    Open(settings);
    const termios applied = Line.Settings();
    EXPECT_EQ(cfgetospeed(&applied), speed) << settings;
    EXPECT_EQ(applied.c_cflag & CSIZE, static_cast<tcflag_t>(CS8)) << settings;
    EXPECT_EQ(applied.c_cflag & (CSTOPB | CRTSCTS), 0U) << settings;
    EXPECT_EQ(applied.c_iflag & (IXON | IXOFF), 0U) << settings;
    Port.Close();
  }
  Open("9600,E,8,2");
  const termios applied = Line.Settings();
  EXPECT_EQ(cfgetospeed(&applied), static_cast<speed_t>(B9600));
  EXPECT_NE(applied.c_cflag & CSTOPB, 0U);
}

TEST_F(QtSerialPortTest, ChangesTheSettingsOfTheOpenLine) {
  Open("19200,N,8,1");
  Port.SetSettings("115200,n,8,2");
  const termios applied = Line.Settings();
  EXPECT_EQ(cfgetospeed(&applied), static_cast<speed_t>(B115200));
  EXPECT_NE(applied.c_cflag & CSTOPB, 0U);
  Port.SetSettings("19200,N,8,1");
  Line.Write({1, 2});
  EXPECT_EQ(Take(2), (Bytes{1, 2}));
}

/// The last ones can be read, but a pseudo terminal has 8 data bits only.
TEST_F(QtSerialPortTest, KeepsItsSettingsWhenTheNewOnesCannotBeHad) {
  Open("19200,N,8,1");
  for (const char* settings : {"", "19200,X,8,1", "0,N,8,1", "115200,N,9,1", "115200,N,7,1"}) {
    EXPECT_EQ(FailureOf([&] { Port.SetSettings(settings); }), 380) << settings;
  }
  const termios applied = Line.Settings();
  EXPECT_EQ(cfgetospeed(&applied), static_cast<speed_t>(B19200));
  EXPECT_TRUE(Port.PortOpen());
}

TEST_F(QtSerialPortTest, ChangesTheSettingsOnceWhatIsUnderWayIsThrough) {
  Open("19200,N,8,1");
  const auto start = std::chrono::steady_clock::now();
  PutOut(100);
  Port.SetSettings("115200,N,8,1");
  EXPECT_GE(std::chrono::steady_clock::now() - start, 52ms);
}

// The system's own drain returns at once on these lines, since they pass bytes on faster than any real one.

TEST_F(QtSerialPortTest, DrainsUntilTheBytesHaveHadTheirTimeOnTheLine) {
  const std::vector<std::pair<std::string, std::chrono::microseconds>> timesOf40Bytes{
      {"19200,N,8,1", 20833us}, {"9600,N,8,1", 41666us}, {"9600,E,8,2", 50000us}, {"57600,N,8,1", 6944us}};
  for (const auto& [settings, time] : timesOf40Bytes) {
    Open(settings);
    const auto start = std::chrono::steady_clock::now();
    PutOut(40);
    Port.Drain();
    EXPECT_GE(std::chrono::steady_clock::now() - start, time) << settings;
    Port.Close();
  }
}

TEST_F(QtSerialPortTest, DrainCountsFromWhereTheLineWasLastIdle) {
  Open("9600,N,8,1");
  PutOut(20);
  Port.Drain();
  std::this_thread::sleep_for(20ms);
  const auto start = std::chrono::steady_clock::now();
  PutOut(20);
  std::this_thread::sleep_for(5ms);
  PutOut(20);
  Port.Drain();
  EXPECT_GE(std::chrono::steady_clock::now() - start, 41666us);
}

TEST_F(QtSerialPortTest, DrainOfAnIdleLineReturnsAtOnce) {
  Open("9600,N,8,1");
  PutOut(96);
  Port.Drain();
  const auto processor = ProcessorTime();
  for (int i = 0; i < 1000; ++i) {
    Port.Drain();  // 100 s, were the old bytes counted again
  }
  EXPECT_LT(ProcessorTime() - processor, 100ms);
}

TEST_F(QtSerialPortTest, DrainsBeforeItCloses) {
  Open("9600,N,8,1");
  const auto start = std::chrono::steady_clock::now();
  PutOut(40);
  Port.Close();
  EXPECT_GE(std::chrono::steady_clock::now() - start, 41666us);
}

TEST_F(QtSerialPortTest, ALossIsNoticedByADrainBeforeAnyEvent) {
  Open();
  Line.Unplug();
  EXPECT_EQ(FailureOf([&] { Port.Drain(); }), 8012);
  EXPECT_EQ(FailureOf([&] { Port.SetSettings("9600,N,8,1"); }), 8012);
  EXPECT_EQ(FailureOf([&] { Port.InBufferCount(); }), 8012);
}

TEST_F(QtSerialPortTest, RefusesSettingsThatCannotBeRead) {
  for (const char* settings :
       {"", "19200", "19200,N,8", "19200,N,8,1,0", "19200,X,8,1", "19200,,8,1", "19200,N,9,1", "19200,N,4,1",
        "19200,N,8,3", "19200,N,8,", "0,N,8,1", "-19200,N,8,1", "fast,N,8,1"}) {
    EXPECT_EQ(OpenFailure(Line.Device(), settings), 380) << settings;
    EXPECT_FALSE(Port.PortOpen());
  }
  Open();
  EXPECT_TRUE(Port.PortOpen());
}

TEST_F(QtSerialPortTest, FailsWithoutASerialDeviceAndStaysClosed) {
  QTemporaryFile file;
  ASSERT_TRUE(file.open());
  for (const std::string& device : {std::string("/dev/no-such-port"), std::string(), std::string("/dev"),
                                    std::string("/dev/null"), file.fileName().toStdString()}) {
    EXPECT_EQ(OpenFailure(device), 8002) << device;
    EXPECT_FALSE(Port.PortOpen());
  }
}

TEST_F(QtSerialPortTest, ADeviceThatThisUserMayNotTouchRefuses) {
  ASSERT_EQ(::chmod(Line.Device().c_str(), 0), 0);
  const uid_t user = ::geteuid();
  if (user == 0) {
    ASSERT_EQ(::seteuid(65534), 0);
  }
  const int failure = OpenFailure(Line.Device());
  ASSERT_EQ(::seteuid(user), 0);
  EXPECT_EQ(failure, 8005);
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(QtSerialPortTest, IsNotOpenedTwice) {
  Open();
  EXPECT_EQ(OpenFailure(Line.Device()), 8005);
  EXPECT_TRUE(Port.PortOpen());
  QtSerialPort other;
  EXPECT_EQ(FailureOf([&] { other.Open(Line.Device(), "19200,N,8,1"); }), 8005);
  EXPECT_FALSE(other.PortOpen());
  Port.Close();
  other.Open(Line.Device(), "19200,N,8,1");
  EXPECT_TRUE(other.PortOpen());
}

TEST_F(QtSerialPortTest, IsNotOpenedTwiceUnderAnotherNameEither) {
  const QTemporaryDir folder;
  const std::string link = folder.filePath(QStringLiteral("by-id")).toStdString();
  ASSERT_EQ(::symlink(Line.Device().c_str(), link.c_str()), 0);
  Open();
  QtSerialPort other;
  EXPECT_EQ(FailureOf([&] { other.Open(link, "19200,N,8,1"); }), 8005);
  Port.Close();
  other.Open(link, "19200,N,8,1");
  other.Output(5);
  EXPECT_EQ(Line.Read(1), Bytes{5});
}

TEST_F(QtSerialPortTest, ADeviceThatAnotherProgramHoldsIsAlreadyOpen) {
  {
    const SecondOpener program(Line.Device());
    ASSERT_TRUE(program.Lock());
    EXPECT_EQ(OpenFailure(Line.Device()), 8005);
    EXPECT_FALSE(Port.PortOpen());
  }
  Open();
  EXPECT_TRUE(Port.PortOpen());
}

/// As programs do that know of no lock; the system holds everyone to it but root.
TEST_F(QtSerialPortTest, ADeviceInAnotherProgramsExclusiveModeIsAlreadyOpen) {
  {
    const SecondOpener program(Line.Device());
    ASSERT_TRUE(program.SetExclusive(true));
    EXPECT_EQ(OpenFailure(Line.Device()), 8005);
    EXPECT_FALSE(Port.PortOpen());
    ASSERT_TRUE(program.SetExclusive(false));
  }
  Open();
  EXPECT_TRUE(Port.PortOpen());
}

TEST_F(QtSerialPortTest, HoldsTheDeviceInExclusiveModeWhileItIsOpen) {
  Open();
  const SecondOpener program(Line.Device());
  EXPECT_TRUE(program.IsExclusive());
  Port.Close();
  EXPECT_FALSE(program.IsExclusive());
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
