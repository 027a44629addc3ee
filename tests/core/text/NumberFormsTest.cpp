#include "core/text/NumberForms.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>
#include <string>

#include "platform/RuntimeError.h"

namespace {

constexpr double Infinity = std::numeric_limits<double>::infinity();
constexpr double NotANumber = std::numeric_limits<double>::quiet_NaN();

/// Number of the RuntimeError that `action` throws, 0 if it throws none.
template <typename Action>
int ErrorOf(const Action& action) {
  try {
    action();
  } catch (const RuntimeError& error) {
    return error.Number();
  }
  return 0;
}

TEST(Str, PutsABlankBeforeAWholeNumberThatIsNotNegative) {
  EXPECT_EQ(Str(std::int32_t{0}), " 0");
  EXPECT_EQ(Str(std::int32_t{1}), " 1");
  EXPECT_EQ(Str(std::int32_t{-1}), "-1");
  EXPECT_EQ(Str(std::numeric_limits<std::int32_t>::max()), " 2147483647");
  EXPECT_EQ(Str(std::numeric_limits<std::int32_t>::min()), "-2147483648");
}

TEST(Str, HasNoZeroBeforeThePoint) {
  EXPECT_EQ(Str(0.5F), " .5");
  EXPECT_EQ(Str(-0.5F), "-.5");
  EXPECT_EQ(Str(0.5), " .5");
  EXPECT_EQ(Str(-0.5), "-.5");
  EXPECT_EQ(Str(0.0625), " .0625");
}

TEST(Str, ShowsWholeFloatsWithoutAPoint) {
  EXPECT_EQ(Str(0.0), " 0");
  EXPECT_EQ(Str(-0.0), " 0");
  EXPECT_EQ(Str(-0.0F), " 0");
  EXPECT_EQ(Str(1.0), " 1");
  EXPECT_EQ(Str(-1.0), "-1");
  EXPECT_EQ(Str(100.0), " 100");
  EXPECT_EQ(Str(-250.0F), "-250");
}

TEST(Str, KeepsSevenDigitsOfAFloat) {
  EXPECT_EQ(Str(0.1F), " .1");
  EXPECT_EQ(Str(1.0F / 3.0F), " .3333333");
  EXPECT_EQ(Str(2.0F / 3.0F), " .6666667");
  EXPECT_EQ(Str(123.4567F), " 123.4567");
  EXPECT_EQ(Str(1234567.0F), " 1234567");
  EXPECT_EQ(Str(9999999.0F), " 9999999");
}

TEST(Str, KeepsFifteenDigitsOfADouble) {
  EXPECT_EQ(Str(0.1), " .1");
  EXPECT_EQ(Str(1.0 / 3.0), " .333333333333333");
  EXPECT_EQ(Str(2.0 / 3.0), " .666666666666667");
  EXPECT_EQ(Str(0.1 + 0.2), " .3");
  EXPECT_EQ(Str(123456789012345.0), " 123456789012345");
  EXPECT_EQ(Str(-12345678901.25), "-12345678901.25");
}

TEST(Str, UsesAnExponentOnlyBelowOneTenThousandth) {
  EXPECT_EQ(Str(0.001), " .001");
  EXPECT_EQ(Str(0.0001), " .0001");
  EXPECT_EQ(Str(0.00012345), " .00012345");
  EXPECT_EQ(Str(0.00009), " 9E-05");
  EXPECT_EQ(Str(1E-5), " 1E-05");
  EXPECT_EQ(Str(-1.25E-5), "-1.25E-05");
  EXPECT_EQ(Str(1E-5F), " 1E-05");
  EXPECT_EQ(Str(0.0001F), " .0001");
  EXPECT_EQ(Str(1.5E-300), " 1.5E-300");
}

TEST(Str, UsesAnExponentFromTheFirstNumberWithMoreDigitsThanItShows) {
  EXPECT_EQ(Str(1E7F), " 1E+07");
  EXPECT_EQ(Str(16777216.0F), " 1.677722E+07");
  EXPECT_EQ(Str(123456789.0F), " 1.234568E+08");
  EXPECT_EQ(Str(999999999999999.0), " 999999999999999");
  EXPECT_EQ(Str(1E14), " 100000000000000");
  EXPECT_EQ(Str(1E15), " 1E+15");
  EXPECT_EQ(Str(-1E15), "-1E+15");
  EXPECT_EQ(Str(1E100), " 1E+100");
}

TEST(Str, ChoosesTheExponentAfterRounding) {
  EXPECT_EQ(Str(999999999999999.9), " 1E+15");
  EXPECT_EQ(Str(0.000099999999999999999), " .0001");
}

TEST(Str, RefusesWhatIsNoFiniteNumber) {
  EXPECT_EQ(ErrorOf([] { Str(Infinity); }), 6);
  EXPECT_EQ(ErrorOf([] { Str(NotANumber); }), 6);
  EXPECT_EQ(ErrorOf([] { Str(-std::numeric_limits<float>::infinity()); }), 6);
}

TEST(Str, IsReadBackToTheSameNumber) {
  for (const float value : {0.5F, 12.0F, -0.25F, 1E-5F, 0.3333333F, 3.402823E+38F}) {
    EXPECT_EQ(ToSingle(Str(value)), value);
  }
  for (const std::int32_t value : {0, 7, -7, 2147483647}) {
    EXPECT_EQ(ToInt32(Str(value)), value);
  }
}

TEST(PlainDecimal, HasAZeroBeforeThePointAndNoLeadingBlank) {
  EXPECT_EQ(PlainDecimal(0.5), "0.5");
  EXPECT_EQ(PlainDecimal(-0.25), "-0.25");
  EXPECT_EQ(PlainDecimal(12), "12");
  EXPECT_EQ(PlainDecimal(-7.5), "-7.5");
  EXPECT_EQ(PlainDecimal(0), "0");
  EXPECT_EQ(PlainDecimal(1028.75), "1028.75");
  EXPECT_EQ(PlainDecimal(1e20), "1E+20");
}

TEST(Val, TakesTheLeadingNumericPart) {
  EXPECT_EQ(Val("12abc"), 12);
  EXPECT_EQ(Val("-3"), -3);
  EXPECT_EQ(Val("+3"), 3);
  EXPECT_EQ(Val(".5"), 0.5);
  EXPECT_EQ(Val("5."), 5);
  EXPECT_EQ(Val("1E3"), 1000);
  EXPECT_EQ(Val("1e-3x"), 0.001);
  EXPECT_EQ(Val("1.2.3"), 1.2);
  EXPECT_EQ(Val("  7: Bob"), 7);
  EXPECT_EQ(Val("1,5"), 1);
}

TEST(Val, IsZeroWithoutANumber) {
  for (const char* text : {"", "   ", "abc", "-", ".", "-.", "E5", "--1", "%", "inf", "nan", "$5"}) {
    EXPECT_EQ(Val(text), 0) << text;
  }
  EXPECT_EQ(Val("0x10"), 0);
}

TEST(Val, LeavesAnExponentWithoutDigitsAlone) {
  EXPECT_EQ(Val("12E"), 12);
  EXPECT_EQ(Val("12E+"), 12);
  EXPECT_EQ(Val("12Em"), 12);
}

TEST(Val, SkipsBlanksAnywhere) {
  EXPECT_EQ(Val("  42"), 42);
  EXPECT_EQ(Val("1 2 3"), 123);
  EXPECT_EQ(Val("\t- 5\n"), -5);
}

TEST(Val, StaysFiniteAndReadable) {
  for (const char* text : {"1E999", "1E99999999999999999999", "1.7976931348623157E308"}) {
    const double value = Val(text);
    EXPECT_GT(value, 1.7E308) << text;
    EXPECT_EQ(ToDouble(Str(value)), value) << text;
    EXPECT_EQ(Val("-" + std::string(text)), -value) << text;
  }
  EXPECT_EQ(Val("1E-999"), 0);
  EXPECT_EQ(Val("-1E-99999999999999999999"), 0);
  EXPECT_EQ(Val("0E999"), 0);
  EXPECT_EQ(Val("0E99999999999999999999"), 0);
}

TEST(Val, WeighsTheExponentAgainstThePlaceOfTheFirstDigit) {
  const std::string zeros(400, '0');
  EXPECT_EQ(Val("1" + zeros + "E-400"), 1);
  EXPECT_EQ(Val("0." + zeros + "1E401"), 1);
  EXPECT_EQ(Val("0." + zeros + "1"), 0);
  EXPECT_EQ(Val("0." + zeros + zeros + "1E400"), 0);
  EXPECT_EQ(Val("0" + zeros + "1E-" + "400"), 0);
  EXPECT_GT(Val("1" + zeros), 1.7E308);
  EXPECT_GT(Val("1" + zeros + zeros + "E-400"), 1.7E308);
}

TEST(IsNumeric, AcceptsSignDigitsPointAndExponent) {
  for (const char* text : {"0", "7", "-3", "+3", " 42", "42 ", "\t42\r\n", "1.5", ".5", "5.", "-.5", "1E3",
                           "1e+3", "1.5E-05", "007", "1E999"}) {
    EXPECT_TRUE(IsNumeric(text)) << text;
  }
}

TEST(IsNumeric, RefusesAllElse) {
  for (const char* text : {"",    " ",    "abc",   "12abc", "1 2", "- 5",  "--5",    "5-",    ".",
                           "-",   "-.",   "1.2.3", "1E",    "1E+", "E3",   ".E3",    "1E2E3", "1E2.5",
                           "1,5", "0x10", "&H10",  "inf",   "nan", "-inf", "52.00%", "$5",    "\u00A05"}) {
    EXPECT_FALSE(IsNumeric(text)) << text;
  }
  EXPECT_FALSE(IsNumeric(std::string_view("5\0", 2)));
}

TEST(ToDouble, ReadsANumberWithBlanksAround) {
  EXPECT_EQ(ToDouble(" 1.25 "), 1.25);
  EXPECT_EQ(ToDouble("+1E-2"), 0.01);
  EXPECT_EQ(ToDouble("1E-999"), 0);
  EXPECT_EQ(ToDouble("1e-999"), 0);
  EXPECT_EQ(ToDouble("1.7976931348623157E308"), std::numeric_limits<double>::max());
}

TEST(ToDouble, ReportsWhatIsNoNumberAndWhatIsTooLarge) {
  EXPECT_EQ(ErrorOf([] { ToDouble(""); }), 13);
  EXPECT_EQ(ErrorOf([] { ToDouble("12abc"); }), 13);
  EXPECT_EQ(ErrorOf([] { ToDouble("inf"); }), 13);
  EXPECT_EQ(ErrorOf([] { ToDouble("1E309"); }), 6);
  EXPECT_EQ(ErrorOf([] { ToDouble("-1E309"); }), 6);
}

TEST(ToSingle, ReadsUpToTheLargestFloat) {
  EXPECT_EQ(ToSingle(" .5"), 0.5F);
  EXPECT_EQ(ToSingle("3.402823E+38"), 3.402823E+38F);
  EXPECT_EQ(ToSingle("3.4028234663852886E+38"), std::numeric_limits<float>::max());
  EXPECT_EQ(ErrorOf([] { ToSingle("3.403E+38"); }), 6);
  EXPECT_EQ(ErrorOf([] { ToSingle("3.5E+38"); }), 6);
  EXPECT_EQ(ErrorOf([] { ToSingle("-3.5E+38"); }), 6);
  EXPECT_EQ(ErrorOf([] { ToSingle("x"); }), 13);
}

TEST(ToInt32, RoundsTiesToEven) {
  EXPECT_EQ(ToInt32("2.5"), 2);
  EXPECT_EQ(ToInt32("3.5"), 4);
  EXPECT_EQ(ToInt32("-2.5"), -2);
  EXPECT_EQ(ToInt32("0.5"), 0);
  EXPECT_EQ(ToInt32("2.51"), 3);
  EXPECT_EQ(ToInt32(" 42 "), 42);
}

TEST(ToInt32, ReportsWhatDoesNotFitAfterRounding) {
  EXPECT_EQ(ToInt32("2147483647.4"), 2147483647);
  EXPECT_EQ(ToInt32("-2147483648.5"), std::numeric_limits<std::int32_t>::min());
  EXPECT_EQ(ErrorOf([] { ToInt32("2147483647.5"); }), 6);
  EXPECT_EQ(ErrorOf([] { ToInt32("-2147483649"); }), 6);
  EXPECT_EQ(ErrorOf([] { ToInt32("1E999"); }), 6);
  EXPECT_EQ(ErrorOf([] { ToInt32(""); }), 13);
  EXPECT_EQ(ErrorOf([] { ToInt32("1x"); }), 13);
}

TEST(ToInt16, HasTheRangeOfSixteenBits) {
  EXPECT_EQ(ToInt16("32767.4"), 32767);
  EXPECT_EQ(ToInt16("-32768.5"), -32768);
  EXPECT_EQ(ErrorOf([] { ToInt16("32767.5"); }), 6);
  EXPECT_EQ(ErrorOf([] { ToInt16("-32769"); }), 6);
  EXPECT_EQ(ErrorOf([] { ToInt16("a"); }), 13);
}

TEST(ToByte, HasTheRangeOfEightBits) {
  EXPECT_EQ(ToByte("255.4"), 255);
  EXPECT_EQ(ToByte("-.5"), 0);
  EXPECT_EQ(ErrorOf([] { ToByte("255.5"); }), 6);
  EXPECT_EQ(ErrorOf([] { ToByte("-1"); }), 6);
  EXPECT_EQ(ErrorOf([] { ToByte("a"); }), 13);
}

TEST(RoundToInt32, RoundsTiesToEven) {
  EXPECT_EQ(RoundToInt32(2.5L), 2);
  EXPECT_EQ(RoundToInt32(3.5L), 4);
  EXPECT_EQ(RoundToInt32(-2.5L), -2);
  EXPECT_EQ(RoundToInt32(-0.5L), 0);
  EXPECT_EQ(RoundToInt32(0.5L), 0);
  EXPECT_EQ(RoundToInt32(0.51L), 1);
}

TEST(RoundToInt32, ReportsWhatDoesNotFit) {
  EXPECT_EQ(RoundToInt32(2147483647.25L), 2147483647);
  EXPECT_EQ(ErrorOf([] { RoundToInt32(2147483647.5L); }), 6);
  EXPECT_EQ(RoundToInt32(-2147483648.5L), std::numeric_limits<std::int32_t>::min());
  EXPECT_EQ(ErrorOf([] { RoundToInt32(-2147483648.75L); }), 6);
  EXPECT_EQ(ErrorOf([] { RoundToInt32(Infinity); }), 6);
  EXPECT_EQ(ErrorOf([] { RoundToInt32(NotANumber); }), 6);
}

TEST(Round2, TakesTiesToTheEvenHundredth) {
  EXPECT_EQ(Round2(0.125), 0.12);
  EXPECT_EQ(Round2(0.375), 0.38);
  EXPECT_EQ(Round2(-0.125), -0.12);
  EXPECT_EQ(Round2(12.346), 12.35);
  EXPECT_EQ(Round2(12.0), 12.0);
}

TEST(Round2, SeesTheProductInDoublePrecision) {
  // Both doubles are a little below the decimals; times 100 they give 111.5 and 100.49999999999999.
  EXPECT_EQ(Round2(1.115), 1.12);
  EXPECT_EQ(Round2(1.005), 1.0);
}

TEST(FormatPercent, ShowsTwoDecimals) {
  EXPECT_EQ(FormatPercent(0.5), "50.00%");
  EXPECT_EQ(FormatPercent(-0.5), "-50.00%");
  EXPECT_EQ(FormatPercent(0.52), "52.00%");
  EXPECT_EQ(FormatPercent(1), "100.00%");
  EXPECT_EQ(FormatPercent(0.01), "1.00%");
  EXPECT_EQ(FormatPercent(0.0001), "0.01%");
  EXPECT_EQ(FormatPercent(0.055), "5.50%");
  EXPECT_EQ(FormatPercent(12345.678), "1234567.80%");
  EXPECT_EQ(FormatPercent(-0.1), "-10.00%");
  EXPECT_EQ(FormatPercent(-0.1F), "-10.00%");
  EXPECT_EQ(FormatPercent(-0.01), "-1.00%");
  EXPECT_EQ(FormatPercent(-0.001), "-0.10%");
  EXPECT_EQ(FormatPercent(-1.1), "-110.00%");
  EXPECT_EQ(FormatPercent(-12345.678), "-1234567.80%");
  EXPECT_EQ(FormatPercent(1E20), "10000000000000000000000.00%");
  EXPECT_EQ(FormatPercent(1152921504606846976.0), "115292150460684697600.00%");
  EXPECT_EQ(FormatPercent(-1152921504606846976.0), "-115292150460684697600.00%");
}

TEST(FormatPercent, RoundsAnExactTieAwayFromZero) {
  EXPECT_EQ(FormatPercent(0.03125), "3.13%");
  EXPECT_EQ(FormatPercent(-0.03125), "-3.13%");
  EXPECT_EQ(FormatPercent(0.28125), "28.13%");
  EXPECT_EQ(FormatPercent(0.15625), "15.63%");
  EXPECT_EQ(FormatPercent(0.96875), "96.88%");
}

TEST(FormatPercent, RoundsTheExactValueAndNotAProduct) {
  // A little above 0.00125, a little below 0.00115, and one that times 100 gives exactly the tie 1.005 in
  // double precision.
  EXPECT_EQ(FormatPercent(0.00125), "0.13%");
  EXPECT_EQ(FormatPercent(0.00115), "0.11%");
  EXPECT_EQ(FormatPercent(0.01005), "1.00%");
}

TEST(FormatPercent, GivesZeroNoSign) {
  EXPECT_EQ(FormatPercent(0), "0.00%");
  EXPECT_EQ(FormatPercent(-0.0), "0.00%");
  EXPECT_EQ(FormatPercent(-0.00001), "0.00%");
}

TEST(FormatPercent, RefusesWhatIsNoFiniteNumber) {
  EXPECT_EQ(ErrorOf([] { FormatPercent(Infinity); }), 6);
  EXPECT_EQ(ErrorOf([] { FormatPercent(NotANumber); }), 6);
}

TEST(FormatFixed, RoundsAnExactTieAwayFromZero) {
  EXPECT_EQ(FormatFixed(0.125, 2), "0.13");
  EXPECT_EQ(FormatFixed(-0.125, 2), "-0.13");
  EXPECT_EQ(FormatFixed(0.375, 2), "0.38");
  EXPECT_EQ(FormatFixed(2.5, 0), "3");
  EXPECT_EQ(FormatFixed(0.5, 0), "1");
  EXPECT_EQ(FormatFixed(-0.5, 0), "-1");
  EXPECT_EQ(FormatFixed(0.25, 1), "0.3");
}

TEST(FormatFixed, CarriesATieOverNines) {
  EXPECT_EQ(FormatFixed(9.5, 0), "10");
  EXPECT_EQ(FormatFixed(-999.5, 0), "-1000");
  EXPECT_EQ(FormatFixed(1.875, 2), "1.88");
  EXPECT_EQ(FormatFixed(199.5, 0), "200");
}

TEST(FormatFixed, RoundsATieOfALargeNumberByNoMoreThanHalfADecimal) {
  EXPECT_EQ(FormatFixed(883781414077969.375, 2), "883781414077969.38");
  EXPECT_EQ(FormatFixed(-883781414077969.125, 2), "-883781414077969.13");
  EXPECT_EQ(FormatFixed(4503599627370495.5, 0), "4503599627370496");
}

TEST(FormatFixed, RoundsTheExactValueOfOtherNumbers) {
  EXPECT_EQ(FormatFixed(1.005, 2), "1.00");
  EXPECT_EQ(FormatFixed(1.115, 2), "1.11");
  EXPECT_EQ(FormatFixed(0.1249999, 2), "0.12");
  EXPECT_EQ(FormatFixed(12, 2), "12.00");
  EXPECT_EQ(FormatFixed(-0.001, 2), "0.00");
}

TEST(FormatFixed, HoldsTheLargestNumberAndManyDecimals) {
  const std::string largest = FormatFixed(std::numeric_limits<double>::max(), 2);
  EXPECT_EQ(largest.size(), 309 + 3);
  EXPECT_TRUE(largest.starts_with("179769313486231570814527423731704356798070"));
  EXPECT_EQ(FormatFixed(-0.5, 30), "-0.500000000000000000000000000000");
  EXPECT_EQ(FormatFixed(0.1, 30), "0.100000000000000005551115123126");
}

TEST(RunTime, IsShownInHoursAndMinutesEachInTheNumberForm) {
  EXPECT_EQ(RunTimeText(125), " 2H  5M");
  EXPECT_EQ(RunTimeText(0), " 0H  0M");
  EXPECT_EQ(RunTimeText(59), " 0H  59M");
  EXPECT_EQ(RunTimeText(6000), " 100H  0M");
  EXPECT_EQ(RunTimeText(-61), "-1H -1M");
}

TEST(NumberOfDigits, IsThatOfDigitsAndNothingElse) {
  EXPECT_EQ(NumberOfDigits("0"), 0);
  EXPECT_EQ(NumberOfDigits("07"), 7);
  EXPECT_EQ(NumberOfDigits("32767"), 32767);
  for (const char* text : {"", "32768", "99999999999", "-1", "+1", " 1", "1 ", "1.0", "1E2", "x", "1x"}) {
    EXPECT_EQ(NumberOfDigits(text), std::nullopt) << text;
  }
}

}  // namespace
