#include "firmware/download/FirmwareFlash.h"

#include <gmock/gmock.h>

#include <QGroupBox>
#include <QImage>
#include <QLabel>
#include <QLineEdit>
#include <cstdlib>
#include <memory>
#include <string>

#include "firmware/download/LabelBar.h"
#include "firmware/download/Lamp.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSerialPort.h"
#include "tests/fakes/FakeWakeLock.h"
#include "tests/firmware/download/BootCode.h"
#include "tests/support/Captions.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

constexpr const char* AbortText =
    "The device did not finish loading. You are likely to experience unexpected program execution.";

class FirmwareWindow : public testing::TestWithParam<Language> {
 protected:
  FirmwareWindow() {
    devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB0"};
    disk.AddFolder("/data");
    disk.Put("/fw/gun.qvm2",
             "1\r\n0,8\r\n" + std::string(3072, 'A') + "\r\n" + std::string(3072, 'B') + "\r\n");
    disk.Put("/fw/gun.qvm", ":01\r\n:02\r\n");
  }

  /// Opens the window; `settings` are those of the ini file.
  FirmwareFlash& Open(const std::string& settings = "[Paths]\nfirmware_path=/fw/gun.qvm2\n") {
    disk.Put("/data/tessarine.ini", settings);
    window = std::make_unique<FirmwareFlash>(FirmwareFlash::Parts{.MSComm1 = port,
                                                                  .Devices = devices,
                                                                  .Ini = ini,
                                                                  .Events = events,
                                                                  .Boxes = boxes,
                                                                  .Cd1 = dialog,
                                                                  .Disk = disk,
                                                                  .Time = time,
                                                                  .Elapsed = events,
                                                                  .Strings = strings,
                                                                  .Awake = awake,
                                                                  .LogFolder = "/data/logs"},
                                             nullptr);
    Show(*window);
    return *window;
  }

  void Press(const char* button) { ::Press(*window, button); }
  std::string TextOf(const char* label) const { return Find<QLabel>(*window, label).text().toStdString(); }
  bool IsEnabled(const char* control) const { return Find<QWidget>(*window, control).isEnabled(); }
  std::string FileName() const { return Find<QLineEdit>(*window, "txtFileName").text().toStdString(); }
  std::string StoredPath() const { return ini.ReadIni("Paths", "firmware_path", "none"); }

  std::string Lamps() const {
    const auto colour = [this](const char* lamp) {
      return std::string(Find<Lamp>(*window, lamp).IsGreen() ? "green" : "red");
    };
    return colour("sptConnect") + " " + colour("sptComplete");
  }

  /// Width of the bar's foreground as a share of its background.
  double Bar() const {
    return static_cast<double>(Find<QLabel>(*window, "lblDownloadBarFG").width()) /
           Find<QLabel>(*window, "lblDownloadBarBG").width();
  }

  void ExpectIdle() {
    EXPECT_EQ(TextOf("lblStatus"), "Idle");
    EXPECT_EQ(TextOf("lblDownload"), "Idle");
    EXPECT_TRUE(IsEnabled("cmdDownload"));
    EXPECT_TRUE(IsEnabled("cmdBrowse"));
    EXPECT_FALSE(IsEnabled("cmdBreak"));
  }

  void ExpectBox(const std::string& text, BoxIcon icon = BoxIcon::Exclamation) {
    EXPECT_THAT(boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{text, "Tessarine", icon, BoxButtons::Ok}));
  }

  FakeFiles disk;
  FakeEventPump events;
  FakeClock time;
  FakeMessageBoxes boxes;
  FakeFileDialog dialog;
  FakeSerialDevices devices;
  FakeSerialPort port;
  FakeWakeLock awake;
  StringTable strings{GetParam()};
  IniReader ini{disk, "/data/tessarine.ini"};
  BootCode boot{port, events};
  std::unique_ptr<FirmwareFlash> window;
};

TEST_P(FirmwareWindow, HasItsCaptionsInBothLanguages) {
  Open();
  EXPECT_EQ(window->windowTitle(), QStringLiteral("Firmware Update"));
  ExpectCaptions(*window, {{"Frame1", "Source File"},
                           {"cmdBrowse", "&Open File"},
                           {"cmdDownload", "&Download"},
                           {"cmdBreak", "&Abort"},
                           {"Close", "Close"},
                           {"lblStat", "Status:"},
                           {"lblStatus", "Idle"},
                           {"lblDownload", "Idle"},
                           {"lblCurrentBuffer", "Buffer Empty"}});
  EXPECT_EQ(Find<QLineEdit>(*window, "Text1").text(), QString());
  EXPECT_EQ(Bar(), 0);
  EXPECT_EQ(Lamps(), "red red");
  EXPECT_FALSE(IsEnabled("cmdBreak"));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_THAT(port.Log, IsEmpty());
}

