#include "sound/SoundRecording.h"

#include "tests/sound/RecordingSite.h"
#include "tests/support/Thrown.h"

namespace {

using std::chrono::milliseconds;
using testing::Contains;
using testing::ElementsAre;
using testing::Not;

class Interrupted : public RecordingSite {};

/// A first answer that does not come.
class RecordingWithoutAnswer : public Interrupted, public testing::WithParamInterface<Recorder> {
 protected:
  RecordingWithoutAnswer() {
    Use(GetParam());
    Fill({{"/a.raw", Samples(600)}, {"/b.raw", Samples(300)}});
  }

  void Without(const std::string& step, int times = 0) {
    hardware.Acknowledges = [step, times](const std::string& what) mutable {
      return what != step || times-- > 0;
    };
  }
};

INSTANTIATE_TEST_SUITE_P(InBothModes, RecordingWithoutAnswer,
                         testing::Values(Recorder::InProduct, Recorder::StandAlone));

TEST_P(RecordingWithoutAnswer, ToStartEndsIdleWithTheLineOpen) {
  Without("start");
  Record();
  ExpectTimeOuts(1);
  EXPECT_THAT(display.Statuses, ElementsAre("Starting...", "Idle"));
  EXPECT_TRUE(port.PortOpen());
  EXPECT_GE(pump.Now(), milliseconds(6000));
  EXPECT_LT(pump.Now(), milliseconds(6100));
}

TEST_P(RecordingWithoutAnswer, ToEraseEndsIdleWithTheLineOpen) {
  Without("erase");
  hardware.Erases = false;
  Record();
  ExpectTimeOuts(1);
  EXPECT_THAT(display.Statuses, ElementsAre("Starting...", "Erasing Flash...", "Idle"));
  EXPECT_TRUE(port.PortOpen());
}

TEST_P(RecordingWithoutAnswer, AtTheEndOfTheEraseWaits30Seconds) {
  hardware.Erases = false;
  Record();
  ExpectTimeOuts(1);
  EXPECT_THAT(display.Statuses, ElementsAre("Starting...", "Erasing Flash...", "Idle"));
  EXPECT_TRUE(port.PortOpen());
  EXPECT_GE(pump.Now(), milliseconds(30000));
  EXPECT_LT(pump.Now(), milliseconds(30200));
}

TEST_P(RecordingWithoutAnswer, MayBeTriedAgainOnTheOpenLine) {
  Without("start");
  Record();
  hardware.Acknowledges = [](const std::string&) { return true; };
  const std::size_t before = port.Log.size();
  Record();
  EXPECT_THAT(std::vector(port.Log.begin() + static_cast<std::ptrdiff_t>(before), port.Log.end()),
              Not(Contains(testing::StartsWith("Open"))));
  EXPECT_EQ(display.Statuses.back(), "Recording Complete.");
  EXPECT_FALSE(port.PortOpen());
}

TEST_P(RecordingWithoutAnswer, ToTheLastPageFails) {
  const int dataBefore = GetParam() == Recorder::InProduct ? 2 : 1;  // the table, and the first page
  Without("data", dataBefore);
  Record();
  ExpectTimeOuts(1);
  EXPECT_THAT(std::vector(display.Statuses.end() - 2, display.Statuses.end()),
              ElementsAre("Idle", "Recording Failed."));
  EXPECT_THAT(hardware.Log, Not(Contains("end")));
  EXPECT_EQ(display.Statuses2.back(), "");
  EXPECT_FALSE(port.PortOpen());
}

TEST_P(RecordingWithoutAnswer, ToEndIsCompleteAllTheSame) {
  Without("end");
  Record();
  ExpectTimeOuts(1);
  EXPECT_EQ(display.Statuses.back(), "Recording Complete.");
  EXPECT_FALSE(port.PortOpen());
}

TEST_P(RecordingWithoutAnswer, ButWithAWrongOneTimesOut) {
  hardware.Answer = {0x55};
  Record();
  ExpectTimeOuts(1);
  EXPECT_THAT(display.Statuses, ElementsAre("Starting...", "Idle"));
}

TEST_P(RecordingWithoutAnswer, BecauseTheLineIsLostHasNoTimeOutButTheFault) {
  hardware.Acknowledges = [this](const std::string& what) {
    if (what == "data") {
      port.Lose();
    }
    return true;
  };
  EXPECT_EQ(NumberThrownBy([this] { Record(); }), 8012);
  ExpectTimeOuts(0);
  EXPECT_FALSE(port.PortOpen());
  EXPECT_EQ(display.Statuses.back(), "Recording Failed.");
  EXPECT_THAT(hardware.Log, Not(Contains("end")));
}

TEST_P(RecordingWithoutAnswer, BecauseTheWindowClosesSaysNothing) {
  pump.At(milliseconds(1000), [this] { stopped = true; });
  Record();
  ExpectTimeOuts(0);
  EXPECT_THAT(display.Statuses, ElementsAre("Starting...", "Erasing Flash...", "Idle"));
  EXPECT_THAT(hardware.Log, ElementsAre("start", "erase"));
}

TEST_P(RecordingWithoutAnswer, BecauseTheWindowClosesInAPageEndsWithoutAnEnd) {
  hardware.Acknowledges = [this](const std::string& what) {
    stopped = what == "data" && hardware.Data.size() == 2;
    return !stopped;
  };
  Record();
  ExpectTimeOuts(0);
  EXPECT_EQ(display.Statuses.back(), "Recording Failed.");
  EXPECT_THAT(hardware.Log, Not(Contains("end")));
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(Interrupted, GoesOnWithoutAnAnswerToTheTableAndFailsAtTheFirstSound) {
  Use(Recorder::InProduct);
  Fill({{"/a.raw", Samples(300)}});
  hardware.Acknowledges = [](const std::string& what) { return what != "data"; };
  Record();
  ExpectTimeOuts(2);
  EXPECT_THAT(display.Statuses, ElementsAre("Starting...", "Erasing Flash...", "Erase complete.",
                                            "Sending Page Indexes", "Idle", "Idle", "Recording Failed."));
  EXPECT_EQ(hardware.Data.size(), 1U);
}

TEST_F(Interrupted, WithoutFilesCompletesWithoutAnAnswerToTheTable) {
  Use(Recorder::InProduct);
  Fill({{"", ""}});
  hardware.Acknowledges = [](const std::string& what) { return what != "data"; };
  Record();
  ExpectTimeOuts(1);
  EXPECT_EQ(display.Statuses.back(), "Recording Complete.");
}

TEST_F(Interrupted, WaitsForTheHeaderOfTheFirstSoundOnly) {
  Fill({{"/a.raw", Samples(300)}, {"/b.raw", Samples(300)}});
  hardware.Acknowledges = [](const std::string& what) { return what != "header 1"; };
  Record();
  EXPECT_EQ(display.Statuses.back(), "Recording Complete.");
  hardware.Acknowledges = [](const std::string& what) { return what != "header 0"; };
  Record();
  ExpectTimeOuts(1);
  EXPECT_EQ(display.Statuses.back(), "Recording Failed.");
}

TEST_F(Interrupted, IsNotAnsweredByWhatCameTooLateForTheTryBefore) {
  Use(Recorder::InProduct);
  Fill({{"", ""}});
  hardware.Acknowledges = [](const std::string&) { return false; };
  Record();
  port.Receive({0xAA});
  Record();
  ExpectTimeOuts(2);
  EXPECT_THAT(hardware.Log, ElementsAre("start", "start"));
  port.Receive({0xAA});
  Test();
  ExpectTimeOuts(3);
  EXPECT_EQ(display.Statuses[display.Statuses.size() - 2], "Test of sound 1 failed.");
}

TEST_F(Interrupted, TakesTwoMergedAnswersOneByOne) {
  Fill({{"", ""}});
  hardware.Erases = false;
  hardware.Acknowledges = [this](const std::string& what) {
    if (what == "erase") {
      pump.At(milliseconds(2000), [this] { port.Receive({0xAA, 0xAA}); });
    }
    return what != "erase";
  };
  Record();
  ExpectTimeOuts(0);
  EXPECT_EQ(display.Statuses.back(), "Recording Complete.");
}

TEST_F(Interrupted, HearsAnAnswerBetweenOtherBytes) {
  Fill({{"/a.raw", Samples(300)}});
  hardware.Answer = {0x55, 0xAA, 0x55};
  Record();
  ExpectTimeOuts(0);
  EXPECT_EQ(display.Statuses.back(), "Recording Complete.");
}

TEST_F(Interrupted, CountsAnAnswerThatComesDuringTheLastBytesOfAPage) {
  Fill({{"/a.raw", Samples(300)}});
  hardware.Acknowledges = [](const std::string& what) { return what != "data"; };
  int sent = 0;
  const auto toHardware = port.OnOutput;
  port.OnOutput = [&](std::uint8_t byte) {
    toHardware(byte);
    if (++sent == 8 + 250) {
      port.Receive({0xAA});
    }
  };
  Record();
  ExpectTimeOuts(0);
  EXPECT_EQ(display.Statuses.back(), "Recording Complete.");
}

TEST_F(Interrupted, ForgetsAnAnswerThatComesEarlierInAPage) {
  Fill({{"/a.raw", Samples(300)}});
  hardware.Acknowledges = [](const std::string& what) { return what != "data"; };
  int sent = 0;
  const auto toHardware = port.OnOutput;
  port.OnOutput = [&](std::uint8_t byte) {
    toHardware(byte);
    if (++sent == 8 + 100) {
      port.Receive({0xAA});
    }
  };
  Record();
  ExpectTimeOuts(1);
  EXPECT_EQ(display.Statuses.back(), "Recording Failed.");
}

}  // namespace
