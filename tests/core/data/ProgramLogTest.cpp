#include "core/data/ProgramLog.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeFiles.h"

namespace {

using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;
using testing::StartsWith;

constexpr const char* Path = "/data/logs/program.log";
constexpr const char* Older = "/data/logs/program.1.log";

class Log : public testing::Test {
 protected:
  std::string Rows() const { return files.FileExists(Path) ? files.Read(Path) : ""; }

  FakeFiles files;
  FakeClock clock;
  ProgramLog log{files, clock, "/data"};
};

TEST_F(Log, HasARowForEachStep) {
  files.AddFolder("/data");
  log.Started({"Tessarine 1", "Screen 1024 x 768"});
  clock.DateAndTime = "2013-05-21 14:31:00";
  log.Command("mnuGetKeshData");
  log.PortOpening("/dev/ttyS0", "19200,N,8,1", 0);
  log.PortOpening("/dev/ttyS0", "19200,N,8,1", 8005);
  log.BoxOpened("Title", "First line\n\nSecond line");
  log.BoxClosed("Cancel");
  log.Ended(0);
  EXPECT_EQ(Rows(),
            "2013-05-21 14:30:05  start    Tessarine 1\n"
            "2013-05-21 14:30:05  start    Screen 1024 x 768\n"
            "2013-05-21 14:31:00  command  mnuGetKeshData\n"
            "2013-05-21 14:31:00  port     /dev/ttyS0 19200,N,8,1 open\n"
            "2013-05-21 14:31:00  port     /dev/ttyS0 19200,N,8,1 fault 8005\n"
            "2013-05-21 14:31:00  box      Title: First line | Second line\n"
            "2013-05-21 14:31:00  answer   Cancel\n"
            "2013-05-21 14:31:00  end      exit code 0\n");
}

TEST_F(Log, TellsInWhichCommandAFaultCame) {
  files.AddFolder("/data");
  log.Fault("Run-time error '6': Overflow");
  log.Command("mnuLoadScores");
  log.Fault("Run-time error '6': Overflow");
  EXPECT_THAT(Rows(), StartsWith("2013-05-21 14:30:05  fault    Run-time error '6': Overflow\n"));
  EXPECT_THAT(Rows(), EndsWith("fault    Run-time error '6': Overflow (latest command mnuLoadScores)\n"));
}

TEST_F(Log, HoldsNothingOfAPerson) {
  files.AddFolder("/data");
  log.BoxOpened("Photo of '/home/jane/Jane.jpg'", "code = 01A2B3C4D5E6F708");
  log.Fault("Disk full: /data/scores/Jane Doe.doc");
  EXPECT_THAT(Rows(), testing::Not(testing::AnyOf(HasSubstr("jane"), HasSubstr("Jane"), HasSubstr("01A2"))));
  EXPECT_THAT(Rows(), HasSubstr("code = (number)\n"));
  EXPECT_THAT(Rows(), HasSubstr("Disk full: (a .doc file)\n"));
}

TEST_F(Log, WaitsForTheDataFolderAndDoesNotMakeIt) {
  log.Started({"Tessarine 1"});
  log.BoxOpened("Title", "Text");
  EXPECT_FALSE(files.FolderExists("/data"));
  EXPECT_EQ(files.Appends, 0);
  files.AddFolder("/data");
  log.BoxClosed("OK");
  EXPECT_THAT(Rows(), testing::ContainsRegex("start .*\n.*box .*\n.*answer   OK\n$"));
}

TEST_F(Log, KeepsNoMoreThanSomeRowsWhileItWaits) {
  for (int row = 0; row < 10'000; ++row) {
    log.Command("mnuLoadScores");
  }
  files.AddFolder("/data");
  log.Ended(1);
  EXPECT_THAT(Rows(), SizeIs(testing::Lt(70'000U)));
  EXPECT_THAT(Rows(), EndsWith("end      exit code 1\n"));
}

TEST_F(Log, GoesOnInASecondFileWhenTheFirstIsFull) {
  files.Put(Path, std::string(ProgramLog::FileBytes - 1, 'x'));
  log.Ended(0);
  EXPECT_EQ(Rows(), "2013-05-21 14:30:05  end      exit code 0\n");
  EXPECT_THAT(files.Read(Older), SizeIs(ProgramLog::FileBytes - 1));
}

TEST_F(Log, IsNeverAReasonToFail) {
  files.AddFolder("/data");
  files.FailCreateFolder("/data/logs", RuntimeError(70));
  EXPECT_NO_THROW(log.Command("mnuLoadScores"));
  files.AddFolder("/data/logs");
  files.FailReplace(Path, RuntimeError(61));
  EXPECT_NO_THROW(log.Command("mnuLoadScores"));
  files.FreeBytes = 1000;
  EXPECT_NO_THROW(log.Command("mnuLoadScores"));
  EXPECT_THAT(files.Contents(), IsEmpty());
}

}  // namespace
