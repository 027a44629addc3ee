// What both kinds of devices have in common: from the file to the identification.

#include <limits>

#include "tests/firmware/download/DownloadSite.h"
#include "tests/support/Thrown.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::IsEmpty;

class Synchronise : public DownloadSite {
 protected:
  /// Of no kind: ends after the synchronisation.
  void RunNothing() { Run("/fw/GUN.QVM"); }

  /// The operator's stop in the midst of a wait.
  void AbortAt(Milliseconds delay) {
    Events.At(delay, [this] { download.RequestAbort(); });
  }
};

TEST_F(Synchronise, OpensTheLineAndWaitsForADevice) {
  Events.At(50ms, [this] {
    EXPECT_EQ(shown.Download, "Running...");
    EXPECT_EQ(shown.Status, "Power up device now. Waiting for device response...");
    EXPECT_EQ(shown.Lamps, "red red");
    EXPECT_EQ(shown.BreakCaption, "&Stop Waiting");
    EXPECT_TRUE(shown.Running);
    EXPECT_THAT(Port.Log, ElementsAre("Open /dev/ttyS0 19200,n,8,1"));
    EXPECT_EQ(Port.Instrument, "boot-code");
    EXPECT_THAT(Awake.Reasons, ElementsAre("Firmware download"));
    EXPECT_EQ(Awake.Held, 1);
  });
  boot.SwitchOnAt(100ms);
  boot.OnCommand = [this](const std::string& command) {
    EXPECT_EQ(command, "X");
    EXPECT_EQ(shown.Status, "Syncronising with device...");
    EXPECT_EQ(shown.BreakCaption, "Abort");
    EXPECT_EQ(shown.Lamps, "green red");
  };
  RunNothing();
  EXPECT_THAT(boot.Commands, ElementsAre("X"));
  ExpectComplete();
}

TEST_F(Synchronise, SendsNothingMoreForAFileOfNoKind) {
  boot.SwitchOnAt(100ms);
  RunNothing();
  EXPECT_EQ(boot.Letters(), "X");
  EXPECT_EQ(shown.Status, "Syncronising with device...");
  EXPECT_EQ(shown.BreakCaption, "Abort");
  EXPECT_EQ(shown.TimesBusy, 0);
  ExpectComplete();
}

TEST_F(Synchronise, TellsTheKindByTheNamesEndInSmallLettersOnly) {
  for (const auto& [name, type] : {std::pair{"a.qvm", FirmwareFileType::Qvm},
                                   {"qvm", FirmwareFileType::Qvm},
                                   {"x.hexqvm", FirmwareFileType::Qvm},
                                   {"a.qvm2", FirmwareFileType::Qvm2},
                                   {"a.QVM", FirmwareFileType::None},
                                   {"a.Qvm2", FirmwareFileType::None},
                                   {"a.qvm ", FirmwareFileType::None},
                                   {"a.qvm3", FirmwareFileType::None},
                                   {"vm2", FirmwareFileType::None},
                                   {"", FirmwareFileType::None}}) {
    EXPECT_EQ(TypeOf(name), type) << name;
  }
}

TEST_F(Synchronise, WaitsForADeviceWithoutLimit) {
  boot.SwitchOnAt(24h);
  RunNothing();
  EXPECT_GE(Events.Now(), 24h);
  ExpectComplete();
}

TEST_F(Synchronise, IgnoresOtherCharactersBetweenTheLetters) {
  boot.SayAt(100ms, std::string("\0\xFF noise b 1", 11));
  boot.SayAt(200ms, "B");
  boot.SayAt(300ms, "xO\r\n");
  boot.SayAt(400ms, "fcO");
  boot.SayAt(90min, "?T");
  RunNothing();
  EXPECT_EQ(boot.Letters(), "X");
  ExpectComplete();
}

TEST_F(Synchronise, TakesTheFirstAnnouncementThatIsWhole) {
  boot.SayAt(100ms, "BOOTBOOT");
  RunNothing();
  EXPECT_EQ(boot.Letters(), "X");
  ExpectComplete();
}

