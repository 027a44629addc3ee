#include "web/EveningTime.h"

#include <gtest/gtest.h>

namespace {

using namespace std::chrono_literals;

TEST(TimesOfAnEvening, AreReadAndWrittenAlike) {
  for (const char* text : {"2026-11-23 20:15:07", "2024-02-29 00:00:00", "1999-12-31 23:59:59"}) {
    const auto time = TimeIn(text);
    ASSERT_TRUE(time) << text;
    EXPECT_EQ(TextOf(*time), text);
  }
}

TEST(TimesOfAnEvening, GoOnBehindMidnight) {
  EXPECT_EQ(TextOf(*TimeIn("2026-12-31 18:30:00") + 6h), "2027-01-01 00:30:00");
  EXPECT_EQ(TextOf(*TimeIn("2024-03-01 01:00:00") - 2h), "2024-02-29 23:00:00");
}

TEST(TimesOfAnEvening, AreNoOtherTexts) {
  for (const char* text : {"", "2026-11-23", "2026-11-23 20:15", "23/11/2026 20:15:07", "2026-13-01 20:15:07",
                           "2026-02-29 20:15:07", "2026-11-23 20:1x:07", "2026-11-23 20:15:07 "}) {
    EXPECT_FALSE(TimeIn(text)) << text;
  }
}

TEST(TimesOfAnEvening, AreShownWithoutTheirDate) {
  EXPECT_EQ(HoursAndMinutes("2026-11-23 20:15:07"), "20:15");
  EXPECT_EQ(HoursAndMinutes("2026-11-23 20:15"), "20:15");
  EXPECT_EQ(HoursAndMinutes("2026-11-23"), "");
}

}  // namespace
