#include "firmware/pic24f/frmBootload.h"

#include <gmock/gmock.h>

#include "tests/firmware/hex/HexFile.h"
#include "tests/firmware/pic24f/BootloadWindow.h"
#include "tests/support/CaredFor.h"

namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::StartsWith;

TEST_P(BootloadWindow, OpensNotConnected) {
  Open();
  EXPECT_EQ(window->windowTitle(), QStringLiteral("Firmware Update - Type B"));
  EXPECT_EQ(Find<QGroupBox>(*window, "Frame1").title(), QStringLiteral("Source File"));
  EXPECT_EQ(Find<QPushButton>(*window, "cmdBrowse").text(), QStringLiteral("&Open File"));
  EXPECT_EQ(Find<QPushButton>(*window, "cmdDownload").text(), QStringLiteral("&Download"));
  EXPECT_EQ(Find<QPushButton>(*window, "cmdBreak").text(), QStringLiteral("&Abort"));
  EXPECT_EQ(Find<QPushButton>(*window, "Close").text(), QStringLiteral("Close"));
  EXPECT_EQ(Status(), "Not connected...");
  EXPECT_EQ(Panel(2), "UNKNOWN");
  EXPECT_EQ(Panel(3), "");
  EXPECT_EQ(Panel(4), "COM 1");
  EXPECT_EQ(Panel(5), "115200");
  EXPECT_THAT(Library.Log, IsEmpty());
  ExpectEntriesAreNamed(*window);
  ExpectCaptionsFit(*window);
}

TEST_P(BootloadWindow, HasNinePositionsInItsToolBar) {
  Open();
  std::vector<std::string> positions;
  for (const QAction* action : Find<QToolBar>(*window, "Toolbar1").actions()) {
    positions.push_back(action->isSeparator()
                            ? "-"
                            : action->objectName().toStdString() + ": " + action->toolTip().toStdString());
  }
  EXPECT_THAT(positions, ElementsAre("Open: Open HEX File", "-", "Abort: Abort Operation", "-",
                                     "Connect: Connect to Device", "Write: Write Device",
                                     "Erase: Erase Device", "-", "Run: Normal Execution Mode"));
  EXPECT_TRUE(Action("Connect").isCheckable());
  EXPECT_TRUE(Action("Run").isCheckable());
}

TEST_P(BootloadWindow, GivesTheToolBarToTheKeyboard) {
  Open();
  Show(*window);
  Find<QLineEdit>(*window, "txtFileName").setFocus();
  const auto& bar = Find<QToolBar>(*window, "Toolbar1");
  const auto* const run = bar.widgetForAction(&Action("Run"));
  int steps = 0;
  while (window->focusWidget() != run && steps++ < 30) {
    Type(*window, Qt::Key_Tab);
  }
  ASSERT_EQ(window->focusWidget(), run);
  Type(*window, Qt::Key_Space);
  EXPECT_EQ(Status(), "Run mode is set...");
  EXPECT_TRUE(Action("Run").isChecked());
}

TEST_P(BootloadWindow, HasToolTipsOnItsPanels) {
  Open();
  EXPECT_EQ(Find<QLabel>(*window, "StatusPanel1").toolTip(),
            QStringLiteral("Right click for memory read/write settings."));
  EXPECT_EQ(Find<QLabel>(*window, "StatusPanel2").toolTip(),
            QStringLiteral("PIC device, right click to select."));
}

TEST_P(BootloadWindow, HasPopUpMenus) {
  Open();
  const auto captions = [this](const char* menu) {
    std::vector<std::string> texts;
    for (const QAction* item : Find<QMenu>(*window, menu).actions()) {
      texts.push_back(item->isSeparator() ? item->objectName().toStdString() : item->text().toStdString());
    }
    return texts;
  };
  EXPECT_EQ(Find<QMenu>(*window, "M_PortSettings").title(), QStringLiteral("PortSettings"));
  EXPECT_EQ(Find<QMenu>(*window, "M_BitRateSettings").title(), QStringLiteral("BitRatetSettings"));
  EXPECT_THAT(captions("M_PortSettings"), ElementsAre("COM1", "COM2", "COM3", "COM4"));
  EXPECT_THAT(captions("M_BitRateSettings"),
              ElementsAre("1200", "2400", "4800", "9600", "19200", "38400", "57600", "115200"));
  EXPECT_THAT(captions("M_Program"), ElementsAre("Device Selector", "space104", "FLASH", "EEDATA", "CONFIG",
                                                 "USERID", "space101", "Send Config", "space102", "About"));
}

