#include "archive/PlayedTime.h"

#include <gtest/gtest.h>

#include "tests/fakes/FakeClock.h"

namespace {

constexpr const char* FileTime = "2026-11-08 22:10:33";

std::string Played(const std::string& dateText, const std::string& fileTime = FileTime) {
  FakeClock clock;
  clock.Stamps = {{"21/11/2026 20:15", "2026-11-21 20:15:00"},
                  {"08/11/2026", "2026-11-08 00:00:00"},
                  {"07/11/2026", "2026-11-07 00:00:00"}};
  return TimePlayed(dateText, fileTime, clock);
}

TEST(TimePlayed, IsTheOneInTheFileInTheFormOfThisComputer) {
  EXPECT_EQ(Played("21/11/2026 20:15"), "2026-11-21 20:15:00");
}

TEST(TimePlayed, IsTheOneInTheFileWithTheYearFirst) {
  EXPECT_EQ(Played("2026-11-20 19:05:07"), "2026-11-20 19:05:07");
  EXPECT_EQ(Played("2026/1/2 9:05"), "2026-01-02 09:05:00");
}

TEST(TimePlayed, IsTheOneInTheFileInAFormThatLeavesNothingOpen) {
  EXPECT_EQ(Played("25.11.2026 20:15"), "2026-11-25 20:15:00");
  EXPECT_EQ(Played("11/25/2026 8:15:30 PM"), "2026-11-25 20:15:30");
  EXPECT_EQ(Played("11/25/2026 12:15 am"), "2026-11-25 00:15:00");
  EXPECT_EQ(Played("11/25/2026 12:15 PM"), "2026-11-25 12:15:00");
  EXPECT_EQ(Played("5.5.2026 20.15"), "2026-05-05 20:15:00");
}

TEST(TimePlayed, TakesOfTwoPossibleDaysTheOneOnWhichTheFileWasChanged) {
  EXPECT_EQ(Played("08.11.2026 20:15"), "2026-11-08 20:15:00");
  EXPECT_EQ(Played("11.08.2026 20:15"), "2026-11-08 20:15:00");
  EXPECT_EQ(Played("09.11.2026 20:15"), FileTime);
}

TEST(TimePlayed, WithoutATimeOfDayIsThatOfTheFileIfTheDayIsTheSame) {
  EXPECT_EQ(Played("08/11/2026"), FileTime);
  EXPECT_EQ(Played("07/11/2026"), "2026-11-07 00:00:00");
  EXPECT_EQ(Played("2026-11-06"), "2026-11-06 00:00:00");
}

TEST(TimePlayed, IsThatOfTheFileWhereItsDateCannotBeRead) {
  for (const char* text : {"", "N/A", "yesterday", "20:15", "31.02.2026 20:15", "13/13/2026 20:15",
                           "25.11.2026 24:15", "25.11.2026 20:60", "11/25/2026 13:15 PM", "25.11.26 20:15",
                           "25.11.1026 20:15", "2026/11/25 下午8:15", "25.11.2026 8:15 p.m.",
                           "1 2 3 4 5 6 7:8", "99999999999999999999.1.2026 20:15"}) {
    EXPECT_EQ(Played(text), FileTime) << text;
  }
}

}  // namespace
