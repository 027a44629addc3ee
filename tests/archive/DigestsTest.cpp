#include "archive/Digests.h"

#include <gtest/gtest.h>

#include <set>

namespace {

// Published examples of both functions.
TEST(Digests, AreThoseOfTheKnownFunctions) {
  EXPECT_EQ(Sha256("abc"), "ba7816bf8f01cfea414140de5dae2223b00361a396177a9cb410ff61f20015ad");
  EXPECT_EQ(Sha256(""), "e3b0c44298fc1c149afbf4c8996fb92427ae41e4649b934ca495991b7852b855");
  EXPECT_EQ(KeyedDigest("Jefe", "what do ya want for nothing?"),
            "5bdcc146bf60754e6a042426089575c75a003f089d2739839dec58b964ec3843");
}

TEST(Digests, DependOnTheKey) {
  EXPECT_NE(KeyedDigest("a", "Bo Ray"), KeyedDigest("b", "Bo Ray"));
}

TEST(RandomKeys, AreLongAndNeverTheSame) {
  std::set<std::string> keys;
  for (int i = 0; i < 100; ++i) {
    const std::string key = RandomKey();
    EXPECT_EQ(key.size(), 64U);
    EXPECT_EQ(key.find_first_not_of("0123456789abcdef"), std::string::npos);
    keys.insert(key);
  }
  EXPECT_EQ(keys.size(), 100U);
}

}  // namespace
