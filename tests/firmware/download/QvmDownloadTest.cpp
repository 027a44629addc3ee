#include <string>

#include "tests/firmware/download/DownloadSite.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::HasSubstr;

constexpr const char* TooManyText =
    "Too many download errors, aborting. You will likely experience unexpected program execution.";
constexpr const char* AddressText =
    "Invalid address in program, aborting. You will likely experience unexpected program execution.";

class QvmDownload : public DownloadSite {
 protected:
  /// The device answers its buffers with `answers` one after the other, then well.
  void AnswerBuffers(std::vector<std::string> answers) {
    boot.Instead = [answers = std::move(answers),
                    next = std::size_t{0}](const std::string& command) mutable -> std::optional<std::string> {
      return command[0] == 'Z' && next < answers.size() ? std::optional(answers[next++]) : std::nullopt;
    };
  }

  /// The device answers only the commands before `letter`.
  void FallSilentAt(char letter) {
    boot.Instead = [letter](const std::string& command) {
      return command[0] == letter ? std::optional<std::string>("") : std::nullopt;
    };
  }
};

/// A line of `count` bytes.
std::string Line(std::size_t count) {
  return ":" + std::string(2 * count, '1') + "\r\n";
}

TEST_F(QvmDownload, SendsEachLineAsOneBuffer) {
  boot.BufferSizes = {3, 2};
  RunQvm("; a comment\r\n:0aFf10\r\n\r\n:7001\r\n");
  const std::string expected(
      "XPBS\x00\x70\x8FZ\x0A\xFF\x10Z\x70\x01"
      "F",
      15);
  EXPECT_EQ(std::string(Port.Sent.begin(), Port.Sent.end()), expected);
  ExpectComplete();
}

TEST_F(QvmDownload, HandsALineOverBeforeEventsRun) {
  boot.BufferSizes = {51};
  std::vector<std::size_t> sentAtEvent;
  Port.OnOutput = [&, take = Port.OnOutput](std::uint8_t byte) {
    if (byte == 'Z') {
      Events.At(0ms, [&] { sentAtEvent.push_back(Port.Sent.size()); });
    }
    take(byte);
  };
  RunQvm(Line(51) + Line(51));
  // "XPBS", three bytes, and then one line and both.
  EXPECT_THAT(sentAtEvent, ElementsAre(7 + 52, 7 + 104));
  ExpectComplete();
}

TEST_F(QvmDownload, ShowsItsStepsAndCountsCodeWordsOneLineLate) {
  boot.BufferSizes = {51, 51, 2, 1};
  std::vector<std::string> buffers;
  boot.OnCommand = [&](const std::string& command) {
    if (command[0] == 'Z') {
      buffers.push_back(shown.Buffer);
    }
  };
  RunQvm(Line(51) + Line(51) + Line(2) + Line(1));
  // 0, then 25.5 to even, 26 + 25.5 to even, 52 + 1
  EXPECT_THAT(shown.Statuses,
              ElementsAre("Power up device now. Waiting for device response...",
                          "Syncronising with device...", "Loaded 0 code words", "Loaded 26 code words",
                          "Loaded 52 code words", "Loaded 53 code words"));
  EXPECT_THAT(shown.Bars, ElementsAre(0, 0, 1 / 3.0, 2 / 3.0, 1));
  EXPECT_THAT(buffers, ElementsAre(":" + std::string(102, '1'), ":" + std::string(102, '1'), ":1111", ":11"));
  EXPECT_EQ(shown.Buffer, ":11");
  EXPECT_EQ(shown.Digits, "");
  EXPECT_EQ(shown.Status, "Loaded 53 code words");
  ExpectComplete();
}

TEST_F(QvmDownload, RoundsHalfWordsToEven) {
  boot.BufferSizes = {1};
  RunQvm(Line(1) + Line(1) + Line(1) + Line(1) + Line(1));
  // 0.5 is 0, again and again
  EXPECT_EQ(shown.Status, "Loaded 0 code words");
}

