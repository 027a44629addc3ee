#include <gmock/gmock.h>

#include <sstream>
#include <utility>
#include <vector>

#include "core/line/LoggedPort.h"
#include "devices/baseunit/BaseUnitDownload.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"
#include "sim/baseunit/BaseUnit.h"
#include "sim/game/GameMaker.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeDownloadProgress.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/support/TemporaryFolder.h"

// A real line with its transcript, and the simulated unit's own log of it.

namespace {

using testing::HasSubstr;
using testing::IsEmpty;

bool IsByte(const std::string& word) {
  return word.size() == 2 && word.find_first_not_of("0123456789ABCDEF") == std::string::npos;
}

/// What passed, a direction and all bytes until it changed: notes and where rows part do not count.
std::vector<std::pair<std::string, std::string>> PassedIn(const std::string& log) {
  std::vector<std::pair<std::string, std::string>> passed;
  std::istringstream rows(log);
  for (std::string row; std::getline(rows, row);) {
    std::istringstream words(row);
    double seconds = -1;
    std::string device;
    std::string direction;
    words >> seconds >> device >> direction;
    EXPECT_GE(seconds, 0) << row;
    EXPECT_EQ(device, "base-unit") << row;
    if (direction == "--") {
      continue;
    }
    if (passed.empty() || passed.back().first != direction) {
      passed.emplace_back(direction, "");
    }
    for (std::string word; words >> word && IsByte(word);) {
      passed.back().second += word;
    }
  }
  return passed;
}

class TranscriptOfADownload : public testing::Test {
 protected:
  TranscriptOfADownload() { devices.Ports = {unit.DevicePath()}; }

  void Download() {
    QtSerialPort line;
    LoggedPort port(line, {files, folder / "logs", events, clock}, "line");
    CommPort commPort(port, ini, devices, boxes, strings, [] {});
    FakeDownloadProgress progress;
    DownloadedGuns guns(game);
    BaseUnitDownload(port, commPort, events, boxes, clock, progress, guns).GetScores();
  }

  std::ostringstream unitLog;
  sim::BaseUnit unit{{.Answer = sim::MakeBaseUnitAnswer(sim::MakeGame(3, 1)), .Log = &unitLog}};
  TemporaryFolder folder;
  LinuxFiles files;
  IniReader ini{files, folder / "tessarine.ini"};
  FakeSerialDevices devices;
  FakeMessageBoxes boxes;
  FakeClock clock;
  QtEventPump events;
  StringTable strings{Language::English};
  Game game{strings};
};

TEST_F(TranscriptOfADownload, TellsTheSameAsTheUnitsOwnLog) {
  Download();
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  ASSERT_TRUE(unit.WaitUntilServed(1, std::chrono::seconds(5)));
  const std::string log = ReadFile(folder / "logs/base-unit.log");
  EXPECT_THAT(log,
              HasSubstr(" base-unit -- opened " + unit.DevicePath() + " 19200,N,8,1 2013-05-21 14:30:05\n"));
  EXPECT_THAT(log, HasSubstr(" base-unit -- closed\n"));
  const auto passed = PassedIn(log);
  ASSERT_EQ(passed.size(), 7U);  // the request, and three times a frame and its reply
  EXPECT_EQ(passed[0], std::pair(std::string("<-"), std::string("0100")));
  EXPECT_EQ(passed, PassedIn(unitLog.str()));
}

TEST_F(TranscriptOfADownload, IsNoFailureWhereItCannotBeWritten) {
  WriteFile(folder / "logs", "a file in the place of the folder");
  Download();
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_TRUE(game.DataPresent);
  EXPECT_EQ(ReadFile(folder / "logs"), "a file in the place of the folder");
}

TEST_F(TranscriptOfADownload, GoesOnInTheSameFile) {
  Download();
  Download();
  ASSERT_TRUE(unit.WaitUntilServed(2, std::chrono::seconds(5)));
  const std::string log = ReadFile(folder / "logs/base-unit.log");
  const auto first = log.find(" opened ");
  ASSERT_NE(first, std::string::npos);
  EXPECT_NE(log.find(" opened ", first + 1), std::string::npos);
  EXPECT_EQ(PassedIn(log), PassedIn(unitLog.str()));
}

}  // namespace
