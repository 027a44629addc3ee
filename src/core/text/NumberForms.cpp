#include "core/text/NumberForms.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <iterator>
#include <limits>
#include <type_traits>

#include "core/text/Pieces.h"
#include "platform/Letters.h"
#include "platform/RuntimeError.h"

namespace {

/// Above this, a double's number form rounds up to a text that no double can hold.
constexpr double LargestReadable = 1.79769313486231E+308;

std::size_t EndOfDigits(std::string_view text, std::size_t at) {
  while (at < text.size() && IsDigit(text[at])) {
    ++at;
  }
  return at;
}

/// Length of the number at the start of `text`: sign, digits with at most one point, exponent; 0 if there is
/// none.
std::size_t LengthOfNumber(std::string_view text) {
  const auto isSign = [text](std::size_t at) {
    return at < text.size() && (text[at] == '+' || text[at] == '-');
  };
  const std::size_t first = isSign(0) ? 1 : 0;
  std::size_t end = EndOfDigits(text, first);
  std::size_t digits = end - first;
  if (end < text.size() && text[end] == '.') {
    const std::size_t endOfDecimals = EndOfDigits(text, end + 1);
    digits += endOfDecimals - end - 1;
    end = endOfDecimals;
  }
  if (digits == 0) {
    return 0;
  }
  if (end < text.size() && (text[end] == 'E' || text[end] == 'e')) {
    const std::size_t exponent = end + (isSign(end + 1) ? 2 : 1);
    const std::size_t endOfExponent = EndOfDigits(text, exponent);
    if (endOfExponent > exponent) {
      end = endOfExponent;
    }
  }
  return end;
}

/// For a number in `text` that no double can hold: true if it is too large, false if too small. The power of
/// ten of its first non-zero digit decides, being far from 0 in both cases.
bool IsTooLarge(std::string_view text) {
  const std::size_t letterE = std::min(text.find_first_of("Ee"), text.size());
  const std::string_view mantissa = text.substr(0, letterE);
  const auto point = static_cast<long long>(std::min(mantissa.find('.'), mantissa.size()));
  const auto firstDigit = static_cast<long long>(mantissa.find_first_of("123456789"));
  std::string_view exponentText = text.substr(std::min(letterE + 1, text.size()));
  const bool negative = exponentText.starts_with('-');
  if (negative || exponentText.starts_with('+')) {
    exponentText.remove_prefix(1);
  }
  long long exponent = 0;
  const auto parsed =
      std::from_chars(exponentText.data(), exponentText.data() + exponentText.size(), exponent);
  if (parsed.ec == std::errc::result_out_of_range) {
    return !negative;
  }
  return point - firstDigit + (negative ? -exponent : exponent) > 0;
}

/// Value of a text that consists of a number only: an infinity if too large, 0 if too small.
double ValueOfNumber(std::string_view text) {
  if (text.starts_with('+')) {
    text.remove_prefix(1);
  }
  constexpr std::size_t exactDigits = 15;
  if (text.size() <= exactDigits) {  // usually an integer, which parses several times faster
    long long whole = 0;
    if (std::from_chars(text.data(), text.data() + text.size(), whole).ptr == text.data() + text.size()) {
      return static_cast<double>(whole);
    }
  }
  double value = 0;
  const auto parsed = std::from_chars(text.data(), text.data() + text.size(), value);
  if (parsed.ec != std::errc::result_out_of_range) {
    return value;
  }
  if (!IsTooLarge(text)) {
    return 0;
  }
  constexpr double infinity = std::numeric_limits<double>::infinity();
  return text.starts_with('-') ? -infinity : infinity;
}

void RequireFinite(double value) {
  if (!std::isfinite(value)) {
    throw RuntimeError(Fault::Overflow);
  }
}

/// Increments the last digit of a decimal text, with carry: "-1.99" becomes "-2.00".
void AddOneToLastDigit(std::string& number) {
  for (std::size_t at = number.size(); at > 0 && number[at - 1] != '-'; --at) {
    char& digit = number[at - 1];
    if (digit == '9') {
      digit = '0';
    } else if (digit != '.') {
      ++digit;
      return;
    }
  }
  number.insert(number.starts_with('-') ? 1 : 0, "1");
}

/// "-12.34%" for -1234.
std::string HundredthsAsPercent(long long hundredths) {
  std::array<char, 24> buffer{};
  char* digits = buffer.data();
  const long long size = std::abs(hundredths);
  if (hundredths < 0) {
    *digits++ = '-';
  }
  char* end = std::to_chars(digits, buffer.data() + buffer.size(), size / 100).ptr;
  *end++ = '.';
  *end++ = static_cast<char>('0' + size / 10 % 10);
  *end++ = static_cast<char>('0' + size % 10);
  *end++ = '%';
  return {buffer.data(), end};
}

template <typename Float>
std::string NumberForm(Float value) {
  constexpr int mostDigits = std::is_same_v<Float, float> ? 7 : 15;
  RequireFinite(value);
  if (value == 0) {
    return " 0";
  }
  std::array<char, 32> buffer{};
  const auto written = std::to_chars(buffer.data(), buffer.data() + buffer.size(), std::abs(value),
                                     std::chars_format::scientific, mostDigits - 1);
  const std::string_view shown(buffer.data(), static_cast<std::size_t>(written.ptr - buffer.data()));
  const std::size_t letterE = shown.find('e');
  const std::string exponentText(shown.substr(letterE + 1));
  const int exponent = std::stoi(exponentText);

  std::string digits(shown.substr(0, letterE));
  digits.erase(1, 1);
  digits.erase(digits.find_last_not_of('0') + 1);

  const std::string sign(value < 0 ? "-" : " ");
  if (exponent < -4 || exponent >= mostDigits) {
    return sign + digits.substr(0, 1) + (digits.size() > 1 ? "." : "") + digits.substr(1) + "E" +
           exponentText;
  }
  if (exponent < 0) {
    return sign + "." + std::string(static_cast<std::size_t>(-exponent - 1), '0') + digits;
  }
  const auto integerDigits = static_cast<std::size_t>(exponent) + 1;
  if (digits.size() <= integerDigits) {
    return sign + digits + std::string(integerDigits - digits.size(), '0');
  }
  return sign + digits.substr(0, integerDigits) + "." + digits.substr(integerDigits);
}

template <typename Integer>
Integer ToInteger(std::string_view text) {
  const std::int32_t value = ToInt32(text);
  if (value < std::numeric_limits<Integer>::min() || value > std::numeric_limits<Integer>::max()) {
    throw RuntimeError(Fault::Overflow);
  }
  return static_cast<Integer>(value);
}

}  // namespace

