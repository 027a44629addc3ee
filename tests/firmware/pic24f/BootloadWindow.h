#pragma once

#include <gmock/gmock.h>

#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QToolBar>

#include "firmware/pic24f/frmBootload.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakePrograms.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/firmware/pic24f/BootSite.h"
#include "tests/firmware/pic24f/SharedPicBoot.h"
#include "tests/support/Controls.h"

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
