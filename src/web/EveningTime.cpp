#include "web/EveningTime.h"

#include <charconv>

namespace {

void AppendTwoDigits(std::string& text, unsigned number) {
  constexpr unsigned ten = 10;
  text += static_cast<char>('0' + number / ten % ten);
  text += static_cast<char>('0' + number % ten);
}

}  // namespace

std::optional<std::chrono::sys_seconds> TimeIn(const std::string& text) {
  constexpr std::size_t length = 19;
  if (text.size() != length) {
    return std::nullopt;
  }
  const auto number = [&text](std::size_t at, std::size_t count) {
    int value = 0;
    const auto [end, fault] = std::from_chars(text.data() + at, text.data() + at + count, value);
    return fault == std::errc() && end == text.data() + at + count ? value : -1;
  };
  const std::chrono::year_month_day day{std::chrono::year(number(0, 4)),
                                        std::chrono::month(static_cast<unsigned>(number(5, 2))),
                                        std::chrono::day(static_cast<unsigned>(number(8, 2)))};
  if (!day.ok() || number(11, 2) < 0 || number(14, 2) < 0 || number(17, 2) < 0) {
    return std::nullopt;
  }
  return std::chrono::sys_days(day) + std::chrono::hours(number(11, 2)) +
         std::chrono::minutes(number(14, 2)) + std::chrono::seconds(number(17, 2));
}

std::string TextOf(std::chrono::sys_seconds time) {
  const auto midnight = std::chrono::floor<std::chrono::days>(time);
  const std::chrono::year_month_day day(midnight);
  const std::chrono::hh_mm_ss clock(time - midnight);
  std::string text = std::to_string(static_cast<int>(day.year()));
  text += '-';
  AppendTwoDigits(text, static_cast<unsigned>(day.month()));
  text += '-';
  AppendTwoDigits(text, static_cast<unsigned>(day.day()));
  text += ' ';
  AppendTwoDigits(text, static_cast<unsigned>(clock.hours().count()));
  text += ':';
  AppendTwoDigits(text, static_cast<unsigned>(clock.minutes().count()));
  text += ':';
  AppendTwoDigits(text, static_cast<unsigned>(clock.seconds().count()));
  return text;
}

std::string HoursAndMinutes(const std::string& stamp) {
  constexpr std::size_t at = 11;
  constexpr std::size_t length = 5;
  return stamp.size() >= at + length ? stamp.substr(at, length) : std::string();
}
