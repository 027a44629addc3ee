// The window during a download and after its end.

#include <gmock/gmock.h>

#include <string>
#include <vector>

#include "tests/firmware/download/FirmwareWindow.h"
#include "tests/support/Captions.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

TEST_P(FirmwareWindow, ShowsHowADownloadGoes) {
  Open();
  boot.SwitchOnAt(100ms);
  int looks = 0;
  events.At(50ms, [&] {
    ++looks;
    EXPECT_EQ(TextOf("lblStatus"), "Power up device now. Waiting for device response...");
    EXPECT_EQ(TextOf("lblDownload"), "Running...");
    EXPECT_EQ(CaptionOf(Find<QPushButton>(*window, "cmdBreak")), "&Stop Waiting");
    EXPECT_TRUE(IsEnabled("cmdBreak"));
    EXPECT_FALSE(IsEnabled("cmdDownload"));
    EXPECT_FALSE(IsEnabled("cmdBrowse"));
    EXPECT_TRUE(IsEnabled("Close"));
    EXPECT_EQ(awake.Held, 1);
  });
  boot.OnCommand = [&](const std::string& command) {
    EXPECT_EQ(CaptionOf(Find<QPushButton>(*window, "cmdBreak")), "Abort");
    EXPECT_EQ(Lamps(), "green red");
    if (command[0] == 'F') {
      ++looks;
      EXPECT_EQ(TextOf("lblStatus"), "Loaded 128 code words");
      EXPECT_EQ(Bar(), 1);
    }
  };
  Press("cmdDownload");
  EXPECT_EQ(looks, 2);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_EQ(TextOf("lblDownload"), "Download Complete!");
  EXPECT_EQ(TextOf("lblStatus"), "Loaded 128 code words");
  EXPECT_EQ(Lamps(), "green green");
  EXPECT_TRUE(IsEnabled("cmdDownload"));
  EXPECT_TRUE(IsEnabled("cmdBrowse"));
  EXPECT_FALSE(IsEnabled("cmdBreak"));
  EXPECT_EQ(CaptionOf(Find<QPushButton>(*window, "cmdBreak")), "Abort");
  EXPECT_EQ(TextOf("lblAdvice"), "");
  EXPECT_FALSE(port.PortOpen());
}

TEST_P(FirmwareWindow, ShowsTheLineInWork) {
  Open("[Paths]\nfirmware_path=/fw/gun.qvm\n");
  boot.Product = 'p';
  boot.SwitchOnAt(100ms);
  std::vector<std::string> buffers;
  boot.OnCommand = [&](const std::string& command) {
    if (command[0] == 'Z') {
      buffers.push_back(TextOf("lblCurrentBuffer"));
      EXPECT_EQ(Find<QLineEdit>(*window, "Text1").text(), QString());
    }
  };
  Press("cmdDownload");
  EXPECT_THAT(buffers, ElementsAre(":01", ":02"));
  EXPECT_EQ(TextOf("lblCurrentBuffer"), ":02");
}

TEST_P(FirmwareWindow, SaysHowMuchTimeIsLeft) {
  Open();
  port.Pump = &events;
  boot.AnswerTime = 500ms;
  boot.SwitchOnAt(100ms);
  std::vector<std::string> left;
  boot.OnCommand = [&](const std::string& command) {
    if (command[0] == 'E') {
      left.push_back(TextOf("lblTimeLeft"));
    }
  };
  Press("cmdDownload");
  ASSERT_EQ(left.size(), 2U);
  EXPECT_EQ(left[0], "");
  EXPECT_EQ(left[1], GetParam() == Language::English ? "0 min 4 s left" : "剩余 0 分 4 秒");
  EXPECT_EQ(TextOf("lblTimeLeft"), "");
}

TEST_P(FirmwareWindow, ReckonsTheTimeLeftAnewInEachDownload) {
  Open();
  port.Pump = &events;
  boot.AnswerTime = 500ms;
  for (int round = 0; round < 2; ++round) {
    boot.Commands.clear();
    boot.SwitchOnAt(100ms);
    boot.OnCommand = [&](const std::string& command) {
      if (command[0] == 'E' && boot.CountOf('E') == 2) {
        EXPECT_EQ(TextOf("lblTimeLeft"),
                  GetParam() == Language::English ? "0 min 4 s left" : "剩余 0 分 4 秒");
      }
    };
    Press("cmdDownload");
    EXPECT_EQ(TextOf("lblDownload"), "Download Complete!");
    events.Sleep(10min);
  }
}

