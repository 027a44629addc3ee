#include <gtest/gtest.h>

#include <QLabel>

#include "firmware/pic24f/frmBootload.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

class TypeBCommand : public testing::TestWithParam<Language> {
 protected:
  Venue venue{GetParam()};
};

TEST_P(TypeBCommand, ShowsTheWindowWithTheSettingsOfThePort) {
  venue.Start();
  venue.Port.Open("/dev/ttyS0", "19200,N,8,1");
  const WhileModal<frmBootload> look([this](frmBootload& window) {
    EXPECT_FALSE(venue.Port.PortOpen());
    EXPECT_EQ(Find<QLabel>(window, "StatusPanel1").text(), QStringLiteral("Not connected..."));
    EXPECT_EQ(Find<QLabel>(window, "StatusPanel4").text(), QStringLiteral("COM 1"));
    EXPECT_EQ(Find<QLabel>(window, "StatusPanel5").text(), QStringLiteral("115200"));
    ExpectCaredFor(window);
    window.close();
  });
  venue.Window->UpdateTypeB();
  EXPECT_EQ(look.Runs(), 1);
}

TEST_P(TypeBCommand, TalksThroughThePortOfTheSettings) {
  venue.Start();
  const WhileModal<frmBootload> look([this](frmBootload& window) {
    Find<QAction>(window, "Run").trigger();
    Find<QAction>(window, "Connect").trigger();
    EXPECT_EQ(venue.Port.Device, "/dev/ttyS0");
    EXPECT_EQ(venue.Port.Settings, "115200,N,8,1");
    EXPECT_EQ(std::vector<std::uint8_t>(venue.Port.Sent.begin(), venue.Port.Sent.begin() + 6),
              (std::vector<std::uint8_t>{0x55, 0x55, 0x00, 0x02, 0xFE, 0x04}));
    EXPECT_TRUE(venue.Port.PortOpen());
    window.close();
  });
  venue.Window->UpdateTypeB();
  EXPECT_EQ(look.Runs(), 1);
  EXPECT_FALSE(venue.Port.PortOpen());
}

TEST_P(TypeBCommand, IsGivenByNoMenuItem) {
  venue.Start();
  for (QAction* item : venue.Window->findChildren<QAction*>()) {
    EXPECT_FALSE(item->text().contains(QStringLiteral("Type B"))) << item->objectName().toStdString();
  }
}

INSTANTIATE_TEST_SUITE_P(Languages, TypeBCommand,
                         testing::Values(Language::English, Language::SimplifiedChinese));

}  // namespace