TEST_F(Synchronise, WaitsInVainAfterAStrayLetter) {
  for (const char* stray : {"B", "O", "T", "BO", "TOOB"}) {
    Boxes.Boxes.clear();
    boot.SayAt(100ms, stray);
    for (int time = 1; time < 20; ++time) {
      boot.SayAt(time * 1s, "BOOT");
    }
    AbortAt(60s);
    RunNothing();
    ExpectBox(LoadModeText);
    ExpectReset();
    EXPECT_THAT(boot.Commands, IsEmpty()) << stray;
  }
}

TEST_F(Synchronise, StoppedBeforeTheDeviceTellsThatItDidNotEnterLoadMode) {
  AbortAt(5s);
  RunNothing();
  EXPECT_EQ(Events.Now(), 5s);
  ExpectBox(LoadModeText);
  ExpectReset();
  EXPECT_EQ(shown.Lamps, "red red");
  EXPECT_EQ(shown.BreakCaption, "&Stop Waiting");
  EXPECT_EQ(shown.Advice, Text(OwnText::AdviceNoDevice));
  EXPECT_THAT(Port.Sent, IsEmpty());
}

TEST_F(Synchronise, StoppedTogetherWithTheAnnouncementEnds) {
  Events.At(5s, [this] {
    boot.Say("BOOT");
    download.RequestAbort();
  });
  RunNothing();
  ExpectBox(LoadModeText);
  EXPECT_THAT(Port.Sent, IsEmpty());
}

TEST_F(Synchronise, WaitsTenSecondsForTheReply) {
  boot.SwitchOnAt(1s);
  boot.Instead = [](const auto& /*command*/) { return ""; };
  RunNothing();
  EXPECT_EQ(Events.Now(), 11s);
  ExpectBox(TimeOutText);
  ExpectReset();
  EXPECT_EQ(shown.BreakCaption, "Abort");
  EXPECT_EQ(shown.Lamps, "green red");
  EXPECT_EQ(shown.Advice, Text(OwnText::AdviceUnchanged));
}

TEST_F(Synchronise, DropsAllCharactersButTheAwaitedOneUntilTheTimeIsOver) {
  boot.SwitchOnAt(1s);
  boot.Instead = [this](const auto& /*command*/) {
    for (int time = 1; time < 300; ++time) {
      boot.SayAt(time * 100ms, "XpfcbB");
    }
    return "";
  };
  RunNothing();
  EXPECT_EQ(Events.Now(), 11s);
  ExpectBox(TimeOutText);
}

TEST_F(Synchronise, TakesAReplyBehindOthersAndTheLastMoment) {
  boot.SwitchOnAt(1s);
  boot.AnswerTime = 9999ms;
  boot.Instead = [](const auto& /*command*/) { return "OOTBOOTx"; };
  RunNothing();
  ExpectComplete();
}

TEST_F(Synchronise, StoppedAfterTheAnnouncementTellsThatTheDeviceDidNotFinish) {
  boot.SwitchOnAt(1s);
  boot.Instead = [](const auto& /*command*/) { return ""; };
  AbortAt(3s);
  RunNothing();
  EXPECT_EQ(Events.Now(), 3s);
  ExpectBox(AbortText);
  ExpectReset();
}

TEST_F(Synchronise, TheStopWinsOverTheTimeOut) {
  boot.SwitchOnAt(1s);
  boot.Instead = [](const auto& /*command*/) { return ""; };
  AbortAt(11s);
  RunNothing();
  ExpectBox(AbortText);
}

TEST_F(Synchronise, AStopFromBeforeIsForgotten) {
  download.RequestAbort();
  boot.SwitchOnAt(1s);
  RunNothing();
  ExpectComplete();
}

TEST_F(Synchronise, TheNextDownloadClosesAPortThatWasLeftOpen) {
  AbortAt(1s);
  RunNothing();
  Boxes.Boxes.clear();
  boot.SwitchOnAt(1s);
  RunNothing();
  EXPECT_EQ(Port.Log, (std::vector<std::string>{"Open /dev/ttyS0 19200,n,8,1", "Close",
                                                "Open /dev/ttyS0 19200,n,8,1", "Output 88", "Close"}));
  ExpectComplete();
}

