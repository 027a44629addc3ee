#include "core/line/LoggedPort.h"

#include <gmock/gmock.h>

#include <memory>

#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/support/FailureOf.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;

constexpr const char* Device = "/dev/ttyS0";
constexpr const char* Settings = "19200,N,8,1";

class LoggedLine : public testing::Test {
 protected:
  LoggedLine() { files.AddFolder("/data"); }

  void Open() { port.Open(Device, Settings); }

  std::string LogOf(const std::string& instrument) const {
    const std::string path = "/data/logs/" + instrument + ".log";
    return files.FileExists(path) ? files.Read(path) : std::string();
  }

  FakeFiles files;
  FakeEventPump time;
  FakeClock clock;
  FakeSerialPort line;
  LoggedPort port{line, {files, "/data/logs", time, clock}, "box"};
};

TEST_F(LoggedLine, DoesWhatTheLineDoes) {
  Open();
  EXPECT_TRUE(port.PortOpen());
  line.Receive({5, 6, 7});
  EXPECT_EQ(port.InBufferCount(), 3U);
  EXPECT_EQ(port.Input(), 5);
  port.Output(9);
  port.SetSettings("9600,N,8,1");
  port.Drain();
  port.ClearInput();
  EXPECT_EQ(port.InBufferCount(), 0U);
  port.Close();
  port.Close();
  EXPECT_FALSE(port.PortOpen());
  EXPECT_THAT(line.Log, ElementsAre("Open /dev/ttyS0 19200,N,8,1", "Output 9", "Settings 9600,N,8,1",
                                    "ClearInput", "Close"));
  EXPECT_EQ(line.Drains.size(), 3U);
}

TEST_F(LoggedLine, PassesFaultsOn) {
  line.FailNextOpen(8005);
  EXPECT_EQ(FailureOf([&] { Open(); }), 8005);
  EXPECT_EQ(FailureOf([&] { port.Output(1); }), 8018);
  EXPECT_EQ(FailureOf([&] { port.InBufferCount(); }), 8018);
  EXPECT_EQ(FailureOf([&] { port.ClearInput(); }), 8018);
  EXPECT_EQ(FailureOf([&] { port.Drain(); }), 8018);
  EXPECT_EQ(FailureOf([&] { port.SetSettings(Settings); }), 8018);
  Open();
  EXPECT_EQ(FailureOf([&] { port.Input(); }), 62);
  line.Lose();
  EXPECT_EQ(FailureOf([&] { port.Input(); }), 8012);
}

TEST_F(LoggedLine, WritesAConversation) {
  Open();
  port.Output(1);
  port.Output(0);
  line.Receive({2, 0x34});
  port.Input();
  port.Input();
  port.SetSettings("115200,N,8,1");
  port.Close();
  EXPECT_EQ(LogOf("box"),
            "    0.000000 box -- opened /dev/ttyS0 19200,N,8,1 2013-05-21 14:30:05\n"
            "    0.000000 box <- 01 00\n"
            "    0.000000 box -> 02 34\n"
            "    0.000000 box -- settings 115200,N,8,1\n"
            "    0.000000 box -- closed\n");
}

TEST_F(LoggedLine, WritesNothingToTheDiskBeforeTheEnd) {
  Open();
  for (int byte = 0; byte < 2000; ++byte) {
    port.Output(1);
  }
  EXPECT_EQ(files.Appends, 0);
  port.Close();
  EXPECT_EQ(files.Appends, 1);
}

TEST_F(LoggedLine, WritesWhatWasDroppedUnread) {
  Open();
  line.Receive({1, 2});
  port.ClearInput();
  line.Receive({3});
  port.Input();
  line.Receive({4});
  port.Close();
  EXPECT_THAT(LogOf("box"), HasSubstr("    0.000000 box -> 01 02 dropped\n"
                                      "    0.000000 box -> 03\n"
                                      "    0.000000 box -> 04 dropped\n"
                                      "    0.000000 box -- closed\n"));
}

TEST_F(LoggedLine, WritesWhyItDidNotOpen) {
  line.FailNextOpen(8005);
  EXPECT_EQ(FailureOf([&] { Open(); }), 8005);
  EXPECT_EQ(LogOf("box"),
            "    0.000000 box -- not opened /dev/ttyS0 19200,N,8,1: 8005 Port already open "
            "2013-05-21 14:30:05\n");
}

