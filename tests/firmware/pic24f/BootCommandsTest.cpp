#include <gmock/gmock.h>

#include "tests/firmware/pic24f/BootloadWindow.h"
#include "tests/support/CaredFor.h"

namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

constexpr const char* NoSelector = "Core error:  Object variable or With block variable not set";

class BootCommands : public BootloadWindow {};

TEST_P(BootCommands, DoesNothingWithDownloadOpenAndAbort) {
  Open();
  Press("cmdDownload");
  Act("Open");
  Act("Abort");
  EXPECT_THAT(Library.Log, IsEmpty());
  EXPECT_THAT(Dialog.Calls, IsEmpty());
  EXPECT_EQ(Status(), "Not connected...");
}

TEST_P(BootCommands, DisconnectsWhileRunIsUp) {
  Open();
  Act("Connect");
  EXPECT_THAT(Library.Log, IsEmpty());
  EXPECT_FALSE(Action("Connect").isChecked());
  EXPECT_EQ(Status(), "Not connected...");
  EXPECT_EQ(Panel(2), " ");
}

TEST_P(BootCommands, EndsAConnectionAtTheMissingDeviceSelector) {
  Open();
  Act("Run");
  Library.Log.clear();
  Act("Connect");
  EXPECT_THAT(Library.Log,
              ElementsAre("OpenPIC COM 1 115200 1000", "SendGetPacket 3: 0 2 up to 10, 3 retries",
                          "ReadPIC 3: 1 at 16711680, 4 bytes in blocks of 4, 3 retries",
                          "SendGetPacket 3: 1 2 0 0 0 up to 255, 5 retries"));
  EXPECT_EQ(Status(), NoSelector);
  EXPECT_EQ(Panel(2), " ");
  EXPECT_EQ(Panel(3), "v1.5");
  EXPECT_FALSE(Action("Write").isEnabled());
  ExpectCaptionsFit(*window);
}

TEST_P(BootCommands, CompletesAConnectionWithADeviceSelector) {
  Connect();
  EXPECT_EQ(Panel(2), "PIC-A");
  EXPECT_EQ(Panel(3), "v1.5");
  EXPECT_THAT(selector.Log, ElementsAre("Clear", "Config Word 2 44028", "Config Word 1 44030"));
  EXPECT_TRUE(Action("Write").isEnabled());
  EXPECT_TRUE(Action("Erase").isEnabled());
  EXPECT_TRUE(Action("Abort").isEnabled());
  EXPECT_FALSE(Action("M_MemAccess2").isVisible());
}

TEST_P(BootCommands, ShowsTheMemoriesOfADeviceWithEeprom) {
  Connect(1103);
  EXPECT_TRUE(Action("M_MemAccess2").isVisible());
  EXPECT_TRUE(Action("M_MemAccess2").isChecked());
  EXPECT_TRUE(Action("M_MemAccess3").isChecked());
  EXPECT_FALSE(Action("M_MemAccess4").isVisible());
  EXPECT_TRUE(Action("M_PSendCfg").isVisible());
}

TEST_P(BootCommands, ShowsItemsOfTheProgramMenuByTheDevice) {
  Open(true);
  EXPECT_TRUE(Action("M_MemAccess2").isVisible());
  EXPECT_FALSE(Action("space101").isVisible());
  EXPECT_FALSE(Action("M_PSendCfg").isVisible());
  Act("Run");
  Act("Connect");
  EXPECT_TRUE(Action("space101").isVisible());
  EXPECT_FALSE(Action("M_PSendCfg").isVisible());
  Connect(1103);
  EXPECT_TRUE(Action("space101").isVisible());
  Act("M_FPBaud7");
  EXPECT_FALSE(Action("space101").isVisible());
  EXPECT_TRUE(Action("M_PSendCfg").isVisible());
}

TEST_P(BootCommands, NeverDisablesTheFasterBitRates) {
  Connect();
  int calls = 0;
  Library.OnCall = [&](const std::string& operation) {
    if (operation == "ErasePIC") {
      ++calls;
      for (int item = 1; item <= 8; ++item) {
        const std::string name = "M_FPBaud" + std::to_string(item);
        EXPECT_EQ(Action(name.c_str()).isEnabled(), item > 5) << name;
      }
      EXPECT_TRUE(Action("Connect").isEnabled());
      EXPECT_TRUE(Action("Open").isEnabled());
    }
  };
  Boxes.Answers = {BoxAnswer::Yes};
  Act("Erase");
  EXPECT_EQ(calls, 1);
  EXPECT_TRUE(Action("M_FPBaud1").isEnabled());
  EXPECT_TRUE(Action("M_MemAccess1").isEnabled());
}

TEST_P(BootCommands, TellsAPortThatDoesNotOpen) {
  Open(true);
  Library.Handle = -1;
  Act("Run");
  Act("Connect");
  EXPECT_EQ(Status(), "Failed to open port...");
  EXPECT_FALSE(Action("Run").isChecked());
  EXPECT_EQ(Panel(3), "");
}