TEST_F(QvmDownload, OfALineWithoutDigitsSendsTheCommandAlone) {
  boot.BufferSizes = {0, 1};
  RunQvm(":\r\n:05\r\n");
  EXPECT_THAT(boot.Commands, testing::Contains("Z"));
  EXPECT_EQ(boot.Commands.back(), "F");
  ExpectComplete();
}

TEST_F(QvmDownload, WithoutLinesGoesThroughAllTheSame) {
  RunQvm("nothing here\r\n");
  EXPECT_EQ(boot.Letters(), "XPBSF");
  EXPECT_EQ(shown.Status, "Syncronising with device...");
  ExpectComplete();
}

TEST_F(QvmDownload, OfASingleLineFailsBeforeItIsSent) {
  RunQvm(":0102\r\n");
  EXPECT_EQ(boot.Letters(), "XPBS");
  ExpectRunTimeFailure(6, "Overflow");
}

TEST_F(QvmDownload, OfAFileWithLineFeedsAloneIsOneLine) {
  RunQvm(":01\n:02\n:03\n");
  EXPECT_EQ(boot.Letters(), "XPBS");
  ExpectRunTimeFailure(6, "Overflow");
}

TEST_F(QvmDownload, FailsOnAnOddCountOfDigits) {
  boot.BufferSizes = {1};
  RunQvm(":01\r\n:023\r\n");
  EXPECT_EQ(boot.Letters(), "XPBSZ");
  EXPECT_EQ(shown.Digits, "3");
  ExpectRunTimeFailure(5, "Invalid procedure call or argument");
}

TEST_F(QvmDownload, FailsOnALineBeyondTheBuffer) {
  boot.BufferSizes = {51};
  RunQvm(Line(51) + Line(52));
  EXPECT_EQ(boot.Letters(), "XPBSZ");
  ExpectRunTimeFailure(9, "Subscript out of range");
}

TEST_F(QvmDownload, FailsInTheMidstOfABufferOnAPairThatIsNoByte) {
  boot.BufferSizes = {1};
  RunQvm(":01\r\n:02G0\r\n");
  const std::string sent(Port.Sent.begin(), Port.Sent.end());
  EXPECT_EQ(sent.substr(sent.size() - 4), "Z\x01Z\x02");
  ExpectRunTimeFailure(6, "Overflow");
}

TEST_F(QvmDownload, SendsABufferAgainUpToTenTimes) {
  AnswerBuffers(std::vector<std::string>(10, "c"));
  RunQvm(":01\r\n:02\r\n");
  EXPECT_EQ(boot.CountOf('Z'), 12U);
  ExpectComplete();
}

TEST_F(QvmDownload, CountsRefusalsForEachLineAnew) {
  std::vector<std::string> answers(10, "c");
  answers.emplace_back("f");
  answers.insert(answers.end(), 10, "c");
  AnswerBuffers(answers);
  RunQvm(":01\r\n:02\r\n");
  EXPECT_EQ(boot.CountOf('Z'), 22U);
  ExpectComplete();
}

TEST_F(QvmDownload, EndsAtTheEleventhRefusalOfALine) {
  AnswerBuffers(std::vector<std::string>(11, "c"));
  RunQvm(":01\r\n:02\r\n");
  EXPECT_EQ(boot.CountOf('Z'), 11U);
  ExpectBox(TooManyText);
  ExpectReset();
  EXPECT_EQ(shown.Advice, Text(OwnText::AdviceIncomplete));
}

TEST_F(QvmDownload, EndsAtAnInvalidAddressWithoutResettingTheWindow) {
  AnswerBuffers({"e"});
  RunQvm(":01\r\n:02\r\n");
  EXPECT_EQ(boot.CountOf('Z'), 1U);
  ExpectBox(AddressText);
  ExpectNoReset();
  EXPECT_EQ(shown.Status, "Loaded 0 code words");
  EXPECT_EQ(shown.Advice, Text(OwnText::AdviceIncomplete) + " " + Text(OwnText::AdviceClose));
}

TEST_F(QvmDownload, TakesAnyOtherReplyForAccepted) {
  AnswerBuffers({"x", "?", "Z"});
  RunQvm(":01\r\n:02\r\n:03\r\n:04\r\n");
  EXPECT_EQ(boot.CountOf('Z'), 4U);
  ExpectComplete();
}

