#include "members/MemberDates.h"

#include <array>
#include <cstdio>
#include <utility>

#include "core/text/Pieces.h"
#include "platform/Letters.h"

namespace {

constexpr std::string_view Midnight = " 00:00:00";

struct WrittenNumber {
  int Value = 0;
  std::size_t Digits = 0;
};

/// Takes the digits at the start of `text`, at most eight.
WrittenNumber TakeNumber(std::string_view& text) {
  constexpr std::size_t mostDigits = 8;
  WrittenNumber number;
  while (number.Digits < mostDigits && !text.empty() && IsDigit(text.front())) {
    number.Value = number.Value * 10 + (text.front() - '0');
    ++number.Digits;
    text.remove_prefix(1);
  }
  return number;
}

bool TakeText(std::string_view& text, std::string_view part) {
  const bool found = text.starts_with(part);
  text.remove_prefix(found ? part.size() : 0);
  return found;
}

bool IsLeapYear(int year) {
  return (year % 4 == 0 && year % 100 != 0) || year % 400 == 0;
}

bool IsDay(int year, int month, int day) {
  constexpr std::array<int, 12> days = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
  if (year < 1 || month < 1 || month > 12 || day < 1) {
    return false;
  }
  return day <= days[static_cast<std::size_t>(month - 1)] + (month == 2 && IsLeapYear(year) ? 1 : 0);
}

/// The numbers of a date as they stand, before their order is settled.
struct WrittenDate {
  int Year = 0;
  int First = 0;
  int Second = 0;
  bool BeginsWithYear = false;
  std::string Time = std::string(Midnight);

  bool IsIn(DateOrder order) const {
    return order == DateOrder::DayFirst && !BeginsWithYear ? IsDay(Year, Second, First)
                                                           : IsDay(Year, First, Second);
  }
};

/// Takes the same separator twice: after the first and after the second number.
bool TakeDateNumbers(std::string_view& text, std::array<WrittenNumber, 3>& numbers) {
  numbers[0] = TakeNumber(text);
  if (text.starts_with("年")) {
    TakeText(text, "年");
    numbers[1] = TakeNumber(text);
    const bool hasMonth = TakeText(text, "月");
    numbers[2] = TakeNumber(text);
    TakeText(text, "日");
    return hasMonth;
  }
  const char separator = text.empty() ? '\0' : text.front();
  if (separator == '\0' || std::string_view("-/. ").find(separator) == std::string_view::npos) {
    return false;
  }
  for (std::size_t place = 1; place < numbers.size(); ++place) {
    if (!TakeText(text, {&separator, 1})) {
      return false;
    }
    text.remove_prefix(separator == '.' && text.starts_with(' ') ? 1 : 0);  // "3. 5. 2001"
    numbers[place] = TakeNumber(text);
  }
  return true;
}

std::optional<WrittenDate> TakeDate(std::string_view& text) {
  constexpr std::size_t compactDigits = 8;
  std::array<WrittenNumber, 3> numbers;
  std::string_view compact = text;
  if (const WrittenNumber whole = TakeNumber(compact); whole.Digits == compactDigits) {
    text = compact;
    return WrittenDate{whole.Value / 10000, whole.Value / 100 % 100, whole.Value % 100, true};
  }
  if (!TakeDateNumbers(text, numbers)) {
    return std::nullopt;
  }
  const auto isShort = [](const WrittenNumber& number) { return number.Digits == 1 || number.Digits == 2; };
  if (numbers[0].Digits == 4 && isShort(numbers[1]) && isShort(numbers[2])) {
    return WrittenDate{numbers[0].Value, numbers[1].Value, numbers[2].Value, true};
  }
  if (!isShort(numbers[0]) || !isShort(numbers[1]) || (numbers[2].Digits != 4 && numbers[2].Digits != 2)) {
    return std::nullopt;
  }
  constexpr int firstYear = 30;
  const int year = numbers[2].Value;
  const int century = numbers[2].Digits == 4 ? 0 : year < firstYear ? 2000 : 1900;
  return WrittenDate{year + century, numbers[0].Value, numbers[1].Value, false};
}

/// Takes " HH:MM[:SS]" with or without AM or PM.
bool TakeTime(std::string_view& text, std::string& time) {
  if (!TakeText(text, "T")) {
    text = Trimmed(text, IsBlank);
  }
  int hour = TakeNumber(text).Value;
  if (!TakeText(text, ":")) {
    return false;
  }
  const WrittenNumber minute = TakeNumber(text);
  const WrittenNumber second = TakeText(text, ":") ? TakeNumber(text) : WrittenNumber{0, 2};
  text = Trimmed(text, IsBlank);
  const bool isMorning = TakeText(text, "AM") || TakeText(text, "am");
  const bool isEvening = !isMorning && (TakeText(text, "PM") || TakeText(text, "pm"));
  if ((isMorning || isEvening) && (hour < 1 || hour > 12)) {
    return false;
  }
  hour = isMorning && hour == 12 ? 0 : isEvening && hour < 12 ? hour + 12 : hour;
  if (hour > 23 || minute.Digits != 2 || minute.Value > 59 || second.Digits != 2 || second.Value > 59) {
    return false;
  }
  std::array<char, 48> digits{};
  std::snprintf(digits.data(), digits.size(), " %02d:%02d:%02d", hour, minute.Value, second.Value);
  time = digits.data();
  return true;
}

std::optional<WrittenDate> DateIn(std::string_view text) {
  text = Trimmed(text, IsWhiteSpace);
  std::optional<WrittenDate> date = TakeDate(text);
  if (!date || (!text.empty() && !TakeTime(text, date->Time)) || !text.empty()) {
    return std::nullopt;
  }
  return date;
}

}  // namespace

DateSign SignOf(std::string_view text) {
  const std::optional<WrittenDate> date = DateIn(text);
  if (!date) {
    return DateSign::NoDate;
  }
  const bool dayFirst = date->IsIn(DateOrder::DayFirst);
  const bool monthFirst = date->IsIn(DateOrder::MonthFirst);
  if (dayFirst && monthFirst) {
    return date->BeginsWithYear || date->First == date->Second ? DateSign::Clear : DateSign::Open;
  }
  return dayFirst ? DateSign::DayFirst : monthFirst ? DateSign::MonthFirst : DateSign::NoDate;
}

std::optional<std::string> StoredMoment(std::string_view text, DateOrder order) {
  const std::optional<WrittenDate> date = DateIn(text);
  if (!date || !date->IsIn(order)) {
    return std::nullopt;
  }
  const bool dayFirst = order == DateOrder::DayFirst && !date->BeginsWithYear;
  std::array<char, 48> digits{};
  std::snprintf(digits.data(), digits.size(), "%04d-%02d-%02d", date->Year,
                dayFirst ? date->Second : date->First, dayFirst ? date->First : date->Second);
  return digits.data() + date->Time;
}

std::string_view ExportedMoment(std::string_view stored) {
  constexpr std::size_t dateLength = 10;
  const bool isMidnight = stored.size() == dateLength + Midnight.size() && stored.ends_with(Midnight);
  return isMidnight ? stored.substr(0, dateLength) : stored;
}