std::string Str(std::int32_t value) {
  constexpr std::size_t mostLetters = 11;
  std::string text(mostLetters, ' ');
  char* const first = text.data() + (value < 0 ? 0 : 1);
  text.resize(
      static_cast<std::size_t>(std::to_chars(first, text.data() + mostLetters, value).ptr - text.data()));
  return text;
}

std::string Str(float value) {
  return NumberForm(value);
}

std::string Str(double value) {
  return NumberForm(value);
}

std::string PlainDecimal(double value) {
  std::string text = Str(value);
  if (text.front() == ' ') {
    text.erase(0, 1);
  }
  if (const auto point = text.find('.'); point == 0 || (point == 1 && text.front() == '-')) {
    text.insert(point, "0");
  }
  return text;
}

double Val(std::string_view text) {
  std::string dense;
  const std::size_t next = text.find_first_not_of("0123456789+-.Ee");
  if (next != std::string_view::npos && IsWhiteSpace(text[next])) {
    // Blanks within a number do not end it.
    std::copy_if(text.begin(), text.end(), std::back_inserter(dense),
                 [](char letter) { return !IsWhiteSpace(letter); });
    text = dense;
  }
  const std::size_t length = LengthOfNumber(text);
  const double value = length == 0 ? 0 : ValueOfNumber(text.substr(0, length));
  return std::clamp(value, -LargestReadable, LargestReadable);
}