TEST_P(BootloadWindow, PopsUpTheMenuOfAPanel) {
  Open();
  const struct {
    const char* Panel;
    const char* Menu;
  } rows[] = {{"StatusPanel1", "M_Program"},
              {"StatusPanel4", "M_PortSettings"},
              {"StatusPanel5", "M_BitRateSettings"}};
  for (const auto& row : rows) {
    auto& menu = Find<QMenu>(*window, row.Menu);
    QTest::mouseClick(&Find<QLabel>(*window, row.Panel), Qt::LeftButton);
    EXPECT_FALSE(menu.isVisible());
    QTest::mouseClick(&Find<QLabel>(*window, row.Panel), Qt::RightButton);
    EXPECT_TRUE(menu.isVisible()) << row.Menu;
    menu.close();
  }
  QTest::mouseClick(&Find<QLabel>(*window, "StatusPanel2"), Qt::RightButton);
  EXPECT_EQ(QApplication::activePopupWidget(), nullptr);
}

TEST_P(BootloadWindow, TakesAPortFromItsMenu) {
  Open();
  Act("M_FPPort3");
  EXPECT_EQ(Panel(4), "COM3");
  EXPECT_TRUE(Action("M_FPPort3").isChecked());
  EXPECT_FALSE(Action("M_FPPort1").isChecked());
  Act("M_FPBaud4");
  EXPECT_EQ(Panel(5), "9600");
  Act("Run");
  Act("Connect");
  EXPECT_THAT(Library.Log, Contains("OpenPIC COM3 9600 1000"));
}

TEST_P(BootloadWindow, TogglesMemories) {
  Open();
  EXPECT_TRUE(Action("M_MemAccess1").isChecked());
  Act("M_MemAccess1");
  EXPECT_FALSE(Action("M_MemAccess1").isChecked());
  Act("M_MemAccess2");
  EXPECT_TRUE(Action("M_MemAccess2").isChecked());
  EXPECT_FALSE(Action("M_MemAccess3").isVisible());
  EXPECT_FALSE(Action("M_PSendCfg").isVisible());
}

TEST_P(BootloadWindow, EndsItsLoadQuietlyWhereTheIniFileIsWrong) {
  Put("bitrateindex", "9");
  Open();
  EXPECT_EQ(Status(), "");
  EXPECT_EQ(Panel(4), "COM 1");
  EXPECT_EQ(Panel(5), "");
  Put("bitrateindex", "0");
  Open();
  EXPECT_EQ(Status(), "");
  Put("selectdevwin", "1");
  Open();
  EXPECT_EQ(Panel(4), "");
  Put("CommTimeOut", "soon");
  Open();
  EXPECT_EQ(Panel(4), "");
  Disk.Remove("/program/P24qp.ini");
  Open();
  EXPECT_EQ(Status(), "");
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(BootloadWindow, OpensTheDeviceSelectorWhenThereIsOne) {
  Put("selectdevwin", "1");
  Open(true);
  EXPECT_THAT(selector.Log, ElementsAre("Open"));
  EXPECT_EQ(Status(), "Not connected...");
}

TEST_P(BootloadWindow, EndsItsLoadQuietlyWhereThePortIsNoNumber) {
  Disk.Put("/data/tessarine.ini", "[comm]\ncommport=x\n");
  Open();
  EXPECT_EQ(Panel(4), "");
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(BootloadWindow, ImportsAHexFile) {
  Open();
  Browse(HexFile::Data(0, HexFile::Instructions(16, 1)) + HexFile::End());
  EXPECT_THAT(Dialog.Calls,
              ElementsAre(FakeFileDialog::Call{false, "INHEX32 Files (*.HEX)|*.HEX|All Files (*.*)|*.*", "",
                                               "", "Open HEX File"}));
  EXPECT_EQ(Find<QLineEdit>(*window, "txtFileName").text(), QStringLiteral("/home/new.hex"));
  EXPECT_EQ(Status(), "HEX file imported...");
  EXPECT_TRUE(Disk.FileExists("/data/progmem.img"));
  EXPECT_FALSE(Find<QListWidget>(*window, "LostBytesList").isVisible());
  ExpectIdle();
}

TEST_P(BootloadWindow, ChangesNothingWhenTheDialogIsCancelled) {
  Open();
  Dialog.Answers = {std::nullopt};
  Press("cmdBrowse");
  EXPECT_EQ(Find<QLineEdit>(*window, "txtFileName").text(), QString());
  EXPECT_EQ(Status(), "Not connected...");
}

TEST_P(BootloadWindow, TellsAnInvalidHexFile) {
  Open();
  Browse("# none\n");
  EXPECT_EQ(Status(), "Invalid HEX file...");
  EXPECT_THAT(Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"-4", "Tessarine", BoxIcon::None, BoxButtons::Ok}));
}

