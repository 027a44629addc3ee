#include <gmock/gmock.h>

#include <QTableView>

#include "sound/ISD_rec.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::Contains;
using testing::IsEmpty;

/// The window as the program opens it.
class SoundCommand : public testing::Test {
 protected:
  SoundCommand() { venue.Start(); }

  Venue venue;
};

TEST_F(SoundCommand, OpensTheWindowWithTheProgramsOwnSoundList) {
  const WhileModal<ISD_rec> window([](ISD_rec& recorder) {
    EXPECT_TRUE(recorder.isModal());
    EXPECT_GE(::Find<QTableView>(recorder, "SoundList").model()->rowCount(), 20);
    ::Press(recorder, "Close");
  });
  venue.Trigger("mnuSoundRecorder");
  EXPECT_EQ(window.Runs(), 1);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(SoundCommand, HasALineOfItsOwnOnThePortOfTheSettings) {
  const WhileModal<ISD_rec> window([](ISD_rec& recorder) {
    ::Press(recorder, "Test");
    recorder.close();
  });
  venue.Trigger("mnuSoundRecorder");
  EXPECT_THAT(venue.SoundPort.Log, Contains("Open /dev/ttyS0 115200,N,8,1"));
  EXPECT_FALSE(venue.SoundPort.PortOpen());
  EXPECT_THAT(venue.Port.Log, IsEmpty());
}

TEST_F(SoundCommand, LeavesTheBaseUnitsLineAtItsSpeed) {
  const WhileModal<ISD_rec> window([](ISD_rec& recorder) { recorder.close(); });
  venue.Trigger("mnuSoundRecorder");
  venue.Port.OnOutput = [this](std::uint8_t byte) {
    if (byte == 0) {
      venue.Port.Receive({0});
    }
  };
  venue.Press("GetScores");
  EXPECT_THAT(venue.Port.Log, Contains("Open /dev/ttyS0 19200,N,8,1"));
}

}  // namespace
