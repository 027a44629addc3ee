#include "platform/jet/JetDate.h"

#include <gtest/gtest.h>

#include <string>

namespace {

TEST(JetDate, HasItsTimeOfDayInTheFractionOnBothSidesOfItsBeginning) {
  EXPECT_EQ(JetDateText(0), "1899-12-30 00:00:00");
  EXPECT_EQ(JetDateText(1.25), "1899-12-31 06:00:00");
  EXPECT_EQ(JetDateText(-1.25), "1899-12-29 06:00:00");
  EXPECT_EQ(JetDateText(41415.6041087963), "2013-05-21 14:29:55");
}

TEST(JetDate, IsOfTheNextDayWhereItsSecondsRoundUp) {
  EXPECT_EQ(JetDateText(41415.9999999), "2013-05-22 00:00:00");
}

bool IsLeapYear(int year) {
  return year % 4 == 0 && (year % 100 != 0 || year % 400 == 0);
}

int DaysOf(int month, int year) {
  constexpr int days[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
  return days[month - 1] + (month == 2 && IsLeapYear(year) ? 1 : 0);
}

/// `number` in the digits that `place` has for it.
void PutDigits(std::string& text, std::size_t place, std::size_t digits, int number) {
  for (std::size_t at = place + digits; at > place; number /= 10) {
    text[--at] = static_cast<char>('0' + number % 10);
  }
}

TEST(JetDate, IsTheCalendarsOnEveryDayThatTheFormatKnows) {
  int year = 100;
  int month = 1;
  int day = 1;
  constexpr int first = -657434;
  constexpr int last = 2958465;
  std::string expected = "0100-01-01 00:00:00";
  for (int number = first; number <= last; ++number) {
    ASSERT_EQ(JetDateText(number), expected) << number;
    if (++day > DaysOf(month, year)) {
      day = 1;
      year += month == 12 ? 1 : 0;
      month = month % 12 + 1;
      PutDigits(expected, 0, 4, year);
      PutDigits(expected, 5, 2, month);
    }
    PutDigits(expected, 8, 2, day);
  }
  EXPECT_EQ(expected, "0000-01-01 00:00:00");  // the year 10000
}

}  // namespace
