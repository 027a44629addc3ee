#include "audience/AudienceWindow.h"

#include <gtest/gtest.h>

namespace {

constexpr double UsualInches = 40;

TEST(DiagonalOfAScreen, IsThatOfItsSides) {
  EXPECT_NEAR(DiagonalOf(QSizeF(1218, 685)), 55, 0.1);
  EXPECT_NEAR(DiagonalOf(QSizeF(509, 286)), 23, 0.1);
  EXPECT_NEAR(DiagonalOf(QSizeF(1602, 901)), 72.4, 0.1);
}

TEST(DiagonalOfAScreen, IsTheUsualOneWhereAScreenDoesNotKnowIt) {
  for (const QSizeF& sides :
       {QSizeF(0, 0), QSizeF(160, 90), QSizeF(16, 9), QSizeF(1600, 900), QSizeF(65535, 65535)}) {
    EXPECT_EQ(DiagonalOf(sides), UsualInches) << sides.width();
  }
}

}  // namespace