TEST_P(BootCommands, ConnectsToADeviceThatDoesNotAnswer) {
  Open(true);
  Library.Answers.clear();
  Library.Results["ReadPIC"] = {-2};
  Act("Run");
  Act("Connect");
  EXPECT_EQ(Panel(2), "");
  EXPECT_EQ(Panel(3), "");
  EXPECT_EQ(Status(), "Device found...");
}

TEST_P(BootCommands, DoesNotAskForTheIdentityInAnotherMode) {
  Put("devicemode", "1");
  Open(true);
  Act("Run");
  Act("Connect");
  EXPECT_THAT(Library.Log, Not(Contains(StartsWith("ReadPIC"))));
}

TEST_P(BootCommands, TellsAnIdentityThatOverflows) {
  Library.Identity = 0x8000;
  Open(true);
  Act("Run");
  Act("Connect");
  EXPECT_EQ(Status(), "Core error:  Overflow");
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(BootCommands, WritesTheMemoriesThatAreChosenAndConfirms) {
  Connect(1103);
  Act("Write");
  EXPECT_EQ(Status(), "Finished operation...");
  EXPECT_EQ(Library.Flash.size(), 512U);
  EXPECT_EQ(Library.Eeprom.size(), 32U);
  EXPECT_EQ(Library.Log.back(), "SendGetPacket 3: 8 up to 255, 5 retries");
  ExpectIdle();
}

TEST_P(BootCommands, OnlyConfirmsWhenNoMemoryIsChosen) {
  Connect();
  Check("M_MemAccess1", false);
  Act("Write");
  EXPECT_THAT(Library.Log, ElementsAre("SendGetPacket 3: 8 up to 255, 5 retries"));
  Library.Answers.erase(8);
  Act("Write");
  EXPECT_EQ(Status(), "Verify Ok command failed...");
}

TEST_P(BootCommands, WritesTheEepromAfterAFailureButDoesNotConfirm) {
  Connect(1103);
  Library.Results["WritePIC"] = {-7};
  Act("Write");
  EXPECT_EQ(Library.Eeprom.size(), 32U);
  EXPECT_EQ(Status(), "Finished operation...");
  EXPECT_THAT(Library.Log, Not(Contains(StartsWith("SendGetPacket"))));
  Library.Results["WritePIC"] = {-7, -7};
  Act("Write");
  EXPECT_EQ(Status(), "Failed to write device...");
}

TEST_P(BootCommands, ShowsTheLogOfDifferences) {
  Connect(1103);
  Library.OnCall = [this](const std::string& operation) {
    if (operation == "ReadPIC") {
      Library.Flash[0x40] = 0x12;
    }
  };
  Act("Write");
  EXPECT_EQ(Status(), "Verify error received...");
  EXPECT_THAT(Started.Started, ElementsAre(std::vector<std::string>{"viewer", "-n", "/data/verify.log"}));
  EXPECT_TRUE(Library.Eeprom.empty());
  EXPECT_THAT(Log(), StartsWith("Verify Error at 0x20 "));
  ExpectIdle();
}

TEST_P(BootCommands, TellsALogThatCannotBeShown) {
  Connect();
  Started.Failure = RuntimeError(53);
  Library.OnCall = [this](const std::string&) { Library.Flash[0x40] = 0x12; };
  Act("Write");
  EXPECT_THAT(Status(), testing::HasSubstr("/data/verify.log"));
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(BootCommands, StopsAWrite) {
  Connect(1103);
  Library.OnCall = [this](const std::string& operation) {
    if (operation == "WritePIC") {
      EXPECT_FALSE(Action("M_FPPort1").isEnabled());
      EXPECT_FALSE(Action("M_MemAccess1").isEnabled());
      EXPECT_NE(QGuiApplication::overrideCursor(), nullptr);
      Press("cmdBreak");
    }
  };
  Act("Write");
  EXPECT_EQ(Status(), "Operation aborted...");
  EXPECT_EQ(Library.Flash.size(), 256U);
  EXPECT_TRUE(Library.Eeprom.empty());
  EXPECT_THAT(Library.Log, Not(Contains(StartsWith("SendGetPacket"))));
  ExpectIdle();
}

TEST_P(BootCommands, IgnoresOtherCommandsDuringAWrite) {
  Connect();
  int calls = 0;
  Library.OnCall = [&](const std::string& operation) {
    if (operation == "WritePIC" && calls++ == 0) {
      const bool connectWasDown = Action("Connect").isChecked();
      for (const char* command : {"Connect", "Write", "Erase", "Run", "M_FPBaud7"}) {
        Act(command);
      }
      EXPECT_EQ(Action("Connect").isChecked(), connectWasDown);
      EXPECT_TRUE(Action("Run").isChecked());
      Press("cmdBrowse");
    }
  };
  Act("Write");
  EXPECT_EQ(Status(), "Finished operation...");
  EXPECT_EQ(Library.Flash.size(), 512U);
  EXPECT_EQ(Panel(5), "115200");
  EXPECT_THAT(Dialog.Calls, IsEmpty());
}

TEST_P(BootCommands, ReportsARuntimeFailureOfAWrite) {
  Connect();
  Disk.Remove("/data/progmem.img");
  Act("Write");
  ASSERT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_THAT(Boxes.Boxes[0].Text, StartsWith("Run-time error '53'"));
  ExpectIdle();
}

TEST_P(BootCommands, ConnectsAnewAfterALostLine) {
  Connect();
  Library.Broken = "WritePIC";
  Act("Write");
  ASSERT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_THAT(Boxes.Boxes[0].Text, StartsWith("Run-time error '8012'"));
  ExpectIdle();
  Library.Broken.clear();
  Library.Log.clear();
  Act("Connect");
  EXPECT_THAT(Library.Log, Contains("OpenPIC COM 1 115200 1000"));
  EXPECT_EQ(Status(), "Device found...");
}

TEST_P(BootCommands, ErasesProgramMemory) {
  Connect(1103);
  Act("Erase");
  EXPECT_THAT(Library.Log, ElementsAre("ErasePIC 3, 10 blocks from 1024, 5 retries"));
  EXPECT_EQ(Status(), "Finished operation...");
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  ExpectIdle();
}

TEST_P(BootCommands, AsksBeforeItErasesTheConfigurationWord) {
  Connect();
  Boxes.Answers = {BoxAnswer::Cancel, BoxAnswer::No, BoxAnswer::Yes};
  Act("Erase");
  EXPECT_EQ(Status(), "Operation aborted...");
  EXPECT_THAT(Library.Log, IsEmpty());
  Act("Erase");
  Act("Erase");
  EXPECT_THAT(Library.Log, ElementsAre("ErasePIC 3, 42 blocks from 0, 5 retries",
                                       "ErasePIC 3, 43 blocks from 0, 5 retries"));
  EXPECT_EQ(Boxes.Boxes[0], (FakeMessageBoxes::Box{"Erase Flash Configuration Word?", "Tessarine",
                                                   BoxIcon::None, BoxButtons::YesNoCancel}));
  ExpectIdle();
}

TEST_P(BootCommands, ErasesNothingWhenFlashIsNotChosen) {
  Connect();
  Check("M_MemAccess1", false);
  Act("Erase");
  EXPECT_THAT(Library.Log, IsEmpty());
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_EQ(Status(), "Device found...");
  EXPECT_TRUE(Action("Write").isEnabled());
  ExpectIdle();
}

TEST_P(BootCommands, TellsAnEraseThatFailsOrIsStopped) {
  Connect(1103);
  Library.Results["ErasePIC"] = {-2};
  Act("Erase");
  EXPECT_EQ(Status(), "Failed to write device...");
  Library.OnCall = [this](const std::string&) { Press("cmdBreak"); };
  Act("Erase");
  EXPECT_EQ(Status(), "Finished operation...");  // one call erased it all
}

TEST_P(BootCommands, RunsTheDevice) {
  Connect();
  Act("Run");
  EXPECT_THAT(Library.Log, ElementsAre("SendPacket 3: 0 0", "ClosePIC 3"));
  EXPECT_EQ(Status(), "Run mode is set...");
  EXPECT_EQ(Panel(2), " ");
  EXPECT_FALSE(Action("Connect").isChecked());
}

TEST_P(BootCommands, ClosesThePortWithTheWindow) {
  Connect();
  Press("Close");
  EXPECT_FALSE(window->isVisible());
  window.reset();
  EXPECT_THAT(Library.Log, ElementsAre("ClosePIC 3"));
}

TEST_P(BootCommands, ClosesAfterAnOperationHasUnwound) {
  Connect(1103);
  Library.OnCall = [this](const std::string& operation) {
    if (operation == "WritePIC") {
      window->close();
      EXPECT_TRUE(window->isVisible());
      EXPECT_TRUE(Stopped());
    }
  };
  Act("Write");
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(Library.Flash.size(), 256U);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
}

TEST_P(BootCommands, EscapeClosesItButNotDuringAnOperation) {
  Connect();
  Library.OnCall = [this](const std::string& operation) {
    if (operation == "WritePIC") {
      Type(*window, Qt::Key_Escape);
    }
  };
  Act("Write");
  EXPECT_TRUE(window->isVisible());
  EXPECT_EQ(Status(), "Finished operation...");
  Type(*window, Qt::Key_Escape);
  EXPECT_FALSE(window->isVisible());
}

INSTANTIATE_TEST_SUITE_P(Languages, BootCommands,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& tested) {
                           return tested.param == Language::English ? "English" : "Chinese";
                         });

}  // namespace