TEST_P(FirmwareWindow, ShowsTheLastFileAndOffersItsDownload) {
  Open();
  EXPECT_EQ(FileName(), "/fw/gun.qvm2");
  EXPECT_TRUE(IsEnabled("cmdDownload"));
  EXPECT_THAT(TextOf("lblDescription"),
              HasSubstr(GetParam() == Language::English ? "QVM2 file: 2 pages, 2 rows, "
                                                        : "QVM2 文件：2 页，2 行，"));
}

TEST_P(FirmwareWindow, OffersNoDownloadWithoutAFile) {
  Open("");
  EXPECT_EQ(FileName(), "Select a File");
  EXPECT_FALSE(IsEnabled("cmdDownload"));
  EXPECT_EQ(TextOf("lblDescription"), "");
  Open("[Paths]\nfirmware_path=/fw/gone.qvm\n");
  EXPECT_EQ(FileName(), "/fw/gone.qvm");
  EXPECT_FALSE(IsEnabled("cmdDownload"));
  Open("[Paths]\nfirmware_path=\n");
  EXPECT_FALSE(IsEnabled("cmdDownload"));
  Open("[Paths]\nfirmware_path=/fw\n");
  EXPECT_FALSE(IsEnabled("cmdDownload"));
}

TEST_P(FirmwareWindow, SaysThatThePortIsNoNumber) {
  Open("[comm]\ncommport=first\n[Paths]\nfirmware_path=/fw/gun.qvm2\n");
  ExpectBox("13 = Type mismatch");
  EXPECT_EQ(FileName(), "/fw/gun.qvm2");
  EXPECT_FALSE(IsEnabled("cmdDownload"));
  boxes.Boxes.clear();
  dialog.Answers = {"/fw/gun.qvm2"};
  Press("cmdBrowse");
  Press("cmdDownload");  // port 0
  EXPECT_THAT(port.Log, IsEmpty());
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_THAT(boxes.Boxes[0].Text, HasSubstr("Run-time error '8002'"));
}

TEST_P(FirmwareWindow, UsesThePortOfTheSettings) {
  Open("[comm]\ncommport=2\n[Paths]\nfirmware_path=/fw/gun.qvm2\n");
  boot.SwitchOnAt(1s);
  Press("cmdDownload");
  EXPECT_EQ(port.Device, "/dev/ttyUSB0");
  EXPECT_EQ(port.Settings, "19200,n,8,1");
}

TEST_P(FirmwareWindow, AsksForAFile) {
  Open("");
  dialog.Answers = {"/fw/gun.qvm"};
  Press("cmdBrowse");
  EXPECT_THAT(dialog.Calls, ElementsAre(FakeFileDialog::Call{
                                .Filter = "QVM Files (*.QVM;*.QVM2)|*.QVM;*.QVM2| All Files (*.*)|*.*",
                                .Name = "",
                                .Title = "Select a file "}));
  EXPECT_EQ(FileName(), "/fw/gun.qvm");
  EXPECT_TRUE(IsEnabled("cmdDownload"));
  EXPECT_THAT(TextOf("lblDescription"), HasSubstr("QVM"));
}

TEST_P(FirmwareWindow, KeepsTheFileWhenNoneIsChosen) {
  Open("");
  Press("cmdBrowse");
  EXPECT_EQ(FileName(), "Select a File");
  EXPECT_FALSE(IsEnabled("cmdDownload"));
}

TEST_P(FirmwareWindow, KeepsThePathForTheNextTime) {
  Open("");
  dialog.Answers = {"/fw/gun.qvm"};
  Press("cmdBrowse");
  EXPECT_EQ(StoredPath(), "none");
  Press("Close");
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(StoredPath(), "/fw/gun.qvm");
}

TEST_P(FirmwareWindow, KeepsANameThatWasTyped) {
  Open();
  auto& name = Find<QLineEdit>(*window, "txtFileName");
  name.setFocus();
  name.selectAll();
  QTest::keyClicks(&name, QStringLiteral("/fw/gun.qvm"));
  QTest::keyClick(&name, Qt::Key_Tab);
  EXPECT_THAT(TextOf("lblDescription"),
              HasSubstr(GetParam() == Language::English ? "QVM file: 2" : "QVM 文件：2"));
  window->close();
  EXPECT_EQ(StoredPath(), "/fw/gun.qvm");
}

