#include "firmware/pic24f/frmBootload.h"

#include <gmock/gmock.h>

#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QToolBar>

#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakePrograms.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/firmware/hex/HexFile.h"
#include "tests/firmware/pic24f/BootSite.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"

namespace {

using std::chrono::milliseconds;
using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

constexpr const char* NoSelector = "Core error:  Object variable or With block variable not set";

/// Passes everything on: the window owns its library, and the test keeps looking at the fake.
class SharedPicBoot : public PicBoot {
 public:
  explicit SharedPicBoot(PicBoot& library) : library_(library) {}
  std::int32_t OpenPIC(const std::string& port, std::int32_t bitRate, std::int32_t timeOut) override {
    return library_.OpenPIC(port, bitRate, timeOut);
  }
  void ClosePIC(std::int32_t handle) override { library_.ClosePIC(handle); }
  void SendPacket(std::int32_t handle, std::span<const std::uint8_t> packet) override {
    library_.SendPacket(handle, packet);
  }
  std::int32_t GetPacket(std::int32_t handle, std::span<std::uint8_t> buffer) override {
    return library_.GetPacket(handle, buffer);
  }
  std::int32_t SendGetPacket(std::int32_t handle, std::span<std::uint8_t> buffer, std::size_t length,
                             std::size_t longest, std::int32_t retries) override {
    return library_.SendGetPacket(handle, buffer, length, longest, retries);
  }
  std::int32_t ReadPIC(std::int32_t handle, const PicRecord& record,
                       std::span<std::uint8_t> buffer) override {
    return library_.ReadPIC(handle, record, buffer);
  }
  std::int32_t WritePIC(std::int32_t handle, const PicRecord& record,
                        std::span<const std::uint8_t> bytes) override {
    return library_.WritePIC(handle, record, bytes);
  }
  std::int32_t VerifyPIC(std::int32_t handle, const PicRecord& record,
                         std::span<const std::uint8_t> bytes) override {
    return library_.VerifyPIC(handle, record, bytes);
  }
  std::int32_t ErasePIC(std::int32_t handle, std::uint32_t address, std::int32_t blocks,
                        std::int32_t retries) override {
    return library_.ErasePIC(handle, address, blocks, retries);
  }

 private:
  PicBoot& library_;
};

class FakeSelector : public DeviceSelector {
 public:
  std::vector<std::string> Log;
  void Open() override { Log.emplace_back("Open"); }
  void ClearConfigBytes() override { Log.emplace_back("Clear"); }
  void AddConfigByte(const std::string& name, std::uint32_t address) override {
    Log.push_back(name + " " + std::to_string(address));
  }
};

class BootloadWindow : public testing::TestWithParam<Language>, protected BootSite {
 protected:
  void Open(bool withSelector = false) {
    window = std::make_unique<frmBootload>(
        frmBootload::Parts{.MakeLibrary =
                               [this](std::function<bool()> stopped) {
                                 Stopped = std::move(stopped);
                                 return std::make_unique<SharedPicBoot>(Library);
                               },
                           .Disk = Disk,
                           .Events = Events,
                           .CommonDialog1 = Dialog,
                           .Boxes = Boxes,
                           .OtherPrograms = Started,
                           .Ini = settings,
                           .Devices = devices,
                           .Strings = strings,
                           .Folder = {Data, Program},
                           .Selector = withSelector ? &selector : nullptr},
        nullptr);
    window->show();
  }

  /// Opens the window and connects it to the device of this identity, with memories to write.
  void Connect(std::uint16_t identity = 1095) {
    Library.Identity = identity;
    Open(true);
    Act("Run");
    Act("Connect");
    ASSERT_EQ(Status(), "Device found...");
    Library.Log.clear();
    Disk.Put("/data/progmem.img", Image(0, 32, 0xA5));
    Disk.Put("/data/eedata.img", Image(0xFE0000, 2, 0x33));
  }

  QAction& Action(const char* name) const { return Find<QAction>(*window, name); }
  void Act(const char* name) { Action(name).trigger(); }
  void Check(const char* memory, bool checked) { Action(memory).setChecked(checked); }
  void Press(const char* button) { ::Press(*window, button); }
  std::string Panel(int number) const {
    return Find<QLabel>(*window, "StatusPanel" + std::to_string(number)).text().toStdString();
  }
  std::string Status() const { return Panel(1); }