TEST_F(LoggedLine, WritesAFaultOnceAndNotForEachByte) {
  Open();
  line.FailOutput(8012);
  for (int byte = 0; byte < 10; ++byte) {
    EXPECT_EQ(FailureOf([&] { port.Output(1); }), 8012);
  }
  port.Close();
  Open();
  EXPECT_EQ(FailureOf([&] { port.Output(1); }), 8012);
  port.Close();
  const std::string opened = "    0.000000 box -- opened /dev/ttyS0 19200,N,8,1 2013-05-21 14:30:05\n";
  const std::string rest =
      "    0.000000 box -- fault 8012 The device is not open\n    0.000000 box -- closed\n";
  EXPECT_EQ(LogOf("box"), opened + rest + opened + rest);
}

TEST_F(LoggedLine, TellsOnceThatItIsLost) {
  int lost = 0;
  LoggedPort told(
      line,
      {.Disk = files, .Folder = "/data/logs", .Elapsed = time, .Time = clock, .OnLost = [&lost] { ++lost; }},
      "box");
  told.Open(Device, Settings);
  EXPECT_EQ(FailureOf([&] { told.Input(); }), 62);
  EXPECT_EQ(lost, 0);
  line.Lose();
  for (int byte = 0; byte < 3; ++byte) {
    EXPECT_EQ(FailureOf([&] { told.InBufferCount(); }), 8012);
  }
  EXPECT_EQ(lost, 1);
  told.Close();
  told.Open(Device, Settings);
  line.Lose();
  EXPECT_EQ(FailureOf([&] { told.Output(1); }), 8012);
  EXPECT_EQ(lost, 2);
}

TEST_F(LoggedLine, WritesTheFaultOfALineThatWasNeverOpen) {
  EXPECT_EQ(FailureOf([&] { port.Output(1); }), 8018);
  EXPECT_EQ(FailureOf([&] { port.Output(1); }), 8018);
  EXPECT_EQ(LogOf("box"), "    0.000000 box -- fault 8018 Operation valid only when the port is open\n");
}

TEST_F(LoggedLine, KeepsATranscriptForEachInstrument) {
  port.SetInstrument("radio");
  Open();
  port.Output(1);
  port.SetInstrument("box");
  port.Output(2);
  port.Close();
  Open();
  port.Output(3);
  port.Close();
  EXPECT_THAT(LogOf("radio"), HasSubstr(" radio <- 01 02\n"));
  EXPECT_THAT(LogOf("box"), HasSubstr(" box <- 03\n"));
  EXPECT_THAT(LogOf("box"), Not(HasSubstr("01 02")));
}

TEST_F(LoggedLine, CountsThePollsOfAReaderThatRepeatTheLastOne) {
  LoggedPort reader(line, {files, "/data/logs", time, clock}, "1-wire", Transcript::Repeats::Counted);
  for (int second = 0; second < 60; ++second) {
    clock.DateAndTime = "2013-05-21 14:30:" + std::to_string(second);
    reader.Open(Device, Settings);
    reader.Output(0xC1);
    line.Receive({0xCD});
    reader.Input();
    reader.Close();
  }
  line.FailNextOpen(8002);
  EXPECT_EQ(FailureOf([&] { reader.Open(Device, Settings); }), 8002);
  EXPECT_EQ(LogOf("1-wire"),
            "    0.000000 1-wire -- opened /dev/ttyS0 19200,N,8,1 2013-05-21 14:30:0\n"
            "    0.000000 1-wire <- C1\n"
            "    0.000000 1-wire -> CD\n"
            "    0.000000 1-wire -- closed\n"
            "    0.000000 1-wire -- the last ones again, 59 times\n"
            "    0.000000 1-wire -- not opened /dev/ttyS0 19200,N,8,1: 8002 Invalid port number "
            "2013-05-21 14:30:59\n");
}

TEST_F(LoggedLine, WorksWhereNoTranscriptCanBeWritten) {
  files.FreeBytes = 0;
  Open();
  port.Output(1);
  port.Close();
  LoggedPort nowhere(line, {files, "/none/logs", time, clock}, "box");
  nowhere.Open(Device, Settings);
  nowhere.Output(2);
  nowhere.Close();
  EXPECT_THAT(line.Sent, ElementsAre(1, 2));
  EXPECT_EQ(files.Appends, 0);
}

TEST_F(LoggedLine, WritesWhatIsLeftWhenTheProgramEndsOnAnOpenLine) {
  auto other = std::make_unique<LoggedPort>(line, LoggedPort::Parts{files, "/data/logs", time, clock}, "box");
  other->Open(Device, Settings);
  other->Output(1);
  other.reset();
  EXPECT_THAT(LogOf("box"), HasSubstr(" box <- 01\n"));
}

}  // namespace