TEST_P(FirmwareWindow, CanBeDestroyedWhileItsNameIsBeingTyped) {
  for (int round = 0; round < 10; ++round) {
    Find<QLineEdit>(Open(), "txtFileName").setFocus();
  }
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_P(FirmwareWindow, ANameThatWasTypedOffersNoDownload) {
  Open("");
  auto& name = Find<QLineEdit>(*window, "txtFileName");
  name.setFocus();
  name.selectAll();
  QTest::keyClicks(&name, QStringLiteral("/fw/gun.qvm"));
  QTest::keyClick(&name, Qt::Key_Tab);
  EXPECT_FALSE(IsEnabled("cmdDownload"));
}

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
    boxes.WhileOpen = [&](const auto& /*box*/) { there = window->isVisible(); };
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

TEST_P(FirmwareWindow, IsDrivenByTheKeyboard) {
  Open();
  events.At(1s, [this] {
    EXPECT_TRUE(Find<QPushButton>(*window, "cmdBreak").hasFocus());
    Type(*window, Qt::Key_Space);
  });
  // A button that is pressed by its Alt key stays down for a moment first.
  Type(*window, Qt::Key_D, Qt::AltModifier);
  EXPECT_TRUE(QTest::qWaitFor([this] { return !boxes.Boxes.empty(); }));
  ExpectBox("The device did not enter load mode.");
  EXPECT_TRUE(Find<QPushButton>(*window, "cmdDownload").hasFocus());
  Type(*window, Qt::Key_O, Qt::AltModifier);
  EXPECT_TRUE(QTest::qWaitFor([this] { return dialog.Calls.size() == 1; }));
}

TEST_P(FirmwareWindow, NamesItsLampsAndNothingElseSo) {
  Open();
  for (const auto& [lamp, name] : {std::pair{"sptConnect", "Connected"}, {"sptComplete", "Complete"}}) {
    EXPECT_EQ(Find<QWidget>(*window, lamp).accessibleName().toStdString(), name);
    int named = 0;
    for (const QWidget* widget : window->findChildren<QWidget*>()) {
      named += widget->accessibleName().toStdString() == name || CaptionOf(*widget) == name ? 1 : 0;
    }
    EXPECT_EQ(named, 1) << name;
  }
}

TEST_P(FirmwareWindow, HasLampsThatArePlainlyRedOrGreen) {
  Open();
  auto& lamp = Find<Lamp>(*window, "sptConnect");
  for (const bool green : {false, true}) {
    lamp.SetGreen(green);
    const QImage picture = lamp.grab().toImage();
    for (int y = picture.height() / 4; y < picture.height() * 3 / 4; ++y) {
      for (int x = picture.width() / 4; x < picture.width() * 3 / 4; ++x) {
        ASSERT_EQ(picture.pixelColor(x, y), green ? QColor(0, 255, 0) : QColor(255, 0, 0)) << x << ' ' << y;
      }
    }
  }
}

TEST_P(FirmwareWindow, KeepsItsBarAtTheSameShareWhenItIsResized) {
  Open();
  auto& bar = Find<LabelBar>(*window, "lblDownloadBarBG");
  bar.SetShare(0.25);
  for (const int width : {900, 1000, 850}) {
    window->resize(width, 600);
    QCoreApplication::processEvents();
    EXPECT_NEAR(Bar(), 0.25, 0.002);
  }
  const QImage picture = bar.grab().toImage();
  const QColor filled = picture.pixelColor(picture.width() / 8, picture.height() / 2);
  const QColor empty = picture.pixelColor(picture.width() / 2, picture.height() / 2);
  EXPECT_GT(std::abs(filled.lightness() - empty.lightness()), 30);
  bar.SetShare(1.5);
  EXPECT_EQ(Bar(), 1);
}

TEST_P(FirmwareWindow, IsCaredFor) {
  Open();
  ExpectCaredFor(*window);
  disk.Put("/fw/long.qvm",
           ":" + std::string(102, '0') + "\r\n:" + std::string(102, 'A') + "\r\n;\r\n:1G\n\r\n");
  dialog.Answers = {"/fw/long.qvm"};
  Press("cmdBrowse");
  boot.Product = 'p';
  boot.BufferSizes = {51};
  boot.SwitchOnAt(1s);
  boot.Instead = [this](const std::string& command) -> std::optional<std::string> {
    if (command[0] != 'Z') {
      return std::nullopt;
    }
    events.At(1s, [this] {
      ExpectCaredFor(*window);
      Press("cmdBreak");
    });
    return "";
  };
  Press("cmdDownload");
  ExpectBox(AbortText);
  ExpectCaredFor(*window);
}

INSTANTIATE_TEST_SUITE_P(Languages, FirmwareWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "Chinese";
                         });

}  // namespace