  void Put(const std::string& key, const std::string& value) {
    std::string ini = Disk.Read("/program/P24qp.ini");
    const std::size_t at = ini.find("\r\n" + key + "=") + 2;
    ini.replace(at, ini.find("\r\n", at) - at, key + "=" + value);
    Disk.Put("/program/P24qp.ini", ini);
  }

  /// Imports a HEX file through the dialog.
  void Browse(const std::string& hex) {
    Disk.Put("/home/new.hex", hex);
    Dialog.Answers = {"/home/new.hex"};
    Press("cmdBrowse");
  }

  std::vector<std::string> LostBytes() const {
    std::vector<std::string> rows;
    const auto& list = Find<QListWidget>(*window, "LostBytesList");
    for (int row = 0; row < list.count(); ++row) {
      rows.push_back(list.item(row)->text().toStdString());
    }
    return rows;
  }

  void ExpectIdle() const {
    EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
    EXPECT_TRUE(Action("M_FPPort1").isEnabled());
  }

  const StringTable strings{GetParam()};
  FakeFileDialog Dialog;
  FakeMessageBoxes Boxes;
  FakePrograms Started;
  FakeSerialDevices devices;
  FakeSelector selector;
  const IniReader settings{Disk, "/data/tessarine.ini"};
  std::function<bool()> Stopped;
  std::unique_ptr<frmBootload> window;
};

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

TEST_P(BootloadWindow, DoesNothingWithDownloadOpenAndAbort) {
  Open();
  Press("cmdDownload");
  Act("Open");
  Act("Abort");
  EXPECT_THAT(Library.Log, IsEmpty());
  EXPECT_THAT(Dialog.Calls, IsEmpty());
  EXPECT_EQ(Status(), "Not connected...");
}

TEST_P(BootloadWindow, DisconnectsWhileRunIsUp) {
  Open();
  Act("Connect");
  EXPECT_THAT(Library.Log, IsEmpty());
  EXPECT_FALSE(Action("Connect").isChecked());
  EXPECT_EQ(Status(), "Not connected...");
  EXPECT_EQ(Panel(2), " ");
}

TEST_P(BootloadWindow, EndsAConnectionAtTheMissingDeviceSelector) {
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

TEST_P(BootloadWindow, CompletesAConnectionWithADeviceSelector) {
  Connect();
  EXPECT_EQ(Panel(2), "PIC-A");
  EXPECT_EQ(Panel(3), "v1.5");
  EXPECT_THAT(selector.Log, ElementsAre("Clear", "Config Word 2 44028", "Config Word 1 44030"));
  EXPECT_TRUE(Action("Write").isEnabled());
  EXPECT_TRUE(Action("Erase").isEnabled());
  EXPECT_TRUE(Action("Abort").isEnabled());
  EXPECT_FALSE(Action("M_MemAccess2").isVisible());
}

TEST_P(BootloadWindow, ShowsTheMemoriesOfADeviceWithEeprom) {
  Connect(1103);
  EXPECT_TRUE(Action("M_MemAccess2").isVisible());
  EXPECT_TRUE(Action("M_MemAccess2").isChecked());
  EXPECT_TRUE(Action("M_MemAccess3").isChecked());
  EXPECT_FALSE(Action("M_MemAccess4").isVisible());
  EXPECT_TRUE(Action("M_PSendCfg").isVisible());
}

TEST_P(BootloadWindow, TellsAPortThatDoesNotOpen) {
  Open(true);
  Library.Handle = -1;
  Act("Run");
  Act("Connect");
  EXPECT_EQ(Status(), "Failed to open port...");
  EXPECT_FALSE(Action("Run").isChecked());
  EXPECT_EQ(Panel(3), "");
}

TEST_P(BootloadWindow, ConnectsToADeviceThatDoesNotAnswer) {
  Open(true);
  Library.Answers.clear();
  Library.Results["ReadPIC"] = {-2};
  Act("Run");
  Act("Connect");
  EXPECT_EQ(Panel(2), "");
  EXPECT_EQ(Panel(3), "");
  EXPECT_EQ(Status(), "Device found...");
}

TEST_P(BootloadWindow, DoesNotAskForTheIdentityInAnotherMode) {
  Put("devicemode", "1");
  Open(true);
  Act("Run");
  Act("Connect");
  EXPECT_THAT(Library.Log, Not(Contains(StartsWith("ReadPIC"))));
}

TEST_P(BootloadWindow, TellsAnIdentityThatOverflows) {
  Library.Identity = 0x8000;
  Open(true);
  Act("Run");
  Act("Connect");
  EXPECT_EQ(Status(), "Core error:  Overflow");
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(BootloadWindow, WritesTheMemoriesThatAreChosenAndConfirms) {
  Connect(1103);
  Act("Write");
  EXPECT_EQ(Status(), "Finished operation...");
  EXPECT_EQ(Library.Flash.size(), 512U);
  EXPECT_EQ(Library.Eeprom.size(), 32U);
  EXPECT_EQ(Library.Log.back(), "SendGetPacket 3: 8 up to 255, 5 retries");
  ExpectIdle();
}

TEST_P(BootloadWindow, OnlyConfirmsWhenNoMemoryIsChosen) {
  Connect();
  Check("M_MemAccess1", false);
  Act("Write");
  EXPECT_THAT(Library.Log, ElementsAre("SendGetPacket 3: 8 up to 255, 5 retries"));
  Library.Answers.erase(8);
  Act("Write");
  EXPECT_EQ(Status(), "Verify Ok command failed...");
}

TEST_P(BootloadWindow, WritesTheEepromAfterAFailureButDoesNotConfirm) {
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

TEST_P(BootloadWindow, ShowsTheLogOfDifferences) {
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

TEST_P(BootloadWindow, TellsALogThatCannotBeShown) {
  Connect();
  Started.Failure = RuntimeError(53);
  Library.OnCall = [this](const std::string&) { Library.Flash[0x40] = 0x12; };
  Act("Write");
  EXPECT_THAT(Status(), testing::HasSubstr("/data/verify.log"));
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(BootloadWindow, StopsAWrite) {
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

TEST_P(BootloadWindow, IgnoresOtherCommandsDuringAWrite) {
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

TEST_P(BootloadWindow, ReportsARuntimeFailureOfAWrite) {
  Connect();
  Disk.Remove("/data/progmem.img");
  Act("Write");
  ASSERT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_THAT(Boxes.Boxes[0].Text, StartsWith("Run-time error '53'"));
  ExpectIdle();
}

TEST_P(BootloadWindow, ConnectsAnewAfterALostLine) {
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

TEST_P(BootloadWindow, ErasesProgramMemory) {
  Connect(1103);
  Act("Erase");
  EXPECT_THAT(Library.Log, ElementsAre("ErasePIC 3, 10 blocks from 1024, 5 retries"));
  EXPECT_EQ(Status(), "Finished operation...");
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  ExpectIdle();
}

TEST_P(BootloadWindow, AsksBeforeItErasesTheConfigurationWord) {
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

TEST_P(BootloadWindow, ErasesNothingWhenFlashIsNotChosen) {
  Connect();
  Check("M_MemAccess1", false);
  Act("Erase");
  EXPECT_THAT(Library.Log, IsEmpty());
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_EQ(Status(), "Device found...");
  EXPECT_TRUE(Action("Write").isEnabled());
  ExpectIdle();
}

TEST_P(BootloadWindow, TellsAnEraseThatFailsOrIsStopped) {
  Connect(1103);
  Library.Results["ErasePIC"] = {-2};
  Act("Erase");
  EXPECT_EQ(Status(), "Failed to write device...");
  Library.OnCall = [this](const std::string&) { Press("cmdBreak"); };
  Act("Erase");
  EXPECT_EQ(Status(), "Finished operation...");  // one call erased it all
}

TEST_P(BootloadWindow, RunsTheDevice) {
  Connect();
  Act("Run");
  EXPECT_THAT(Library.Log, ElementsAre("SendPacket 3: 0 0", "ClosePIC 3"));
  EXPECT_EQ(Status(), "Run mode is set...");
  EXPECT_EQ(Panel(2), " ");
  EXPECT_FALSE(Action("Connect").isChecked());
}

TEST_P(BootloadWindow, ClosesThePortWithTheWindow) {
  Connect();
  Press("Close");
  EXPECT_FALSE(window->isVisible());
  window.reset();
  EXPECT_THAT(Library.Log, ElementsAre("ClosePIC 3"));
}

TEST_P(BootloadWindow, ClosesAfterAnOperationHasUnwound) {
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

TEST_P(BootloadWindow, EscapeClosesItButNotDuringAnOperation) {
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

INSTANTIATE_TEST_SUITE_P(Languages, BootloadWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& tested) {
                           return tested.param == Language::English ? "English" : "Chinese";
                         });

}  // namespace
