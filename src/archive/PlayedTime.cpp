#include "archive/PlayedTime.h"

#include <array>
#include <cstdio>
#include <optional>
#include <string_view>
#include <vector>

namespace {

constexpr std::size_t DayLength = 10;  // "YYYY-MM-DD"

enum class HalfOfDay { None, Morning, Afternoon };

/// The numbers of a date and, behind it, a time.
struct Numbers {
  std::vector<int> Values;
  HalfOfDay Half = HalfOfDay::None;

  bool HasTime() const { return Values.size() > 3; }
};

bool IsDigit(char letter) {
  return letter >= '0' && letter <= '9';
}

/// Takes "AM" or "PM" off the end of a text.
HalfOfDay TakeHalf(std::string_view& text) {
  constexpr std::size_t length = 2;
  if (text.size() < length || (text.back() != 'M' && text.back() != 'm')) {
    return HalfOfDay::None;
  }
  const char letter = text[text.size() - length];
  const bool isMorning = letter == 'A' || letter == 'a';
  if (!isMorning && letter != 'P' && letter != 'p') {
    return HalfOfDay::None;
  }
  text.remove_suffix(length);
  return isMorning ? HalfOfDay::Morning : HalfOfDay::Afternoon;
}

/// The numbers in a text of a date and, behind it, a time; none for one with any other words.
std::optional<Numbers> NumbersIn(std::string_view text) {
  constexpr std::size_t mostNumbers = 6;
  constexpr std::string_view between = " ./-:,T";
  Numbers numbers;
  numbers.Half = TakeHalf(text);
  for (std::size_t at = 0; at < text.size();) {
    if (!IsDigit(text[at])) {
      if (between.find(text[at++]) == std::string_view::npos) {
        return std::nullopt;
      }
      continue;
    }
    int value = 0;
    for (; at < text.size() && IsDigit(text[at]); ++at) {
      constexpr int most = 10'000;
      value = value < most ? value * 10 + (text[at] - '0') : value;
    }
    if (numbers.Values.size() == mostNumbers) {
      return std::nullopt;
    }
    numbers.Values.push_back(value);
  }
  const std::size_t count = numbers.Values.size();
  return count == 3 || count == 5 || count == 6 ? std::optional(numbers) : std::nullopt;
}

/// "YYYY-MM-DD"; empty if there is no such day.
std::string DayOf(int year, int month, int day) {
  constexpr std::array<int, 12> days = {31, 29, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
  constexpr int firstYear = 1990;
  constexpr int lastYear = 2100;
  const bool isLeap = year % 4 == 0 && (year % 100 != 0 || year % 400 == 0);
  const bool isDay = year >= firstYear && year <= lastYear && month >= 1 && month <= 12 && day >= 1 &&
                     day <= days.at(static_cast<std::size_t>(month - 1)) &&
                     (month != 2 || day < 29 || isLeap);
  std::array<char, 40> text{};
  std::snprintf(text.data(), text.size(), "%04d-%02d-%02d", year, month, day);
  return isDay ? text.data() : std::string();
}

/// The time of day; empty if there is none, or no such.
std::string TimeOf(const Numbers& numbers) {
  if (!numbers.HasTime()) {
    return {};
  }
  int hour = numbers.Values[3];
  const int minute = numbers.Values[4];
  const int second = numbers.Values.size() > 5 ? numbers.Values[5] : 0;
  constexpr int noon = 12;
  if (numbers.Half != HalfOfDay::None) {
    if (hour < 1 || hour > noon) {
      return {};
    }
    hour = hour % noon + (numbers.Half == HalfOfDay::Afternoon ? noon : 0);
  }
  std::array<char, 40> text{};
  std::snprintf(text.data(), text.size(), "%02d:%02d:%02d", hour, minute, second);
  return hour < 24 && minute < 60 && second < 60 ? text.data() : std::string();
}

/// The day that the first three numbers tell; empty if they leave it open. `fileDay` decides between two.
std::string DayIn(const std::vector<int>& numbers, std::string_view fileDay) {
  constexpr int firstFourDigits = 1000;
  const int first = numbers[0];
  const int second = numbers[1];
  const int third = numbers[2];
  if (first >= firstFourDigits) {
    return DayOf(first, second, third);
  }
  const std::string dayFirst = DayOf(third, second, first);
  const std::string monthFirst = DayOf(third, first, second);
  if (dayFirst.empty() || monthFirst.empty() || dayFirst == monthFirst) {
    return dayFirst.empty() ? monthFirst : dayFirst;
  }
  if (dayFirst == fileDay || monthFirst == fileDay) {
    return std::string(fileDay);
  }
  return {};
}

}  // namespace

std::string TimePlayed(const std::string& dateText, const std::string& fileTime, const Clock& time) {
  const std::string fileDay = fileTime.substr(0, DayLength);
  const std::optional<Numbers> numbers = NumbersIn(dateText);
  const bool hasTime = numbers && numbers->HasTime();
  std::string stamp = time.Stamp(dateText);
  if (!stamp.empty() && hasTime) {
    return stamp;
  }
  const std::string clock = numbers ? TimeOf(*numbers) : std::string();
  if (!numbers || (hasTime && clock.empty())) {
    return stamp.empty() ? fileTime : stamp;
  }
  const std::string day = stamp.empty() ? DayIn(numbers->Values, fileDay) : stamp.substr(0, DayLength);
  if (day.empty()) {
    return fileTime;
  }
  if (hasTime) {
    return day + " " + clock;
  }
  return day == fileDay ? fileTime : day + " 00:00:00";
}
