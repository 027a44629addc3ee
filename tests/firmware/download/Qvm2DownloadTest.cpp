#include <string>

#include "tests/firmware/download/DownloadSite.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;

class Qvm2Download : public DownloadSite {
 protected:
  /// The device gives these answers to packets, by their order (0 for the first), instead of good ones.
  void AnswerPackets(std::map<int, std::string> answers) {
    boot.Instead = [answers = std::move(answers),
                    next = 0](const std::string& command) mutable -> std::optional<std::string> {
      if (command[0] != 'E' && command[0] != 'Z') {
        return std::nullopt;
      }
      const auto answer = answers.find(next++);
      return answer == answers.end() ? std::nullopt : std::optional(answer->second);
    };
  }

  /// The flash as the commands so far left it, in bytes of the image.
  std::string Flash() const {
    std::string flash(786432, '?');
    for (const std::string& command : boot.Commands) {
      const auto byte = [&command](std::size_t at) { return static_cast<unsigned char>(command[at]); };
      if (command[0] == 'E') {
        const std::size_t address = byte(1) * 65536U + byte(2) * 256U + byte(3);
        flash.replace(address / 1024 * 1536, 1536, std::string(1536, '-'));
      } else if (command[0] == 'Z') {
        const std::size_t address = byte(1) * 65536U + byte(2) * 256U + byte(3);
        flash.replace(address / 128 * 192, 192, command.substr(5, 192));
      }
    }
    return flash;
  }
};

TEST_F(Qvm2Download, ErasesEachUsedPageAndWritesItsEightRows) {
  RunQvm2("2\r\n\r\n010203\r\n");
  EXPECT_EQ(boot.Letters(),
            "XPB"
            "EZZZZZZZZ"
            "EZZZZZZZZ"
            "F");
  EXPECT_EQ(boot.Commands[3], std::string("\x45\x00\x00\x00\x01\xBA", 6));
  EXPECT_EQ(boot.Commands[12], std::string("\x45\x00\x08\x00\x01\xB2", 6));
  const std::string firstRow = boot.Commands[4];
  ASSERT_EQ(firstRow.size(), 198U);
  EXPECT_EQ(firstRow.substr(0, 9), std::string("\x5A\x00\x00\x00\xC1\x01\x02\x03\xFF", 9));
  // 0x5A + 0xC1 + 1 + 2 + 3 + 189 * 0xFF = 0xBD64
  EXPECT_EQ(firstRow[197], '\x9C');
  EXPECT_EQ(boot.Commands[5].substr(0, 5), std::string("\x5A\x00\x00\x80\xC1", 5));
  EXPECT_EQ(boot.Commands[13].substr(0, 5), std::string("\x5A\x00\x08\x00\xC1", 5));
  ExpectComplete();
}

TEST_F(Qvm2Download, LeavesTheImageInTheDevice) {
  std::string data;
  std::string image(4 * 1536, '\xFF');
  for (std::size_t at = 0; at < 3 * 1536; ++at) {
    image[at] = static_cast<char>(at * 7 + at / 256);
    std::array<char, 4> digits{};
    std::snprintf(digits.data(), digits.size(), at % 2 == 0 ? "%02x" : "%02X",
                  static_cast<unsigned char>(image[at]));
    data += digits.data();
    data += at % 40 == 39 ? "\r\n" : "";
  }
  RunQvm2("0,1,3\r\n0,1\r\n" + data + "\r\n");
  const std::string flash = Flash();
  EXPECT_EQ(flash.substr(0, 3072), image.substr(0, 3072));
  EXPECT_EQ(flash.substr(3072, 1536), std::string(1536, '?'));  // page 2 is not listed
  EXPECT_EQ(flash.substr(4608, 1536), std::string(1536, '\xFF'));
  EXPECT_EQ(flash.find_first_not_of('?', 6144), std::string::npos);
  ExpectComplete();
}

TEST_F(Qvm2Download, WritesTheLastPageButNeverTheOneBehindIt) {
  RunQvm2("1FF,200\r\n1000\r\n");
  EXPECT_EQ(boot.CountOf('E'), 2U);
  EXPECT_EQ(boot.Commands[12], std::string("\x45\x07\xFC\x00\x01\xB7", 6));
  EXPECT_EQ(boot.Commands[20].substr(0, 5), std::string("\x5A\x07\xFF\x80\xC1", 5));
  ExpectComplete();
}

