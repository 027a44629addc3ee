#include "audience/AudienceScreens.h"

#include <gtest/gtest.h>

namespace {

using Kind = AudienceSpot::Kind;

const AudienceScreen Desk{"DP-1", true};
const AudienceScreen Hall{"HDMI-1", false};
const AudienceScreen Bar{"HDMI-2", false};

TEST(AudienceSpot, IsAWindowWhereTheOperatorHasTheOnlyScreen) {
  EXPECT_EQ(SpotOn({Desk}, "", "").Where, Kind::Window);
  EXPECT_EQ(SpotOn({Desk}, "HDMI-1", "").Where, Kind::Window);
}

TEST(AudienceSpot, IsTheFirstScreenOfAnotherPicture) {
  EXPECT_EQ(SpotOn({Desk, Hall, Bar}, "", ""), (AudienceSpot{Kind::Screen, "HDMI-1"}));
  EXPECT_EQ(SpotOn({Desk, {"HDMI-1", true}, Bar}, "", ""), (AudienceSpot{Kind::Screen, "HDMI-2"}));
  EXPECT_EQ(SpotOn({Desk, {"HDMI-1", true}}, "", "").Where, Kind::Window);
}

TEST(AudienceSpot, IsTheScreenThatWasSet) {
  EXPECT_EQ(SpotOn({Desk, Hall, Bar}, "HDMI-2", ""), (AudienceSpot{Kind::Screen, "HDMI-2"}));
  EXPECT_EQ(SpotOn({Desk, Hall}, "HDMI-2", ""), (AudienceSpot{Kind::Screen, "HDMI-1"}));
}

TEST(AudienceSpot, NeverCoversTheOperatorsScreen) {
  EXPECT_EQ(SpotOn({Desk, Hall}, "DP-1", "").Where, Kind::Window);
  EXPECT_EQ(SpotOn({Desk, {"HDMI-1", true}}, "HDMI-1", "HDMI-1"), (AudienceSpot{Kind::Nowhere, "HDMI-1"}));
}

TEST(AudienceSpot, GoesWithItsScreenAndReturnsWithIt) {
  EXPECT_EQ(SpotOn({Desk}, "", "HDMI-1"), (AudienceSpot{Kind::Nowhere, "HDMI-1"}));
  EXPECT_EQ(SpotOn({Desk, Bar}, "", "HDMI-1"), (AudienceSpot{Kind::Nowhere, "HDMI-1"}));
  EXPECT_EQ(SpotOn({Desk, Bar, Hall}, "HDMI-2", "HDMI-1"), (AudienceSpot{Kind::Screen, "HDMI-1"}));
}

}  // namespace