TEST_P(FirmwareWindow, DescribesTheFileAsItIsWhenItIsSent) {
  Open();
  Find<QPushButton>(*window, "cmdDownload").setFocus();
  disk.Put("/fw/gun.qvm2", "1,2\r\n0,8\r\n");
  boot.SwitchOnAt(100ms);
  Press("cmdDownload");
  EXPECT_EQ(boot.CountOf('E'), 3U);
  EXPECT_THAT(TextOf("lblDescription"), HasSubstr(GetParam() == Language::English ? "3 pages" : "3 页"));
}

TEST_P(FirmwareWindow, StopsWaitingWhenAsked) {
  Open();
  events.At(5s, [this] { Press("cmdBreak"); });
  Press("cmdDownload");
  EXPECT_EQ(events.Now(), 5s);
  ExpectBox("The device did not enter load mode.");
  ExpectIdle();
  EXPECT_EQ(TextOf("lblAdvice"), strings.Text(OwnText::AdviceNoDevice));
}

TEST_P(FirmwareWindow, AbortsWhenAsked) {
  Open();
  boot.SwitchOnAt(1s);
  boot.Instead = [this](const std::string& command) -> std::optional<std::string> {
    if (command[0] != 'Z') {
      return std::nullopt;
    }
    events.At(1s, [this] { Press("cmdBreak"); });
    return "";
  };
  Press("cmdDownload");
  ExpectBox(AbortText);
  ExpectIdle();
  EXPECT_EQ(TextOf("lblAdvice"), strings.Text(OwnText::AdviceIncomplete));
  boot.Instead = nullptr;
  boot.SwitchOnAt(1s);
  Press("cmdDownload");
  EXPECT_EQ(TextOf("lblDownload"), "Download Complete!");
  EXPECT_EQ(TextOf("lblAdvice"), "");
}

TEST_P(FirmwareWindow, AfterAWrongProductOnlyCloseHelps) {
  Open("[Paths]\nfirmware_path=/fw/gun.qvm\n");
  boot.SwitchOnAt(1s);
  Press("cmdDownload");
  ExpectBox("Wrong Product for this firmware file. Aborting.");
  EXPECT_FALSE(IsEnabled("cmdDownload"));
  EXPECT_FALSE(IsEnabled("cmdBrowse"));
  EXPECT_TRUE(IsEnabled("cmdBreak"));
  EXPECT_TRUE(port.PortOpen());
  Press("cmdBreak");
  EXPECT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_TRUE(IsEnabled("cmdBreak"));
  Press("Close");
  EXPECT_FALSE(window->isVisible());
  EXPECT_FALSE(port.PortOpen());
  EXPECT_EQ(boxes.Boxes.size(), 1U);
}

TEST_P(FirmwareWindow, ReportsAFileThatCannotBeLoadedAndStaysUsable) {
  disk.Put("/fw/bad.qvm2", "0\n0\nFF\n");
  for (const auto& [name, report] : {std::pair{"/fw/gone.qvm", "Run-time error '53': File not found"},
                                     {"/fw/bad.qvm2", "Run-time error '6': Overflow"}}) {
    boxes.Boxes.clear();
    Open();
    dialog.Answers = {name};
    Press("cmdBrowse");
    Press("cmdDownload");
    ExpectBox(report, BoxIcon::Critical);
    EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
    EXPECT_TRUE(IsEnabled("cmdDownload"));
    EXPECT_TRUE(IsEnabled("cmdBrowse"));
    EXPECT_FALSE(IsEnabled("cmdBreak"));
    EXPECT_EQ(TextOf("lblAdvice"), strings.Text(OwnText::AdviceNotStarted));
    dialog.Answers = {"/fw/gun.qvm2"};
    Press("cmdBrowse");
    boot.SwitchOnAt(1s);
    Press("cmdDownload");
    EXPECT_EQ(TextOf("lblDownload"), "Download Complete!");
  }
}