TEST_F(Qvm2Download, OfAnEmptyListWritesPageZeroAlone) {
  RunQvm2("\r\n\r\n");
  EXPECT_EQ(boot.Letters(), "XPBEZZZZZZZZF");
  ExpectComplete();
}

TEST_F(Qvm2Download, ShowsItsSteps) {
  RunQvm2("1\r\n\r\n");
  ASSERT_EQ(shown.Statuses.size(), 19U);
  EXPECT_EQ(shown.Statuses[1], "Syncronising with device...");
  EXPECT_EQ(shown.Statuses[2], "Sync'd");
  for (int row = 1; row <= 16; ++row) {
    EXPECT_EQ(shown.Statuses[2 + static_cast<std::size_t>(row)],
              "Loaded " + std::to_string(8 * row) + " code words");
  }
  std::vector<double> bars(1, 0);
  bars.insert(bars.end(), 8, 0.5);
  bars.insert(bars.end(), 8, 1);
  EXPECT_EQ(shown.Bars, bars);
  EXPECT_EQ(shown.Status, "Loaded 128 code words");
  EXPECT_EQ(shown.Buffer, "Buffer Empty");
  ExpectComplete();
}

TEST_F(Qvm2Download, ToleratesTenRefusalsInAll) {
  AnswerPackets({{0, "c"},
                 {1, "c"},
                 {2, "c"},
                 {4, "c"},
                 {5, "c"},
                 {7, "c"},
                 {15, "c"},
                 {16, "c"},
                 {17, "c"},
                 {20, "c"}});
  RunQvm2("1\r\n\r\n");
  EXPECT_EQ(boot.CountOf('E') + boot.CountOf('Z'), 18U + 10U);
  ExpectComplete();
}

TEST_F(Qvm2Download, SendsARefusedPacketAgainUnchanged) {
  AnswerPackets({{0, "c"}, {2, "c"}});
  RunQvm2("\r\n\r\n0102\r\n");
  EXPECT_EQ(boot.Letters(), "XPBEEZZZZZZZZZF");
  EXPECT_EQ(boot.Commands[3], boot.Commands[4]);
  EXPECT_EQ(boot.Commands[5], boot.Commands[6]);
  EXPECT_NE(boot.Commands[6], boot.Commands[7]);
  ExpectComplete();
}

TEST_F(Qvm2Download, EndsAtTheEleventhRefusalWhicheverPacketsItWas) {
  AnswerPackets({{0, "c"},
                 {2, "c"},
                 {4, "c"},
                 {6, "c"},
                 {8, "c"},
                 {10, "c"},
                 {12, "c"},
                 {14, "c"},
                 {16, "c"},
                 {17, "c"},
                 {20, "c"}});
  RunQvm2("1\r\n\r\n");
  ExpectBox("Too many download errors, aborting. You will likely experience unexpected program execution.");
  ExpectReset();
  EXPECT_EQ(shown.Advice, Text(OwnText::AdviceIncomplete));
}

TEST_F(Qvm2Download, EndsAtTheEleventhRefusalOfAnErasure) {
  std::map<int, std::string> answers;
  for (int packet = 0; packet < 11; ++packet) {
    answers[packet] = "c";
  }
  AnswerPackets(answers);
  RunQvm2("1\r\n\r\n");
  EXPECT_EQ(boot.Letters(), "XPB" + std::string(11, 'E'));
  ExpectBox(
      "Too many download errors (erasing), aborting. You will likely experience unexpected program "
      "execution.");
  ExpectReset();
}

TEST_F(Qvm2Download, EndsAtAnInvalidPageWithoutResettingTheWindow) {
  AnswerPackets({{9, "e"}});
  RunQvm2("1\r\n\r\n");
  ExpectBox(
      "Invalid (erase) address in program, aborting. You will likely experience unexpected program "
      "execution.");
  ExpectNoReset();
  EXPECT_EQ(shown.Status, "Loaded 64 code words");
  EXPECT_EQ(shown.Advice, Text(OwnText::AdviceIncomplete) + " " + Text(OwnText::AdviceClose));
}

TEST_F(Qvm2Download, EndsAtAnInvalidRowAndResetsTheWindow) {
  AnswerPackets({{3, "e"}});
  RunQvm2("1\r\n\r\n");
  ExpectBox("Invalid address in program, aborting. You will likely experience unexpected program execution.");
  ExpectReset();
}

