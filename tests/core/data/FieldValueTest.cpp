#include "core/data/FieldValue.h"

#include <gtest/gtest.h>

#include <limits>

#include "tests/support/Thrown.h"

namespace {

TEST(TextOf, GivesTextsAndPlainNumbers) {
  EXPECT_EQ(TextOf(std::string("Mole")), "Mole");
  EXPECT_EQ(TextOf(Value()), "");
  EXPECT_EQ(TextOf(std::int64_t{-7}), "-7");
  EXPECT_EQ(TextOf(12.5), "12.5");
  EXPECT_EQ(TextOf(-0.5), "-.5");
  EXPECT_EQ(TextOf(0.0), "0");
  EXPECT_EQ(TextOf(std::numeric_limits<std::int64_t>::min()), "-9223372036854775808");
  EXPECT_EQ(TextOf(std::string()), "");
}

TEST(TextOf, RefusesBytesWith13) {
  EXPECT_EQ(NumberThrownBy([] { TextOf(Blob{1}); }), 13);
}

TEST(NumberOf, TakesNumbersTextsAndNull) {
  EXPECT_EQ(NumberOf(std::int64_t{7}), 7);
  EXPECT_EQ(NumberOf(-2.5), -2.5);
  EXPECT_EQ(NumberOf(std::string(" 25 ")), 25);
  EXPECT_EQ(NumberOf(Value()), 0);
}

TEST(NumberOf, RefusesOtherTextsAndBytesWith13) {
  EXPECT_EQ(NumberThrownBy([] { NumberOf(std::string("abc")); }), 13);
  EXPECT_EQ(NumberThrownBy([] { NumberOf(std::string()); }), 13);
  EXPECT_EQ(NumberThrownBy([] { NumberOf(Blob{1}); }), 13);
}

}  // namespace
