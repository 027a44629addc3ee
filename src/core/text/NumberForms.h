#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

/// Conversions between numbers and text. The decimal point is always ".", whatever the locale.

/// Number form: a leading blank if not negative, no zero before the point, the fewest digits that represent
/// the value (at most 7 for a float, 15 for a double). Below 1E-4, and from 1E+7 (float) or 1E+15 (double)
/// up, an exponent of at least two digits ("E-05"). Throws RuntimeError 6 for an infinity or a NaN.
std::string Str(std::int32_t value);
std::string Str(float value);
std::string Str(double value);

/// Conventional decimal form: 12, 0.5, -0.25. No leading blank, a zero before the point; digits and exponent
/// as in Str. Throws as Str does.
std::string PlainDecimal(double value);

/// Value of the leading numeric part of `text`: "12abc" is 12; without one, 0. Blanks, tabs and line breaks
/// are ignored everywhere: "1 2" is 12. Never throws; a value too large for a double becomes the largest one
/// whose number form can still be read back.
double Val(std::string_view text);

/// The value of a numeric text (see IsNumeric), an infinity if it is too large; nullopt for any other text.
std::optional<double> NumberIn(std::string_view text);

/// The number in a text of digits only; nullopt for any other text, and above 32767.
std::optional<std::int16_t> NumberOfDigits(std::string_view text);

/// True for an optional sign, digits with at most one point, and an optional exponent, with any white space
/// around it.
bool IsNumeric(std::string_view text);

/// Throw RuntimeError 13 if `text` is not numeric, 6 if its value is out of range.
double ToDouble(std::string_view text);
float ToSingle(std::string_view text);

/// Round to nearest, ties to even. Throw RuntimeError 13 if `text` is not numeric, 6 if its value is out of
/// range.
std::int32_t ToInt32(std::string_view text);
std::int16_t ToInt16(std::string_view text);
std::uint8_t ToByte(std::string_view text);

/// Rounds to nearest, ties to even. Throws RuntimeError 6 if out of range or NaN.
std::int32_t RoundToInt32(long double value);

/// Rounds to two decimals: times 100, to nearest with ties to even, divided by 100.
double Round2(double value);

/// `value` times 100 with two decimals and "%": 0.5 is "50.00%". Rounds the exact value, ties away from zero;
/// a zero has no sign, and digits are not grouped. Throws RuntimeError 6 for an infinity or a NaN.
std::string FormatPercent(double value);

/// A running time in minutes as hours and minutes, each in the number form: " 2H  5M" for 125.
std::string RunTimeText(std::int32_t minutes);
/// The number that FormatPercent shows for a float, in hundredths of a percent: 5000 for "50.00%".
double PercentHundredths(float value);

/// `value` with `decimals` (0 or more) digits after the point, rounded like FormatPercent.
std::string FormatFixed(double value, int decimals);
