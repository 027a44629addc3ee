#include "core/game/DallasId.h"

#include <gtest/gtest.h>

namespace {

TEST(DallasId, BeginsWithTheCheckByteAndEndsWithTheFamily) {
  EXPECT_EQ(DallasIdOf({0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF}), "EFCDAB8967452301");
}

TEST(DallasId, HasTwoDigitsForEachByte) {
  EXPECT_EQ(DallasIdOf({0x0A, 0x00, 0x0F, 0x10, 0x01, 0x09, 0xA0, 0xFF}), "FFA00901100F000A");
}

TEST(DallasId, StandsForNoButtonWhenAllBytesAreZero) {
  EXPECT_EQ(DallasIdOf({}), NoDallasId);
}

}  // namespace
