#include "platform/jet/JetDate.h"

#include <array>
#include <chrono>
#include <cmath>
#include <cstdio>

bool IsJetDate(double date) {
  constexpr double first = -657434;
  constexpr double behindLast = 2958466;
  return date > first - 1 && date < behindLast;  // false for NaN
}

std::string JetDateText(double date) {
  using std::chrono::days;
  constexpr std::chrono::sys_days first{std::chrono::year{1899} / 12 / 30};
  constexpr int secondsOfDay = 86400;
  auto day = static_cast<days::rep>(date);
  auto seconds = static_cast<int>(std::lround(std::abs(date - static_cast<double>(day)) * secondsOfDay));
  if (seconds == secondsOfDay) {
    seconds = 0;
    ++day;
  }
  const std::chrono::year_month_day civil{first + days{day}};
  std::array<char, 64> text{};
  std::snprintf(text.data(), text.size(), "%04d-%02u-%02u %02d:%02d:%02d", static_cast<int>(civil.year()),
                static_cast<unsigned int>(civil.month()), static_cast<unsigned int>(civil.day()),
                seconds / 3600, seconds / 60 % 60, seconds % 60);
  return text.data();
}
