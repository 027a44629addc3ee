#include "firmware/download/FirmwareRecord.h"

#include <gmock/gmock.h>

#include <string>

#include "tests/firmware/download/DownloadSite.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

class Record : public testing::Test {
 protected:
  Record() { disk.AddFolder("/data"); }

  FirmwareRecord Make() {
    return {{disk, "/data/logs", clock, time}, "/fw/a.qvm", "9 bytes, CRC-32 CBF43926"};
  }

  std::string Written() const {
    const auto names = disk.FileNames("/data/logs");
    return names.empty() ? "" : disk.Read("/data/logs/" + names.back());
  }

  FakeFiles disk;
  FakeEventPump clock;
  FakeClock time;
};

TEST_F(Record, TellsOfTheFileTheAnswersTheLineAndTheEnd) {
  FirmwareRecord record = Make();
  clock.Pass(1500000us);
  record.Sent('X');
  record.Received('?');
  record.Received('x');
  record.BadAnswer("line 3", '?');
  time.DateAndTime = "2013-05-21 14:31:00";
  record.Write("complete");
  EXPECT_THAT(disk.FileNames("/data/logs"), ElementsAre("firmware-2013-05-21-143100.log"));
  EXPECT_EQ(Written(),
            "File: /fw/a.qvm\n"
            "9 bytes, CRC-32 CBF43926\n"
            "Begun: 2013-05-21 14:30:05\n"
            "Ended: 2013-05-21 14:31:00 complete\n"
            "\n"
            "Answers other than the good one:\n"
            "    1.500000 3F to line 3\n"
            "\n"
            "Transcript:\n"
            "    1.500000 boot-code <- 58\n"
            "    1.500000 boot-code -> 3F 78\n");
}

TEST_F(Record, KeepsTheStartAndTheEndOfALongTranscript) {
  FirmwareRecord record = Make();
  for (int packet = 0; packet < 3000; ++packet) {
    for (int byte = 0; byte < 64; ++byte) {
      record.Sent(static_cast<std::uint8_t>(packet));
    }
    record.Received(static_cast<std::uint8_t>(packet / 256));
    clock.Pass(10ms);
  }
  record.Write("complete");
  const std::string text = Written();
  EXPECT_THAT(text, HasSubstr("Transcript:\n    0.000000 boot-code <- 00 00"));
  EXPECT_THAT(text, HasSubstr("none\n"));
  EXPECT_TRUE(text.ends_with("\n   29.990000 boot-code -> 0B\n"));
  EXPECT_THAT(text, HasSubstr(" bytes left out ...\n"));
  EXPECT_GT(text.size(), 2 * FirmwareRecord::KeptBytes - 1000);
  EXPECT_LT(text.size(), 2 * FirmwareRecord::KeptBytes + 500);
  // Only whole rows.
  for (std::size_t start = text.find("Transcript:\n") + 12; start < text.size();) {
    const std::size_t end = text.find('\n', start);
    const std::string row = text.substr(start, end - start);
    EXPECT_TRUE(row.substr(12).starts_with(" boot-code ") || row.ends_with("left out ...")) << row;
    start = end + 1;
  }
}

TEST_F(Record, OfAShortTranscriptLeavesNothingOut) {
  FirmwareRecord record = Make();
  for (int packet = 0; packet < 500; ++packet) {
    for (int byte = 0; byte < 64; ++byte) {
      record.Sent(7);
    }
    record.Received('f');
  }
  record.Write("complete");
  const std::string text = Written();
  EXPECT_THAT(text, Not(HasSubstr("left out")));
  EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 9 + 1000);
}

TEST_F(Record, NamesAThousandAnswersAndCountsTheOthers) {
  FirmwareRecord record = Make();
  record.Received('?');
  for (int answer = 0; answer < 1000; ++answer) {
    record.BadAnswer("line 1", '?');
  }
  FirmwareRecord noisy = Make();
  noisy.Received('?');
  for (int answer = 0; answer < 1003; ++answer) {
    noisy.BadAnswer("line 1", '?');
  }
  record.Write("ended");
  EXPECT_THAT(Written(), Not(HasSubstr("more")));
  noisy.Write("ended");
  const std::string text = Written();
  EXPECT_THAT(text, HasSubstr(" 3F to line 1\n... 3 more ...\n\nTranscript:"));
  EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 7 + 1000 + 3);
}

