#pragma once

#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>
#include <memory>
#include <optional>
#include <string>

#include "firmware/download/FirmwareFlash.h"
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
#include "tests/support/Controls.h"

/// Files on a disk that may not let tell whether one exists.
class UnsureFiles : public FakeFiles {
 public:
  std::optional<int> Doubt;

  bool FileExists(const std::string& path) const override {
    if (Doubt) {
      throw RuntimeError(*Doubt);
    }
    return FakeFiles::FileExists(path);
  }
};

/// The window between fake files and a fake device, in both languages.
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

  /// The same with port 2, on a disk that fails when it is asked for the file.
  FirmwareFlash& OpenInDoubt(int fault) {
    disk.Doubt = fault;
    FirmwareFlash& opened = Open("[comm]\ncommport=2\n[Paths]\nfirmware_path=/fw/gun.qvm2\n");
    disk.Doubt.reset();
    return opened;
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
    EXPECT_THAT(boxes.Boxes,
                testing::ElementsAre(FakeMessageBoxes::Box{text, "Tessarine", icon, BoxButtons::Ok}));
  }

  UnsureFiles disk;
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
