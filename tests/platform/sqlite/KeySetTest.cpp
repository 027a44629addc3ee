#include "platform/sqlite/KeySet.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <optional>

namespace {

TEST(KeySet, PutsItsFirstKeysInOrder) {
  const KeySet keys({9, 1, 5});
  ASSERT_EQ(keys.Size(), 3u);
  EXPECT_EQ(keys.At(0), 1);
  EXPECT_EQ(keys.At(1), 5);
  EXPECT_EQ(keys.At(2), 9);
}

TEST(KeySet, HoldsAKeyOnce) {
  const KeySet keys({5, 9, 5, 1, 9});
  ASSERT_EQ(keys.Size(), 3u);
  EXPECT_EQ(keys.At(1), 5);
  EXPECT_EQ(keys.PositionOf(9), 2u);
}

TEST(KeySet, FindsPositionsOfAscendingKeys) {
  const KeySet keys({-3, 1, 5});
  EXPECT_TRUE(keys.Ascending());
  EXPECT_EQ(keys.PositionOf(-3), 0u);
  EXPECT_EQ(keys.PositionOf(5), 2u);
  EXPECT_EQ(keys.PositionOf(4), std::nullopt);
  EXPECT_EQ(keys.PositionOf(6), std::nullopt);
  EXPECT_EQ(KeySet().PositionOf(1), std::nullopt);
}

TEST(KeySet, FindsPositionsOfKeysThatDoNotAscend) {
  KeySet keys({1, 5, 9});
  keys.Append(3);
  EXPECT_FALSE(keys.Ascending());
  EXPECT_EQ(keys.PositionOf(9), 2u);
  EXPECT_EQ(keys.PositionOf(3), 3u);
  EXPECT_EQ(keys.PositionOf(4), std::nullopt);
}

TEST(KeySet, FindsNewPositionsAfterEachChange) {
  KeySet keys({1, 5, 9});
  keys.Append(3);
  ASSERT_EQ(keys.PositionOf(3), 3u);
  keys.Erase(0);
  EXPECT_EQ(keys.PositionOf(1), std::nullopt);
  EXPECT_EQ(keys.PositionOf(3), 2u);
  keys.Append(2);
  EXPECT_EQ(keys.PositionOf(2), 3u);
}

}  // namespace
