#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

/// Numbers as text and texts as numbers. The decimal point is always "." and no locale is asked.

/// Number form: one leading blank when not negative, no zero before the point, the fewest digits that show
/// the value (at most 7 for a float, 15 for a double). An exponent of at least two digits ("E-05") below
/// 1E-4, and from 1E+7 (float) or 1E+15 (double) up. Throws RuntimeError 6 for an infinity or a NaN.
std::string Str(std::int32_t value);
std::string Str(float value);
std::string Str(double value);

/// As a reader of records expects it: 12, 0.5, -0.25. No leading blank; digits and exponent as in Str. Throws
/// as Str does.
std::string PlainDecimal(double value);

/// Value of the leading numeric part of `text`: "12abc" is 12, and a text without one is 0. Blanks, tabs and
/// line breaks count nowhere: "1 2" is 12. Never throws; a value too large for a double becomes the largest
/// one whose number form can still be read back.
double Val(std::string_view text);

/// The number that `text` is as a whole (see IsNumeric), an infinity when it is too large; nothing for any
/// other text.
std::optional<double> NumberIn(std::string_view text);

/// The number that a text of digits and nothing else says; nothing for any other text, and above 32767.
std::optional<std::int16_t> NumberOfDigits(std::string_view text);

/// True for an optional sign, digits with at most one point, and an optional exponent, with any white space
/// around it.
bool IsNumeric(std::string_view text);

/// Throws RuntimeError 13 when `text` is not numeric, 6 when its value does not fit.
double ToDouble(std::string_view text);
float ToSingle(std::string_view text);

/// Rounded to nearest, ties to even. Throws RuntimeError 13 when `text` is not numeric, 6 when its value does
/// not fit.
std::int32_t ToInt32(std::string_view text);
std::int16_t ToInt16(std::string_view text);
std::uint8_t ToByte(std::string_view text);

/// Rounded to nearest, ties to even. Throws RuntimeError 6 when out of range or not a number.
std::int32_t RoundToInt32(long double value);

/// Rounded to two decimals: times 100, to nearest with ties to even, divided by 100.
double Round2(double value);

/// `value` times 100 with two decimals and "%": 0.5 is "50.00%". Rounds the exact value, a tie away from
/// zero; zero has no sign, and digits are not grouped. Throws RuntimeError 6 for an infinity or a NaN.
std::string FormatPercent(double value);

/// A running time in minutes as hours and minutes, each in the number form: " 2H  5M" for 125.
std::string RunTimeText(std::int32_t minutes);
/// The number that FormatPercent shows of a float, in hundredths of a percent: 5000 for "50.00%".
double PercentHundredths(float value);

/// `value` with `decimals` (0 or more) digits behind the point, rounded like FormatPercent.
std::string FormatFixed(double value, int decimals);