TEST_P(FirmwareWindow, ReportsALineThatDoesNotOpen) {
  Open();
  port.FailNextOpen(8005);
  Press("cmdDownload");
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_THAT(boxes.Boxes[0].Text, HasSubstr("Run-time error '8005'"));
  EXPECT_TRUE(IsEnabled("cmdDownload"));
  EXPECT_FALSE(IsEnabled("cmdBreak"));
}

TEST_P(FirmwareWindow, TellsOnceThatTheLineWasLost) {
  Open();
  events.At(2s, [this] { port.Lose(); });
  Press("cmdDownload");
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_EQ(boxes.Boxes[0].Text, "Error Occured, The device is not open");
  EXPECT_EQ(boxes.Boxes[1].Text, "8012");
  EXPECT_EQ(boxes.Boxes[1].Icon, BoxIcon::None);
  EXPECT_EQ(TextOf("lblStatus"), "Error");
  EXPECT_EQ(TextOf("lblDownload"), "Idle");
  EXPECT_EQ(TextOf("lblCurrentBuffer"), "Buffer Empty");
  EXPECT_TRUE(IsEnabled("cmdDownload"));
}

TEST_P(FirmwareWindow, ClosedInAWaitGoesAfterItsOneBox) {
  for (const char* way : {"Close", "close box"}) {
    boxes.Boxes.clear();
    Open();
    bool there = false;
    boxes.WhileOpen = [&](const auto& /*box*/) {
      there = window->isVisible();
      ExpectIdle();
    };
    events.At(5s, [this, way] {
      if (std::string(way) == "Close") {
        Press("Close");
      } else {
        window->close();
      }
      EXPECT_FALSE(port.PortOpen());
    });
    Press("cmdDownload");
    ExpectBox("The device did not enter load mode.");
    EXPECT_TRUE(there);
    EXPECT_FALSE(window->isVisible());
    EXPECT_FALSE(port.PortOpen());
    EXPECT_EQ(awake.Held, 0);
    EXPECT_EQ(StoredPath(), "/fw/gun.qvm2");
  }
}

TEST_P(FirmwareWindow, ClosedInATransferGoesAfterItsOneBox) {
  Open();
  boot.SwitchOnAt(1s);
  boot.OnCommand = [this](const std::string& command) {
    if (command[0] == 'Z' && boot.CountOf('Z') == 3) {
      Press("Close");
    }
  };
  Press("cmdDownload");
  EXPECT_EQ(boot.CountOf('Z'), 3U);
  ExpectBox(AbortText);
  EXPECT_FALSE(window->isVisible());
  EXPECT_FALSE(port.PortOpen());
}

TEST_P(FirmwareWindow, IsNotClosedByEscapeDuringADownload) {
  Open();
  events.At(1s, [this] { QTest::keyClick(window.get(), Qt::Key_Escape); });
  boot.SwitchOnAt(2s);
  Press("cmdDownload");
  EXPECT_TRUE(window->isVisible());
  EXPECT_EQ(TextOf("lblDownload"), "Download Complete!");
  QTest::keyClick(window.get(), Qt::Key_Escape);
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(StoredPath(), "/fw/gun.qvm2");
}

TEST_P(FirmwareWindow, NothingStartsWhileItCloses) {
  Open();
  events.At(0ms, [this] { Press("cmdDownload"); });
  events.At(0ms, [this] { Press("cmdBrowse"); });
  Press("Close");
  EXPECT_FALSE(window->isVisible());
  EXPECT_THAT(port.Log, IsEmpty());
  EXPECT_THAT(dialog.Calls, IsEmpty());
}

TEST_P(FirmwareWindow, IsClosedOnceByTwoPresses) {
  Open();
  events.At(0ms, [this] { window->close(); });
  Press("Close");
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(StoredPath(), "/fw/gun.qvm2");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_P(FirmwareWindow, RefusesAFileThatIsTooLarge) {
  Open();
  disk.Put("/fw/large.qvm", std::string((8U << 20U) + 1, '1'));
  dialog.Answers = {"/fw/large.qvm"};
  Press("cmdBrowse");
  Press("cmdDownload");
  ExpectBox("Run-time error '7': Out of memory", BoxIcon::Critical);
  EXPECT_THAT(port.Log, IsEmpty());
  EXPECT_TRUE(IsEnabled("cmdDownload"));
  EXPECT_THAT(TextOf("lblDescription"), HasSubstr("8388609"));
}

}  // namespace