TEST_F(QvmDownload, TakesASurplusReplyForThatOfTheNextBuffer) {
  AnswerBuffers({"fe"});
  RunQvm(":01\r\n:02\r\n");
  EXPECT_EQ(boot.CountOf('Z'), 2U);
  ExpectBox(AddressText);
}

TEST_F(QvmDownload, WaitsTenSecondsForEachReply) {
  for (const char letter : {'X', 'P', 'B', 'S', 'Z', 'F'}) {
    Boxes.Boxes.clear();
    FallSilentAt(letter);
    const auto start = Events.Now();
    RunQvm(":01\r\n:02\r\n");
    ExpectBox(TimeOutText);
    ExpectReset();
    EXPECT_GE(Events.Now() - start, 10100ms) << letter;
    EXPECT_LE(Events.Now() - start, 10200ms) << letter;
  }
}

TEST_F(QvmDownload, CountsTheTenSecondsFromTheLastByteOfABuffer) {
  Port.Pump = &Events;
  boot.BufferSizes = {51};
  boot.AnswerTime = 9990ms;
  RunQvm(Line(51) + Line(51));
  ExpectComplete();
}

TEST_F(QvmDownload, CanBeStoppedInEveryWait) {
  for (const char letter : {'X', 'P', 'B', 'S', 'Z', 'F'}) {
    Boxes.Boxes.clear();
    FallSilentAt(letter);
    boot.OnCommand = [this, letter](const std::string& command) {
      if (command[0] == letter) {
        Events.At(2s, [this] { download.RequestAbort(); });
      }
    };
    RunQvm(":01\r\n:02\r\n");
    ExpectBox(AbortText);
    ExpectReset();
  }
}

TEST_F(QvmDownload, StoppedInTheMidstOfABufferSendsNoMoreOfIt) {
  boot.BufferSizes = {51};
  Port.OnOutput = [this, take = Port.OnOutput](std::uint8_t byte) {
    take(byte);
    if (Port.Sent.size() == 17) {
      download.RequestAbort();
    }
  };
  RunQvm(Line(51) + Line(51));
  EXPECT_EQ(Port.Sent.size(), 17U);
  ExpectBox(AbortText);
  ExpectReset();
}

TEST_F(QvmDownload, AdvisesByWhatTheDeviceGotSoFar) {
  const std::vector<std::pair<char, OwnText>> advice = {{'X', OwnText::AdviceUnchanged},
                                                        {'P', OwnText::AdviceUnchanged},
                                                        {'B', OwnText::AdviceIncomplete},
                                                        {'Z', OwnText::AdviceIncomplete},
                                                        {'F', OwnText::AdviceUnconfirmed}};
  for (const auto& [letter, text] : advice) {
    FallSilentAt(letter);
    RunQvm(":01\r\n:02\r\n");
    EXPECT_EQ(shown.Advice, Text(text)) << letter;
  }
}

TEST_F(QvmDownload, TellsHowMuchIsSent) {
  boot.BufferSizes = {51, 51};
  std::vector<std::pair<std::uint64_t, std::uint64_t>> sent;
  boot.OnCommand = [&](const std::string& command) {
    if (command[0] == 'Z') {
      sent.emplace_back(shown.Sent, shown.All);
    }
  };
  RunQvm(Line(51) + Line(51));
  EXPECT_THAT(sent, ElementsAre(testing::Pair(0, 104), testing::Pair(52, 104)));
  EXPECT_EQ(shown.All, 0U);
}

TEST_F(QvmDownload, ShowsTheHourglassWhileTheFileIsRead) {
  RunQvm(":01\r\n:02\r\n");
  EXPECT_EQ(shown.TimesBusy, 1);
  EXPECT_EQ(shown.Busy, 0);
}

TEST_F(QvmDownload, IsSentFromTheFileAsItIsNow) {
  RunQvm(":01\r\n:02\r\n");
  Port.Sent.clear();
  RunQvm(":08\r\n:09\r\n");
  EXPECT_THAT(std::string(Port.Sent.begin(), Port.Sent.end()), HasSubstr("Z\x08Z\x09"));
}

}  // namespace
