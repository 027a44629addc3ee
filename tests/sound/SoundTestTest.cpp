#include "sound/SoundRecording.h"

#include "tests/sound/RecordingSite.h"
#include "tests/support/Thrown.h"

namespace {

using std::chrono::milliseconds;
using testing::ElementsAre;
using testing::IsEmpty;

class Testing : public RecordingSite {};

TEST_F(Testing, PlaysEveryRowWithOrWithoutAFile) {
  Fill({{"/a.raw", Samples(300)}, {"", ""}});
  Test();
  EXPECT_THAT(port.Sent, ElementsAre(3, 2, 0, 3, 2, 1));
  EXPECT_THAT(display.Statuses, ElementsAre("Testing sound: 1", "Testing sound: 2", "Testing complete."));
  EXPECT_EQ(port.Log.back(), "Close");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_THAT(pump.Sleeps,
              ElementsAre(milliseconds(10), milliseconds(10), milliseconds(10), milliseconds(10)));
  EXPECT_GE(pump.Now(), milliseconds(2000));  // a second behind each sound
}

TEST_F(Testing, PlaysInAProductByItsCommand) {
  Use(Recorder::InProduct);
  Fill({{"", ""}, {"", ""}});
  Test();
  EXPECT_THAT(port.Sent, ElementsAre(14, 0, 0, 14, 0, 1));
}

TEST_F(Testing, WaitsAMinuteForASound) {
  Fill({{"", ""}, {"", ""}, {"", ""}});
  hardware.Acknowledges = [](const std::string& what) { return what != "play 1"; };
  Test();
  ExpectTimeOuts(1);
  EXPECT_THAT(display.Statuses, ElementsAre("Testing sound: 1", "Testing sound: 2", "Test of sound 2 failed.",
                                            "Testing complete."));
  EXPECT_GE(pump.Now(), milliseconds(61000));
  EXPECT_LT(pump.Now(), milliseconds(61200));
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(Testing, HearsASoundThatTakesLong) {
  Fill({{"", ""}});
  hardware.AnswerTime = milliseconds(59900);
  Test();
  ExpectTimeOuts(0);
}

TEST_F(Testing, EndsSilentlyWhenTheWindowCloses) {
  Fill({{"", ""}, {"", ""}});
  hardware.AnswerTime = milliseconds(5000);
  pump.At(milliseconds(1000), [this] { stopped = true; });
  Test();
  ExpectTimeOuts(0);
  EXPECT_THAT(hardware.Log, ElementsAre("play 0"));
  EXPECT_EQ(display.Statuses.back(), "Testing complete.");
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(Testing, TellsALostLineOnce) {
  Fill({{"", ""}, {"", ""}});
  pump.At(milliseconds(500), [this] { port.Lose(); });
  pump.At(milliseconds(600), [] {});
  EXPECT_EQ(NumberThrownBy([this] { Test(); }), 8012);
  ExpectTimeOuts(0);
  EXPECT_FALSE(port.PortOpen());
}

}  // namespace
