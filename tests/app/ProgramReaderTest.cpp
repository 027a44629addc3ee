#include <gtest/gtest.h>

#include <QMessageBox>
#include <filesystem>

#include "app/Composition.h"
#include "devices/buttons/ButtonSwipe.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/VenueProcess.h"
#include "tests/support/WhileModal.h"

namespace {

/// The program's own parts, on a data folder of the test, with the simulated adapter as its reader.
class ReaderOfTheProgram : public testing::Test {
 protected:
  ReaderOfTheProgram() {
    venue.ReadDevice("base unit");
    const std::string folder = data / "Orvalin/Tessarine";
    std::filesystem::create_directories(folder);
    WriteFile(folder + "/tessarine.ini",
              "[onewire]\nport=7\n[ports]\ncom7=" + venue.ReadDevice("1-wire adapter") + "\n");
    qputenv("XDG_DATA_HOME", QByteArray::fromStdString(data.Path()));
  }
  ~ReaderOfTheProgram() override { qunsetenv("XDG_DATA_HOME"); }

  TemporaryFolder data;
  sim::VenueProcess venue{{"--onewire", "--players", "0"}};
};

TEST_F(ReaderOfTheProgram, AsksForAButtonAndTellsItsCode) {
  Composition composition;
  const WhileModal<ButtonSwipe> touch([this](ButtonSwipe&) { venue.WriteInput("touch A300CDAB89674501\n"); });
  QString told;
  const WhileModal<QMessageBox> box([&told](QMessageBox& window) {
    told = window.text();
    window.accept();
  });
  EXPECT_EQ(composition.Services().ButtonSwipe(), "A300CDAB89674501");
  EXPECT_EQ(touch.Runs(), 1);
  EXPECT_EQ(told, QStringLiteral("Membership button read sucessfully, code = A300CDAB89674501"));
}

TEST_F(ReaderOfTheProgram, GivesNoButtonAfterCancel) {
  Composition composition;
  const WhileModal<ButtonSwipe> cancel([](ButtonSwipe& window) { window.close(); });
  EXPECT_EQ(composition.Services().ButtonSwipe(), NoDallasId);
}

}  // namespace
