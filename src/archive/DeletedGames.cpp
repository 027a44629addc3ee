#include "archive/DeletedGames.h"

#include <array>
#include <chrono>
#include <cstdio>

std::string LastTimeOfRemoved(const std::string& now) {
  using namespace std::chrono;
  int year = 0;
  unsigned month = 0;
  unsigned day = 0;
  constexpr std::size_t dateLength = 10;
  if (std::sscanf(now.c_str(), "%4d-%2u-%2u", &year, &month, &day) != 3) {
    return {};
  }
  const year_month_day date{std::chrono::year(year), std::chrono::month(month), std::chrono::day(day)};
  if (!date.ok()) {
    return {};
  }
  const year_month_day before{sys_days(date) - days(DaysOfDeletedGames)};
  std::array<char, 32> text{};
  std::snprintf(text.data(), text.size(), "%04d-%02u-%02u", static_cast<int>(before.year()),
                static_cast<unsigned>(before.month()), static_cast<unsigned>(before.day()));
  return text.data() + now.substr(dateLength);
}
