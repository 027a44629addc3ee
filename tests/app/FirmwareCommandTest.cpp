#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>
#include <chrono>

#include "firmware/download/FirmwareFlash.h"
#include "tests/firmware/download/BootCode.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

/// The window as the program opens it.
class FirmwareCommand : public testing::Test {
 protected:
  FirmwareCommand() { venue.Start(); }

  Venue venue;
};

TEST_F(FirmwareCommand, OpensTheWindow) {
  const WhileModal<FirmwareFlash> window([](FirmwareFlash& firmware) {
    EXPECT_TRUE(firmware.isModal());
    ::Press(firmware, "Close");
  });
  venue.Trigger("mnuFirmwareUpdate");
  EXPECT_EQ(window.Runs(), 1);
}

TEST_F(FirmwareCommand, ClosesThePortOfTheMainWindowFirst) {
  venue.Port.Open("/dev/ttyS0", "19200,N,8,1");
  const WhileModal<FirmwareFlash> window([this](FirmwareFlash& firmware) {
    EXPECT_FALSE(venue.Port.PortOpen());
    firmware.close();
  });
  venue.Trigger("mnuFirmwareUpdate");
  EXPECT_EQ(window.Runs(), 1);
}

TEST_F(FirmwareCommand, EndsAScoreDownloadWithoutABox) {
  const WhileModal<FirmwareFlash> window([](FirmwareFlash& firmware) { firmware.close(); });
  venue.Events.At(1s, [this] { venue.Trigger("mnuFirmwareUpdate"); });
  venue.Press("GetScores");
  EXPECT_EQ(window.Runs(), 1);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_FALSE(venue.Port.PortOpen());
  EXPECT_THAT(venue.Find<QLabel>("Status").text().toStdString(), HasSubstr("Download stopped"));
}

TEST_F(FirmwareCommand, RunsADownloadAndLeavesItsRecordAndPath) {
  WriteFile(venue.Folder / "gun.qvm2", "\r\n\r\n0102\r\n");
  BootCode boot(venue.Port, venue.Events);
  boot.SwitchOnAt(1s);
  venue.Dialog.Answers = {venue.Folder / "gun.qvm2"};
  const WhileModal<FirmwareFlash> window([](FirmwareFlash& firmware) {
    ::Press(firmware, "cmdBrowse");
    ::Press(firmware, "cmdDownload");
    EXPECT_EQ(::Find<QLabel>(firmware, "lblDownload").text(), QStringLiteral("Download Complete!"));
    firmware.close();
  });
  venue.Trigger("mnuFirmwareUpdate");
  EXPECT_EQ(boot.Letters(), "XPBEZZZZZZZZF");
  EXPECT_THAT(venue.Awake.Reasons, ElementsAre("Firmware download"));
  EXPECT_THAT(venue.Disk.FileNames(venue.DataFolder() + "/logs"),
              testing::Contains("firmware-2013-05-21-143005.log"));
  const IniReader ini(venue.Disk, venue.DataFile("tessarine.ini"));
  EXPECT_EQ(ini.ReadIni("Paths", "firmware_path", ""), venue.Folder / "gun.qvm2");
}

TEST_F(FirmwareCommand, ShowsThePathOfTheLastTimeAgain) {
  for (const char* expected : {"Select a File", "/fw/any.qvm"}) {
    const WhileModal<FirmwareFlash> window([expected](FirmwareFlash& firmware) {
      auto& name = ::Find<QLineEdit>(firmware, "txtFileName");
      EXPECT_EQ(name.text().toStdString(), expected);
      name.setText(QStringLiteral("/fw/any.qvm"));
      firmware.close();
    });
    venue.Trigger("mnuFirmwareUpdate");
    EXPECT_EQ(window.Runs(), 1);
  }
}

}  // namespace
