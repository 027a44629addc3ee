#include "members/MemberDates.h"

#include <gtest/gtest.h>

namespace {

std::string DayFirst(std::string_view text) {
  return StoredMoment(text, DateOrder::DayFirst).value_or("none");
}

std::string MonthFirst(std::string_view text) {
  return StoredMoment(text, DateOrder::MonthFirst).value_or("none");
}

TEST(MemberDates, AreTakenInTheOrderOfTheFile) {
  for (const char* text : {"3.5.2001", "03/05/2001", "3-5-2001", "3 5 2001", "3. 5. 2001", " 3.5.2001\t"}) {
    EXPECT_EQ(DayFirst(text), "2001-05-03 00:00:00") << text;
    EXPECT_EQ(MonthFirst(text), "2001-03-05 00:00:00") << text;
  }
}

TEST(MemberDates, BeginningWithTheYearHaveOneOrder) {
  for (const char* text :
       {"2001-05-03", "2001/5/3", "2001.05.03", "20010503", "2001年5月3日", "2001年5月3"}) {
    EXPECT_EQ(DayFirst(text), "2001-05-03 00:00:00") << text;
    EXPECT_EQ(MonthFirst(text), "2001-05-03 00:00:00") << text;
    EXPECT_EQ(SignOf(text), DateSign::Clear) << text;
  }
}

TEST(MemberDates, OfTwoDigitsAreFrom1930To2029) {
  EXPECT_EQ(DayFirst("3.5.29"), "2029-05-03 00:00:00");
  EXPECT_EQ(DayFirst("3.5.30"), "1930-05-03 00:00:00");
  EXPECT_EQ(DayFirst("3.5.00"), "2000-05-03 00:00:00");
  EXPECT_EQ(DayFirst("3.5.99"), "1999-05-03 00:00:00");
}

TEST(MemberDates, MayHaveATime) {
  EXPECT_EQ(DayFirst("2001-05-03 20:15:30"), "2001-05-03 20:15:30");
  EXPECT_EQ(DayFirst("2001-05-03T20:15"), "2001-05-03 20:15:00");
  EXPECT_EQ(DayFirst("3.5.2001 7:05"), "2001-05-03 07:05:00");
  EXPECT_EQ(MonthFirst("5/3/2001 8:15 PM"), "2001-05-03 20:15:00");
  EXPECT_EQ(MonthFirst("5/3/2001 12:15:01 am"), "2001-05-03 00:15:01");
  EXPECT_EQ(MonthFirst("5/3/2001 12:15 PM"), "2001-05-03 12:15:00");
}

TEST(MemberDates, ThatDoNotExistAreNone) {
  for (const char* text : {"",           "N/A",       "2001-02-29",        "1900-02-29", "31.4.2001",
                           "0.5.2001",   "3.5",       "3.5.2001 24:00",    "3.5.2001 7", "3.5.2001 7:5",
                           "3/5-2001",   "3.5.2001x", "3.5.201",           "2001-13-01", "2001-1-32",
                           "0000-01-01", "12345",     "3.5.2001 13:00 PM", "123456789",  "2001年5",
                           "3..2001"}) {
    EXPECT_EQ(DayFirst(text), "none") << text;
    EXPECT_EQ(SignOf(text), DateSign::NoDate) << text;
  }
  EXPECT_EQ(DayFirst("29.2.2004"), "2004-02-29 00:00:00");
  EXPECT_EQ(DayFirst("29.2.2000"), "2000-02-29 00:00:00");
}

TEST(MemberDates, TellTheirOrderWhereOnlyOneIsADate) {
  EXPECT_EQ(SignOf("23.5.2001"), DateSign::DayFirst);
  EXPECT_EQ(SignOf("5/23/2001"), DateSign::MonthFirst);
  EXPECT_EQ(SignOf("3/5/2001"), DateSign::Open);
  EXPECT_EQ(SignOf("5/5/2001"), DateSign::Clear);
  EXPECT_EQ(SignOf("23/23/2001"), DateSign::NoDate);
  EXPECT_EQ(MonthFirst("23.5.2001"), "none");
  EXPECT_EQ(DayFirst("5/23/2001"), "none");
}

TEST(MemberDates, AreExportedWithoutMidnight) {
  EXPECT_EQ(ExportedMoment("2001-05-03 00:00:00"), "2001-05-03");
  EXPECT_EQ(ExportedMoment("2001-05-03 20:15:00"), "2001-05-03 20:15:00");
  EXPECT_EQ(ExportedMoment("2001-05-03"), "2001-05-03");
  EXPECT_EQ(ExportedMoment("x 00:00:00"), "x 00:00:00");
}

}  // namespace
