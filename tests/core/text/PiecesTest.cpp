#include "core/text/Pieces.h"

#include <gtest/gtest.h>

#include "platform/Letters.h"

namespace {

TEST(Trimmed, LosesTheBlanksThatAreMeantAtBothEnds) {
  EXPECT_EQ(Trimmed(" \t a b \t", IsBlank), "a b");
  EXPECT_EQ(Trimmed("\r\n x\v\f", IsWhiteSpace), "x");
  EXPECT_EQ(Trimmed("\r\n x\n", IsBlank), "\r\n x\n");
  EXPECT_EQ(Trimmed("", IsBlank), "");
  EXPECT_EQ(Trimmed("  ", IsBlank), "");
}

TEST(FirstLineOf, EndsBeforeTheFirstLineBreak) {
  EXPECT_EQ(FirstLineOf("one\r\ntwo\r\nthree"), "one");
  EXPECT_EQ(FirstLineOf("\r\ntwo"), "");
}

TEST(FirstLineOf, IsAllOfATextWithoutOne) {
  EXPECT_EQ(FirstLineOf("one"), "one");
  EXPECT_EQ(FirstLineOf(""), "");
  EXPECT_EQ(FirstLineOf("one\ntwo\rthree"), "one\ntwo\rthree");
  EXPECT_EQ(FirstLineOf("one\r"), "one\r");
}

}  // namespace