TEST_F(Record, IsNotWrittenWithoutAByte) {
  Make().Write("ended");
  EXPECT_THAT(disk.FileNames("/data/logs"), IsEmpty());
}

TEST_F(Record, IsKeptForTheLastTenDownloads) {
  disk.Put("/data/logs/line.log", "other");
  for (int minute = 10; minute < 30; ++minute) {
    FirmwareRecord record = Make();
    record.Received('B');
    time.DateAndTime = "2013-05-21 14:" + std::to_string(minute) + ":00";
    record.Write("ended");
  }
  const auto names = disk.FileNames("/data/logs");
  ASSERT_EQ(names.size(), 11U);
  EXPECT_EQ(names.front(), "firmware-2013-05-21-142000.log");
  EXPECT_EQ(names.back(), "line.log");
}

TEST_F(Record, ThatCannotBeWrittenIsLost) {
  disk.FailCreateFolder("/data/logs", RuntimeError(70));
  FirmwareRecord record = Make();
  record.Received('B');
  record.Write("ended");
  EXPECT_THAT(disk.Contents(), IsEmpty());
}

TEST_F(Record, LeavesTheLastSpaceOfTheDisk) {
  disk.FreeBytes = 32U << 20U;
  FirmwareRecord record = Make();
  record.Received('B');
  record.Write("ended");
  EXPECT_THAT(disk.Contents(), IsEmpty());
}

class RecordedDownload : public DownloadSite {
 protected:
  std::string Written() const {
    const auto names = Disk.FileNames("/data/logs");
    return names.empty() ? "" : Disk.Read("/data/logs/" + names.back());
  }
};

TEST_F(RecordedDownload, NamesTheFileAndEachBadAnswer) {
  boot.Instead = [this](const std::string&) -> std::optional<std::string> {
    return boot.Commands.size() == 5 ? std::optional<std::string>("c") : std::nullopt;
  };
  RunQvm2("\r\n\r\n");
  EXPECT_THAT(Written(), HasSubstr("File: /fw/gun.qvm2\n4 bytes, CRC-32 "));
  EXPECT_THAT(Written(), HasSubstr(" 63 to row 0\n"));
  EXPECT_THAT(Written(), HasSubstr(" complete\n"));
  EXPECT_THAT(Written(), HasSubstr(" boot-code -> 42 4F 4F 54\n"));
  EXPECT_THAT(Written(), HasSubstr(" boot-code <- 58\n"));
}

TEST_F(RecordedDownload, SaysThatAFileOfNoKindIsNotLoaded) {
  RunQvm2("\r\n\r\n");
  Time.DateAndTime = "2013-05-21 15:00:00";
  boot.SwitchOnAt(100ms);
  Run("/fw/GUN.QVM");
  EXPECT_THAT(Written(), HasSubstr("File: /fw/GUN.QVM\nnot loaded\n"));
}

TEST_F(RecordedDownload, TellsHowItFailed) {
  boot.Instead = [](const std::string& command) -> std::optional<std::string> {
    return command[0] == 'Z' ? std::optional<std::string>("?") : std::nullopt;
  };
  RunQvm2("\r\n\r\n");
  EXPECT_THAT(Written(), HasSubstr("Invalid response received, aborting."));
  EXPECT_THAT(Written(), HasSubstr(" 3F to row 0\n"));
}

TEST_F(RecordedDownload, ThatFailsAtRunTimeIsRecordedToo) {
  RunQvm(":01\r\n");
  EXPECT_THAT(Written(), HasSubstr("File: /fw/gun.qvm\n"));
  EXPECT_THAT(Written(), HasSubstr(" 6 Overflow\n"));
}

TEST_F(RecordedDownload, GoesOnWithoutItsRecord) {
  Disk.FailCreateFolder("/data/logs", RuntimeError(70));
  RunQvm2("\r\n\r\n");
  ExpectComplete();
}

}  // namespace
