// Lines that fail, windows that close and programs that end in the midst of a download.

#include <string>

#include "tests/firmware/download/DownloadSite.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::IsEmpty;

constexpr const char* TwoLines = ":01\r\n:02\r\n";
constexpr const char* OnePage = "\r\n\r\n";

class DisturbedDownload : public DownloadSite {
 protected:
  /// The device says nothing from this command on; `then` happens two seconds later.
  void At(char letter, const std::function<void()>& then) {
    boot.Instead = [this, letter, then](const std::string& command) -> std::optional<std::string> {
      if (command[0] != letter) {
        return std::nullopt;
      }
      Events.At(2s, then);
      return "";
    };
  }

  /// As on a real line: that it is lost is an event.
  void LoseAt(Milliseconds delay) {
    Events.At(delay, [this] { Port.Lose(); });
  }
};

TEST_F(DisturbedDownload, TellsOnceThatTheLineWasLostBeforeTheAnnouncement) {
  LoseAt(5s);
  Run("/fw/any");
  EXPECT_EQ(Events.Now(), 5s);
  ExpectRunTimeFailure(8012, "The device is not open");
  EXPECT_EQ(shown.Advice, Text(OwnText::AdviceNoDevice));
}

TEST_F(DisturbedDownload, TellsOnceThatTheLineWasLostInAWait) {
  for (const char letter : {'X', 'P', 'B', 'S', 'Z', 'F'}) {
    Boxes.Boxes.clear();
    At(letter, [this] { Port.Lose(); });
    RunQvm(TwoLines);
    ExpectRunTimeFailure(8012, "The device is not open");
  }
  for (const char letter : {'X', 'P', 'B', 'E', 'Z', 'F'}) {
    Boxes.Boxes.clear();
    At(letter, [this] { Port.Lose(); });
    RunQvm2(OnePage);
    ExpectRunTimeFailure(8012, "The device is not open");
  }
}

TEST_F(DisturbedDownload, TellsOnceThatTheLineWasLostWhileItSends) {
  const auto take = Port.OnOutput;
  for (const std::size_t bytes : {1U, 2U, 3U, 5U, 9U, 10U, 100U}) {
    Boxes.Boxes.clear();
    Port.Sent.clear();
    boot.SwitchOnAt(100ms);
    Disk.Put(Qvm2Name, OnePage);
    Port.OnOutput = [this, bytes, take](std::uint8_t byte) {
      take(byte);
      if (Port.Sent.size() == bytes) {
        Port.Lose();
      }
    };
    Run(Qvm2Name);
    ExpectRunTimeFailure(8012, "The device is not open");
  }
}

TEST_F(DisturbedDownload, BeginsAnewAfterALostLine) {
  LoseAt(5s);
  Run("/fw/any");
  Boxes.Boxes.clear();
  RunQvm2(OnePage);
  ExpectComplete();
}

