#include "firmware/download/FirmwareFlash.h"

#include <gmock/gmock.h>

#include <QGroupBox>
#include <QImage>
#include <cstdlib>
#include <string>

#include "firmware/download/LabelBar.h"
#include "tests/firmware/download/FirmwareWindow.h"
#include "tests/support/Captions.h"
#include "tests/support/CaredFor.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

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
  EXPECT_EQ(Find<QLabel>(*window, "lblDownloadBarBG").accessibleName(), QStringLiteral("0 %"));
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

TEST_P(FirmwareWindow, UsesPortOneWhenTheFileIsNotFoundOrEnds) {
  for (const int fault : {53, 62}) {
    port.Device.clear();
    OpenInDoubt(fault);
    EXPECT_THAT(boxes.Boxes, IsEmpty());
    EXPECT_FALSE(IsEnabled("cmdDownload"));
    dialog.Answers = {"/fw/gun.qvm2"};
    Press("cmdBrowse");
    boot.SwitchOnAt(1s);
    Press("cmdDownload");
    EXPECT_EQ(port.Device, "/dev/ttyS0");
  }
}

TEST_P(FirmwareWindow, SaysThatItCannotTellWhetherTheFileExists) {
  OpenInDoubt(70);
  ExpectBox("70 = Permission denied");
  EXPECT_FALSE(IsEnabled("cmdDownload"));
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
