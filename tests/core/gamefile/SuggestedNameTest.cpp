#include "core/gamefile/SuggestedName.h"

#include <gtest/gtest.h>

#include "core/text/TextEncoding.h"

namespace {

constexpr const char* Received = "2026-11-21 20:15:09";

TEST(SuggestedName, HasDateTimeAndMission) {
  EXPECT_EQ(SuggestedGameName(Received, "The Night Courier"), "2026-11-21 2015 The Night Courier.game.xml");
  EXPECT_EQ(SuggestedGameName(Received, "夜间信使"), "2026-11-21 2015 夜间信使.game.xml");
}

TEST(SuggestedName, HasADashForWhatAFileNameCannotHold) {
  EXPECT_EQ(SuggestedGameName(Received, "a\\b/c:d*e?f\"g<h>i|j\tk\r\nl\x7Fm"),
            "2026-11-21 2015 a-b-c-d-e-f-g-h-i-j-k--l-m.game.xml");
}

TEST(SuggestedName, HasAnotherEndingForOtherFiles) {
  EXPECT_EQ(SuggestedFileName(Received, "Keep", ".csv"), "2026-11-21 2015 Keep.csv");
  EXPECT_EQ(SuggestedFileName(Received, "Keep", ""), "2026-11-21 2015 Keep");
}

TEST(SuggestedName, HasNoBlanksBeforeItsSuffix) {
  EXPECT_EQ(SuggestedGameName(Received, ""), "2026-11-21 2015.game.xml");
  EXPECT_EQ(SuggestedGameName(Received, "Keep  "), "2026-11-21 2015 Keep.game.xml");
}

TEST(SuggestedName, HasAtMostTwoHundredBytesAndWholeCharacters) {
  EXPECT_EQ(SuggestedGameName(Received, std::string(500, 'x')).size(), 200U);
  std::string mission = "x";
  for (int i = 0; i < 100; ++i) {
    mission += "夜";
  }
  for (const std::string& begin : {std::string(), std::string("y"), std::string("yy")}) {
    const std::string name = SuggestedGameName(Received, begin + mission);
    EXPECT_LE(name.size(), 200U);
    EXPECT_GE(name.size(), 198U);
    EXPECT_TRUE(IsUtf8(name));
    EXPECT_TRUE(name.ends_with(".game.xml"));
  }
}

}  // namespace