TEST_F(DisturbedDownload, TellsOfACommandThatCannotBeSent) {
  boot.SwitchOnAt(100ms);
  Port.FailOutput(57);
  Run("/fw/any");
  ExpectBox("Error occured sending data. Please try again.");
  EXPECT_EQ(shown.Status, "Idle");
  EXPECT_EQ(shown.Download, "Idle");
  EXPECT_FALSE(shown.Running);
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(DisturbedDownload, FailsOnAPacketThatCannotBeSent) {
  boot.OnCommand = [this](const std::string& command) {
    if (command == "B") {
      Port.FailOutput(57);
    }
  };
  RunQvm2(OnePage);
  ASSERT_EQ(Boxes.Boxes.size(), 2U);
  EXPECT_EQ(Boxes.Boxes[1].Text, "57");
  EXPECT_EQ(shown.Status, "Error");
}

TEST_F(DisturbedDownload, ClosedBeforeTheAnnouncementGivesTheOneBoxOfThat) {
  Events.At(5s, [this] { download.Close(); });
  Run("/fw/any");
  EXPECT_EQ(Events.Now(), 5s);
  ExpectBox(LoadModeText);
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_THAT(Port.Sent, IsEmpty());
}

TEST_F(DisturbedDownload, ClosedLaterGivesTheOneBoxOfThat) {
  for (const char letter : {'X', 'P', 'B', 'S', 'Z', 'F'}) {
    Boxes.Boxes.clear();
    At(letter, [this] { download.Close(); });
    RunQvm(TwoLines);
    ExpectBox(AbortText);
    EXPECT_FALSE(Port.PortOpen());
  }
  for (const char letter : {'X', 'P', 'B', 'E', 'Z', 'F'}) {
    Boxes.Boxes.clear();
    At(letter, [this] { download.Close(); });
    RunQvm2(OnePage);
    ExpectBox(AbortText);
    EXPECT_FALSE(Port.PortOpen());
  }
}

TEST_F(DisturbedDownload, ClosedAfterAnyNumberOfBytesGivesOneBoxAndSendsNothingMore) {
  const auto take = Port.OnOutput;
  for (std::size_t bytes = 1; bytes < 420; bytes += 7) {
    Boxes.Boxes.clear();
    Port.Sent.clear();
    boot.SwitchOnAt(100ms);
    Disk.Put(Qvm2Name, OnePage);
    Port.OnOutput = [this, bytes, take](std::uint8_t byte) {
      take(byte);
      if (Port.Sent.size() == bytes) {
        download.Close();
      }
    };
    Run(Qvm2Name);
    EXPECT_EQ(Port.Sent.size(), bytes);
    ExpectBox(AbortText);
    EXPECT_FALSE(Port.PortOpen());
  }
}

TEST_F(DisturbedDownload, EndsSilentlyWithTheProgram) {
  Events.At(5s, [this] { Events.EndWaits(); });
  Run("/fw/any");
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_FALSE(Port.PortOpen());
}

/// The operator's stop at the very moment of an answer.
class StoppedWithAnAnswer : public DownloadSite {
 protected:
  /// Both come as one event, with the `count`th command of this letter.
  void StopWith(char letter, std::size_t count, const std::string& answer) {
    boot.Instead = [this, letter, count, answer](const std::string& command) -> std::optional<std::string> {
      if (command[0] != letter || boot.CountOf(letter) != count) {
        return std::nullopt;
      }
      Events.At(boot.AnswerTime, [this, answer] {
        boot.Say(answer);
        download.RequestAbort();
      });
      return "";
    };
  }

  /// The stop comes right after the answer.
  void StopBehind(char letter, std::size_t count) {
    boot.OnCommand = [this, letter, count](const std::string& command) {
      if (command[0] == letter && boot.CountOf(letter) == count) {
        Events.At(boot.AnswerTime / 2, [this] {
          Events.At(boot.AnswerTime - boot.AnswerTime / 2, [this] { download.RequestAbort(); });
        });
      }
    };
  }
};

TEST_F(StoppedWithAnAnswer, TakesTheSynchronisationButNotTheIdentification) {
  for (const bool isQvm : {true, false}) {
    for (const auto& [letter, answer, letters] :
         {std::tuple{'X', "x", "XP"}, {'P', isQvm ? "p" : "d", "XP"}}) {
      Boxes.Boxes.clear();
      boot.Commands.clear();
      StopWith(letter, 1, answer);
      isQvm ? RunQvm(TwoLines) : RunQvm2(OnePage);
      EXPECT_EQ(boot.Letters(), letters);
      ExpectBox(AbortText);
      ExpectReset();
    }
  }
}

TEST_F(StoppedWithAnAnswer, ToItsLastLineDoesNotFinish) {
  StopWith('Z', 2, "f");
  RunQvm(TwoLines);
  EXPECT_EQ(boot.Letters(), "XPBSZZ");
  ExpectBox(AbortText);
}

TEST_F(StoppedWithAnAnswer, ToALineOrARowSendsNoOther) {
  StopBehind('Z', 1);
  RunQvm(TwoLines);
  EXPECT_EQ(boot.Letters(), "XPBSZ");
  ExpectBox(AbortText);
  Boxes.Boxes.clear();
  boot.Commands.clear();
  StopBehind('Z', 3);
  RunQvm2(OnePage);
  EXPECT_EQ(boot.Letters(), "XPBEZZZ");
  ExpectBox(AbortText);
}

TEST_F(DisturbedDownload, KeepsTheComputerAwakeToTheEndAndNoLonger) {
  Boxes.WhileOpen = [this](const auto& /*box*/) { EXPECT_EQ(Awake.Held, 0); };
  boot.OnCommand = [this](const auto& /*command*/) { EXPECT_EQ(Awake.Held, 1); };
  At('Z', [this] { Port.Lose(); });
  RunQvm2(OnePage);
  EXPECT_EQ(Boxes.Boxes.size(), 2U);
  EXPECT_THAT(Awake.Reasons, ElementsAre("Firmware download"));
  EXPECT_EQ(Awake.Held, 0);
}

TEST_F(DisturbedDownload, AHundredWithFaultsAreEachFollowedByAGoodOne) {
  std::uint32_t lot = 2463534242U;
  const auto draw = [&lot](std::uint32_t range) {
    lot ^= lot << 13U;
    lot ^= lot >> 17U;
    lot ^= lot << 5U;
    return lot % range;
  };
  const std::vector<std::string> answers = {"", "e", "c", "x", "?", "fe", "bb"};
  for (int round = 0; round < 100; ++round) {
    const std::uint32_t faulty = draw(12);
    const std::string answer = answers[draw(static_cast<std::uint32_t>(answers.size()))];
    const bool loses = draw(5) == 0;
    const bool closes = draw(5) == 0;
    std::uint32_t command = 0;
    boot.Instead = [&](const std::string&) -> std::optional<std::string> {
      if (command++ != faulty) {
        return std::nullopt;
      }
      if (loses) {
        Events.At(1s, [this] { Port.Lose(); });
      } else if (closes) {
        Events.At(1s, [this] { download.Close(); });
      }
      return answer;
    };
    RunQvm2(OnePage);
    download.Close();
    boot.Instead = nullptr;
    Boxes.Boxes.clear();
    boot.Commands.clear();
    Events.Sleep(20s);  // all of the faulty one has happened
    RunQvm2(OnePage);
    ASSERT_EQ(boot.Letters(), "XPBEZZZZZZZZF") << round;
    ExpectComplete();
  }
}

}  // namespace