TEST_F(Qvm2Download, EndsAtAnyOtherReply) {
  for (const char* reply : {"x", "f", "B", "?"}) {
    Boxes.Boxes.clear();
    AnswerPackets({{0, reply}});
    RunQvm2("1\r\n\r\n");
    ExpectBox("Invalid response received (erase), aborting.");
    ExpectReset();
  }
  for (const char* reply : {"x", "b", "F", "?"}) {
    Boxes.Boxes.clear();
    AnswerPackets({{1, reply}});
    RunQvm2("1\r\n\r\n");
    ExpectBox("Invalid response received, aborting.");
    ExpectReset();
  }
}

TEST_F(Qvm2Download, WaitsTenSecondsForEachReply) {
  for (const char letter : {'X', 'P', 'B', 'E', 'Z', 'F'}) {
    Boxes.Boxes.clear();
    boot.Instead = [letter](const std::string& command) {
      return command[0] == letter ? std::optional<std::string>("") : std::nullopt;
    };
    const auto start = Events.Now();
    RunQvm2("\r\n\r\n");
    ExpectBox(TimeOutText);
    ExpectReset();
    EXPECT_GE(Events.Now() - start, 10100ms) << letter;
    EXPECT_LE(Events.Now() - start, 10200ms) << letter;
  }
}

TEST_F(Qvm2Download, CanBeStoppedInEveryWait) {
  for (const char letter : {'X', 'P', 'B', 'E', 'Z', 'F'}) {
    Boxes.Boxes.clear();
    boot.Instead = [this, letter](const std::string& command) -> std::optional<std::string> {
      if (command[0] != letter) {
        return std::nullopt;
      }
      Events.At(2s, [this] { download.RequestAbort(); });
      return "";
    };
    RunQvm2("\r\n\r\n");
    ExpectBox(AbortText);
    ExpectReset();
  }
}

TEST_F(Qvm2Download, StoppedInTheMidstOfAPacketStillSendsAllOfIt) {
  Port.OnOutput = [this, take = Port.OnOutput](std::uint8_t byte) {
    take(byte);
    if (Port.Sent.size() == 100) {
      download.RequestAbort();
    }
  };
  RunQvm2("\r\n\r\n");
  EXPECT_EQ(Port.Sent.size(), 3U + 6 + 198);
  ExpectBox(AbortText);
  ExpectReset();
}

TEST_F(Qvm2Download, StoppedBehindTheLastUsedPageDoesNotFinish) {
  boot.OnCommand = [this](const std::string& command) {
    if (command[0] == 'Z' && boot.CountOf('Z') == 8) {
      Events.At(boot.AnswerTime + 0ms, [this] { download.RequestAbort(); });
    }
  };
  RunQvm2("\r\n\r\n");
  EXPECT_EQ(boot.CountOf('F'), 0U);
  ExpectBox(AbortText);
}

TEST_F(Qvm2Download, AdvisesByWhatTheDeviceGotSoFar) {
  const std::vector<std::pair<char, OwnText>> advice = {{'P', OwnText::AdviceUnchanged},
                                                        {'B', OwnText::AdviceUnchanged},
                                                        {'E', OwnText::AdviceIncomplete},
                                                        {'Z', OwnText::AdviceIncomplete},
                                                        {'F', OwnText::AdviceUnconfirmed}};
  for (const auto& [letter, text] : advice) {
    boot.Instead = [letter = letter](const std::string& command) {
      return command[0] == letter ? std::optional<std::string>("") : std::nullopt;
    };
    RunQvm2("\r\n\r\n");
    EXPECT_EQ(shown.Advice, Text(text)) << letter;
  }
}

TEST_F(Qvm2Download, TellsHowMuchIsSent) {
  std::vector<std::uint64_t> sent;
  boot.OnCommand = [&](const std::string& command) {
    if (command[0] == 'E' || command[0] == 'F') {
      EXPECT_TRUE(shown.All == 2 * (6 + 8 * 198) || shown.Sent == 0);
      sent.push_back(shown.Sent);
    }
  };
  RunQvm2("1\r\n\r\n");
  EXPECT_THAT(sent, ElementsAre(0, 1590, 3180));
  EXPECT_EQ(shown.All, 0U);
}

TEST_F(Qvm2Download, ShowsTheHourglassWhileTheFileIsRead) {
  RunQvm2("\r\n\r\n");
  EXPECT_EQ(shown.TimesBusy, 1);
  EXPECT_EQ(shown.Busy, 0);
}

}  // namespace
