#include "devices/box/BoxFrame.h"

#include <gmock/gmock.h>

#include "platform/Fault.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;

BoxEntries WithPoints(const std::string& text) {
  BoxEntries entries;
  entries.PointsPerAct = text;
  return entries;
}

TEST(BoxFrame, HoldsEveryEntryInItsPlace) {
  const BoxEntries entries = {.BoxType = 4,
                              .TeamList = 2,
                              .PointsPerAct = "10",
                              .RechargePoints = "20",
                              .ActivationAmount = "30",
                              .AutoModeTime = "255",
                              .Destroyable = true};
  EXPECT_THAT(BoxFrame(entries), ElementsAre(0x42, 0x43, 0x24, 10, 20, 30, 0xFF, 1, 0, 0));
}

TEST(BoxFrame, OfZerosMeansABoxThatNeverRunsOutAndIsNotAutomatic) {
  EXPECT_THAT(BoxFrame({}), ElementsAre(0x42, 0x43, 0, 0, 0, 0, 0, 0, 0, 0));
}

TEST(BoxFrame, PutsTheTeamAboveTheType) {
  EXPECT_EQ(BoxFrame({.BoxType = 8, .TeamList = 3})[2], 0x38);
}

TEST(BoxFrame, RoundsToTheNearestEvenNumber) {
  EXPECT_EQ(BoxFrame(WithPoints("2.5"))[3], 2);
  EXPECT_EQ(BoxFrame(WithPoints("3.5"))[3], 4);
  EXPECT_EQ(BoxFrame(WithPoints(" 7 "))[3], 7);
}

TEST(BoxFrame, RefusesWhatIsNoNumber) {
  for (const char* text : {"", " ", "abc", "1 2x", "\u0661\u0662", "1,5"}) {
    EXPECT_EQ(NumberThrownBy([&] { BoxFrame(WithPoints(text)); }), Fault::TypeMismatch) << text;
  }
}

TEST(BoxFrame, RefusesWhatIsNoByte) {
  for (const char* text : {"256", "-1", "1e9", "255.5"}) {
    EXPECT_EQ(NumberThrownBy([&] { BoxFrame(WithPoints(text)); }), Fault::Overflow) << text;
  }
}

TEST(BoxFrame, RefusesAListWithoutAChoice) {
  EXPECT_EQ(NumberThrownBy([] { BoxFrame({.BoxType = -1}); }), Fault::Overflow);
  EXPECT_EQ(NumberThrownBy([] { BoxFrame({.BoxType = 9}); }), Fault::Overflow);
  EXPECT_EQ(NumberThrownBy([] { BoxFrame({.TeamList = -1}); }), Fault::Overflow);
  EXPECT_EQ(NumberThrownBy([] { BoxFrame({.TeamList = 4}); }), Fault::Overflow);
}

}  // namespace