TEST_F(Synchronise, ClearsWhatTheDownloadBeforeShowed) {
  boot.SwitchOnAt(1s);
  RunNothing();
  shown.Bar = 0.5;
  shown.Advice = "old";
  shown.Sent = 7;
  AbortAt(1s);
  Events.At(500ms, [this] {
    EXPECT_EQ(shown.Lamps, "red red");
    EXPECT_EQ(shown.Bar, 0);
    EXPECT_EQ(shown.Advice, "");
    EXPECT_EQ(shown.Sent, 0U);
  });
  RunNothing();
}

TEST_F(Synchronise, ThatTheLineDoesNotOpenIsThrownAndLeavesTheButtons) {
  for (const int failure : {8002, 8005}) {
    Port.FailNextOpen(failure);
    EXPECT_EQ(NumberThrownBy([this] { RunNothing(); }), failure);
    EXPECT_FALSE(shown.Running);
    EXPECT_FALSE(Port.PortOpen());
    EXPECT_EQ(shown.Download, "Running...");
    EXPECT_EQ(shown.Lamps, "red red");
    EXPECT_EQ(shown.Advice, Text(OwnText::AdviceNotStarted));
    EXPECT_THAT(Awake.Reasons, IsEmpty());
  }
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_F(Synchronise, ThatThereIsNoDeviceForThePortNumberIsThrown) {
  EXPECT_EQ(NumberThrownBy([this] {
              download.Run("a", []() -> std::string { throw RuntimeError(Fault::InvalidPortNumber); });
            }),
            8002);
  EXPECT_THAT(Port.Log, IsEmpty());
  EXPECT_EQ(shown.Advice, Text(OwnText::AdviceNotStarted));
}

TEST_F(Synchronise, AFileThatCannotBeLoadedIsThrownBeforeTheLineOpens) {
  Disk.Put("/fw/bad.qvm2", "201\r\n\r\n");
  Disk.Put("/fw/odd.qvm2", "0\r\n0\r\n0\r\n");
  Disk.Put("/fw/secret.qvm", ":00\r\n");
  Disk.AddFolder("/fw/folder.qvm2");
  Disk.FailRead("/fw/secret.qvm", RuntimeError(75));
  for (const auto& [name, number] : {std::pair{"/fw/none.qvm", 53},
                                     {"/fw/none.qvm2", 53},
                                     {"/fw/bad.qvm2", 9},
                                     {"/fw/odd.qvm2", 6},
                                     {"/fw/secret.qvm", 75},
                                     {"/fw/folder.qvm2", 75}}) {
    EXPECT_EQ(NumberThrownBy([this, name = name] { Run(name); }), number) << name;
    EXPECT_FALSE(shown.Running);
    EXPECT_EQ(shown.Busy, 0);
    EXPECT_EQ(shown.Advice, Text(OwnText::AdviceNotStarted));
  }
  EXPECT_THAT(Port.Log, IsEmpty());
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_F(Synchronise, AFileThatCannotBeLoadedFindsThePortClosed) {
  AbortAt(1s);
  RunNothing();
  EXPECT_TRUE(Port.PortOpen());
  EXPECT_EQ(NumberThrownBy([this] { Run("/fw/none.qvm"); }), 53);
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_EQ(shown.Download, "Downloading...");
  EXPECT_EQ(shown.Status, "Idle");
}

TEST_F(Synchronise, AdvisesAnewInEachDownload) {
  boot.SwitchOnAt(1s);
  boot.Instead = [](const auto& /*command*/) { return ""; };
  RunNothing();
  EXPECT_EQ(shown.Advice, Text(OwnText::AdviceUnchanged));
  AbortAt(1s);
  RunNothing();
  EXPECT_EQ(shown.Advice, Text(OwnText::AdviceNoDevice));
}

TEST_F(Synchronise, AFileThatIsTooLargeIsThrownByWhatIsWrongInItsStart) {
  constexpr std::size_t tooMuch = (8U << 20U) + 1;
  Disk.Put("/fw/large.qvm", std::string(tooMuch, '1'));
  Disk.Put(
      "/fw/data.qvm2", "\r\n\r\n" + [] {
        std::string lines;
        for (int line = 0; line < 90'000; ++line) {
          lines += std::string(96, 'F') + "\r\n";
        }
        return lines;
      }());
  Disk.Put("/fw/feeds.qvm2", std::string(tooMuch, '\n'));
  Disk.Put("/fw/zeros.qvm2", std::string(tooMuch, '\0'));
  Disk.Put("/fw/empty.qvm2", [] {
    std::string lines;
    while (lines.size() < tooMuch) {
      lines += "\r\n";
    }
    return lines;
  }());
  for (const auto& [name, number] : {std::pair{"/fw/large.qvm", 7},
                                     {"/fw/data.qvm2", 9},
                                     {"/fw/feeds.qvm2", 6},
                                     {"/fw/zeros.qvm2", 62},
                                     {"/fw/empty.qvm2", 7}}) {
    EXPECT_EQ(NumberThrownBy([this, name = name] { Run(name); }), number) << name;
    EXPECT_EQ(shown.Busy, 0);
  }
  EXPECT_THAT(Port.Log, IsEmpty());
}

TEST_F(Synchronise, AFileIsNotTooLargeUpToEightMegabytes) {
  boot.BufferSizes = {0};
  std::string contents(8U << 20U, ';');
  contents.replace(0, 6, ":\r\n:\r\n", 6);
  RunQvm(contents);
  EXPECT_EQ(boot.Letters(), "XPBSZZF");
  ExpectComplete();
}

TEST_F(Synchronise, AFileOfNoKindIsNotReadHoweverLarge) {
  Disk.Put("/fw/GUN.QVM", std::string((8U << 20U) + 1, '1'));
  Disk.FailRead("/fw/GUN.QVM", RuntimeError(75));
  boot.SwitchOnAt(100ms);
  RunNothing();
  ExpectComplete();
}

TEST_F(Synchronise, ADownloadAfterAFailedLoadIsAsGoodAsAny) {
  Disk.Put("/fw/bad.qvm2", "201\r\n\r\n");
  EXPECT_EQ(NumberThrownBy([this] { Run("/fw/bad.qvm2"); }), 9);
  RunQvm2("\r\n\r\n");
  ExpectComplete();
}

class WrongProduct : public DownloadSite {
 protected:
  void ExpectRefused() {
    ExpectBox("Wrong Product for this firmware file. Aborting.");
    ExpectNoReset();
    EXPECT_EQ(boot.Letters(), "XP");
    EXPECT_EQ(shown.Status, "Syncronising with device...");
    EXPECT_EQ(shown.Advice, Text(OwnText::AdviceWrongProduct) + " " + Text(OwnText::AdviceClose));
  }
};

TEST_F(WrongProduct, OfAQvmFile) {
  boot.Instead = [](const std::string& command) {
    return command == "P" ? std::optional<std::string>("d") : std::nullopt;
  };
  RunQvm(":01\r\n:02\r\n");
  ExpectRefused();
}

TEST_F(WrongProduct, OfAQvm2File) {
  boot.Instead = [](const std::string& command) {
    return command == "P" ? std::optional<std::string>("p") : std::nullopt;
  };
  RunQvm2("\r\n\r\n");
  ExpectRefused();
}

TEST_F(WrongProduct, IsLeftByClosing) {
  boot.Instead = [](const std::string& command) {
    return command == "P" ? std::optional<std::string>("p") : std::nullopt;
  };
  RunQvm2("\r\n\r\n");
  download.RequestAbort();
  EXPECT_TRUE(shown.Running);
  download.Close();
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_EQ(Boxes.Boxes.size(), 1U);
}

TEST_F(WrongProduct, IsOnlyToldByTheTwoKnownAnswers) {
  boot.Instead = [](const std::string& command) {
    return command == "P" ? std::optional<std::string>("xqDPd") : std::nullopt;
  };
  RunQvm2("\r\n\r\n");
  ExpectComplete();
}

}  // namespace