std::optional<double> NumberIn(std::string_view text) {
  const std::string_view number = Trimmed(text, IsWhiteSpace);
  if (number.empty() || LengthOfNumber(number) != number.size()) {
    return std::nullopt;
  }
  return ValueOfNumber(number);
}

std::optional<std::int16_t> NumberOfDigits(std::string_view text) {
  std::int16_t number = 0;
  const char* const end = text.data() + text.size();
  const auto parsed = std::from_chars(text.data(), end, number);
  const bool whole = parsed.ec == std::errc() && parsed.ptr == end && IsDigit(text.front());
  return whole ? std::optional(number) : std::nullopt;
}

bool IsNumeric(std::string_view text) {
  return NumberIn(text).has_value();
}

double ToDouble(std::string_view text) {
  const std::optional<double> value = NumberIn(text);
  if (!value) {
    throw RuntimeError(Fault::TypeMismatch);
  }
  RequireFinite(*value);
  return *value;
}

float ToSingle(std::string_view text) {
  const double value = ToDouble(text);
  if (std::abs(value) > std::numeric_limits<float>::max()) {
    throw RuntimeError(Fault::Overflow);
  }
  return static_cast<float>(value);
}

std::int32_t ToInt32(std::string_view text) {
  return RoundToInt32(ToDouble(text));
}

std::int16_t ToInt16(std::string_view text) {
  return ToInteger<std::int16_t>(text);
}

std::uint8_t ToByte(std::string_view text) {
  return ToInteger<std::uint8_t>(text);
}

std::int32_t RoundToInt32(long double value) {
  constexpr long double outOfRange = 3e9L;
  const bool near = value > -outOfRange && value < outOfRange;
  const long long rounded = near ? std::llrint(value) : std::numeric_limits<long long>::max();
  if (rounded < std::numeric_limits<std::int32_t>::min() ||
      rounded > std::numeric_limits<std::int32_t>::max()) {
    throw RuntimeError(Fault::Overflow);
  }
  return static_cast<std::int32_t>(rounded);
}

double Round2(double value) {
  return std::nearbyint(value * 100) / 100;
}

std::string FormatPercent(double value) {
  constexpr double mostPercent = 1e9;
  const auto single = static_cast<float>(value);
  if (std::abs(value) < mostPercent && single == value) {
    return HundredthsAsPercent(static_cast<long long>(PercentHundredths(single)));
  }
  std::string text = FormatFixed(value, 4);
  const std::size_t point = text.find('.');
  text.erase(point, 1).insert(point + 2, ".");
  const std::size_t first = text.starts_with('-') ? 1 : 0;
  const std::size_t units = point + 1;
  text.erase(first, std::min(text.find_first_not_of('0', first), units) - first);
  return text + "%";
}

std::string RunTimeText(std::int32_t minutes) {
  const std::int32_t hours = minutes / 60;
  return Str(hours) + "H " + Str(minutes - hours * 60) + "M";
}

double PercentHundredths(float value) {
  // Ten thousand times a float is exact in a double, and so is the tie.
  return std::round(double{value} * 10'000);
}

std::string FormatFixed(double value, int decimals) {
  RequireFinite(value);
  // A tie is an odd multiple of half the last decimal place; for a binary fraction, of 1 / 2^(decimals + 1).
  // to_chars would round it to the even digit, so it is written exactly, with one more decimal, and then
  // rounded up.
  const bool tie = std::abs(std::fmod(std::ldexp(value, decimals + 1), 2)) == 1;
  constexpr int mostBeforeDecimals = 312;
  std::string text(static_cast<std::size_t>(mostBeforeDecimals + decimals), '\0');
  const auto written = std::to_chars(text.data(), text.data() + text.size(), value, std::chars_format::fixed,
                                     tie ? decimals + 1 : decimals);
  text.resize(static_cast<std::size_t>(written.ptr - text.data()));
  if (tie) {
    text.resize(text.size() - (decimals == 0 ? 2 : 1));
    AddOneToLastDigit(text);
  }
  if (text.find_first_of("123456789") == std::string::npos && text.starts_with('-')) {
    text.erase(0, 1);
  }
  return text;
}