TEST_P(BootloadWindow, ReportsAProgramThatDoesNotBeginAtAddressZero) {
  Open();
  Browse(HexFile::Data(0, {1}) + HexFile::End());
  Browse(HexFile::Data(0x100, {1}) + HexFile::End());
  EXPECT_EQ(Status(), "Invalid HEX file...");
  ASSERT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_THAT(Boxes.Boxes[0].Text, StartsWith("Run-time error '9': Subscript out of range"));
  EXPECT_EQ(Boxes.Boxes[0].Icon, BoxIcon::Critical);
  EXPECT_FALSE(Disk.FileExists("/data/progmem.img"));
  ExpectIdle();
}

TEST_P(BootloadWindow, ListsBytesThatTheDeviceWouldNotGet) {
  Open();
  Browse(HexFile::Data(0, HexFile::Instructions(16, 1)) + HexFile::Data(0x40, HexFile::Instructions(16, 1)) +
         HexFile::Upper(0x100) + HexFile::Data(0, {1, 2, 3}) + HexFile::End());
  EXPECT_EQ(Status(), "HEX file imported...");
  const auto& list = Find<QListWidget>(*window, "LostBytesList");
  EXPECT_TRUE(list.isVisible());
  ASSERT_EQ(list.count(), 2);
  EXPECT_THAT(LostBytes()[0], StartsWith("000000"));
  EXPECT_THAT(LostBytes()[0], testing::HasSubstr("16"));
  EXPECT_THAT(LostBytes()[0], testing::HasSubstr(strings.Text(OwnText::BytesMissing)));
  EXPECT_THAT(LostBytes()[1], StartsWith("01000000"));
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  ExpectEntriesAreNamed(*window);
  Browse(HexFile::Data(0, {1}) + HexFile::End());
  EXPECT_FALSE(list.isVisible());
}

TEST_P(BootloadWindow, ListsAThousandStretchesAndTheCountOfTheOthers) {
  Open();
  std::string hex = HexFile::Data(0, {1});
  // One of them is the configuration memory's, which is never lost.
  for (unsigned int i = 0; i < 1004; ++i) {
    hex += HexFile::Upper(0x101 + i) + HexFile::Data(0, {1});
  }
  Browse(hex + HexFile::End());
  ASSERT_EQ(LostBytes().size(), 1001U);
  EXPECT_THAT(LostBytes()[999], StartsWith("04E90000"));
  EXPECT_THAT(LostBytes()[1000], testing::HasSubstr(" 3"));
}

INSTANTIATE_TEST_SUITE_P(Languages, BootloadWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& tested) {
                           return tested.param == Language::English ? "English" : "Chinese";
                         });

}  // namespace
