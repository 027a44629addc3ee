#include <gmock/gmock.h>

#include <QApplication>
#include <QMessageBox>
#include <QTimer>
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

TEST_F(ReaderOfTheProgram, KeepsATranscriptThatCountsPollsWithoutChange) {
  {
    Composition composition;
    int polls = 0;
    QTimer timer;
    QObject::connect(&timer, &QTimer::timeout, [&polls] {
      if (++polls == 12) {
        QApplication::activeModalWidget()->close();
      }
    });
    timer.start(100);
    composition.Services().ButtonSwipe();
  }
  const std::string log = ReadFile(data / "Orvalin/Tessarine/logs/1-wire.log");
  EXPECT_THAT(log, testing::HasSubstr(" 1-wire <- C1\n"));
  EXPECT_THAT(log, testing::HasSubstr(" 1-wire -> CD"));
  EXPECT_THAT(log, testing::HasSubstr(" 1-wire -- closed\n"));
  // In turn the walk finds the reader's own device and the end of the bus.
  EXPECT_THAT(log, testing::HasSubstr(" 1-wire -- the last ones again, "));
}

TEST_F(ReaderOfTheProgram, GivesNoButtonAfterCancel) {
  Composition composition;
  const WhileModal<ButtonSwipe> cancel([](ButtonSwipe& window) { window.close(); });
  EXPECT_EQ(composition.Services().ButtonSwipe(), NoDallasId);
}

}  // namespace
