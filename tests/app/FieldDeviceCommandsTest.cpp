#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <chrono>

#include "devices/box/BoxConfig.h"
#include "devices/charging/ChargeiButton.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"
#include "ui/ResultList.h"

namespace {

using namespace std::chrono_literals;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

/// The windows of utility boxes and of charging as the program opens them.
class FieldDeviceCommands : public testing::Test {
 protected:
  FieldDeviceCommands() { venue.Start(); }

  /// Opens a window by its menu item, does `act` and expects the window destroyed afterwards.
  template <typename Window>
  void In(const char* menuItem, const std::function<void(Window&)>& act) {
    QPointer<Window> opened;
    const WhileModal<Window> open([&](Window& window) {
      opened = &window;
      EXPECT_TRUE(window.isModal());
      act(window);
      window.close();
    });
    venue.Trigger(menuItem);
    EXPECT_EQ(open.Runs(), 1);
    EXPECT_TRUE(opened.isNull());
  }

  static int Rows(const QWidget& window) { return Find<ResultList>(window, "Results").rowCount(); }

  Venue venue;
};

TEST_F(FieldDeviceCommands, ProgramABoxOnThePortOfTheSettings) {
  venue.Devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB0"};
  WriteFile(venue.Folder / "Orvalin/Tessarine/tessarine.ini", "[comm]\ncommport= 2\n");
  venue.Port.OnOutput = [this](std::uint8_t) {
    if (venue.Port.Sent.size() == 10) {
      venue.Port.Receive({0xAA});
    }
  };
  In<BoxConfig>("mnuBoxConfig", [](BoxConfig& window) { ::Press(window, "ProgramButton"); });
  EXPECT_EQ(venue.Port.Device, "/dev/ttyUSB0");
  EXPECT_THAT(venue.Port.Sent, SizeIs(10));
  ASSERT_THAT(venue.Boxes.Boxes, SizeIs(1));
  EXPECT_EQ(venue.Boxes.Boxes[0].Text, "Programming Successful");
}

TEST_F(FieldDeviceCommands, CloseThePortOfTheMainWindowBeforeTheWindowOfBoxes) {
  venue.Port.Open("/dev/ttyS0", "19200,N,8,1");
  In<BoxConfig>("mnuBoxConfig", [this](BoxConfig&) { EXPECT_FALSE(venue.Port.PortOpen()); });
}

TEST_F(FieldDeviceCommands, EndAScoreDownloadWithoutABoxForTheWindowOfBoxes) {
  venue.Events.At(1s, [this] { In<BoxConfig>("mnuBoxConfig", [](BoxConfig&) {}); });
  venue.Press("GetScores");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_FALSE(venue.Port.PortOpen());
  EXPECT_THAT(venue.Find<QLabel>("Status").text().toStdString(), HasSubstr("Download stopped"));
}

TEST_F(FieldDeviceCommands, KeepTheBoxesOfTheRunButNotTheEntries) {
  In<BoxConfig>("mnuBoxConfig", [](BoxConfig& window) {
    Find<QLineEdit>(window, "PointsPerAct").setText(QStringLiteral("5"));
    ::Press(window, "ProgramButton");
    EXPECT_EQ(Rows(window), 1);
  });
  In<BoxConfig>("mnuBoxConfig", [](BoxConfig& window) {
    EXPECT_EQ(Rows(window), 1);
    EXPECT_EQ(Find<QLineEdit>(window, "PointsPerAct").text(), QStringLiteral("0"));
  });
}

TEST_F(FieldDeviceCommands, KeepTheButtonsOfTheRun) {
  venue.Wire.Devices = {{0x0C, 1, 0, 0, 0, 0, 0, 0xA1}};
  const auto waitForARow = [](ChargeiButton& window) {
    EXPECT_TRUE(QTest::qWaitFor([&] { return Rows(window) == 1; }));
  };
  In<ChargeiButton>("mnuChargeiButton", waitForARow);
  venue.Wire.Devices.clear();
  In<ChargeiButton>("mnuChargeiButton", [](ChargeiButton& window) { EXPECT_EQ(Rows(window), 1); });
}

TEST_F(FieldDeviceCommands, OfferToChargeOnlyWhereThereIsAReader) {
  EXPECT_TRUE(venue.Find<QAction>("mnuChargeiButton").isEnabled());
  EXPECT_TRUE(venue.Find<QAction>("mnuBoxConfig").isEnabled());
  venue.HasReader = false;
  venue.MakeWindow().FormLoad();
  EXPECT_FALSE(venue.Find<QAction>("mnuChargeiButton").isEnabled());
}

}  // namespace
