#include "platform/jet/JetText.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using namespace std::string_literals;

struct TextCase {
  std::string Bytes;
  std::string Utf8;
  bool Whole;
};

void ExpectAll(const std::vector<TextCase>& cases) {
  for (const TextCase& one : cases) {
    const JetText text = DecodeJetText(one.Bytes);
    EXPECT_EQ(text.Utf8, one.Utf8);
    EXPECT_EQ(text.Whole, one.Whole) << one.Utf8;
  }
}

TEST(JetText, IsUtf16) {
  ExpectAll({{"", "", true},
             {"A\0d\0a\0"s, "Ada", true},
             {"\xC9\0"s, "É", true},
             {"\x6C\x9A", "马", true},
             {"\xFF\xFF"s, "\uFFFF", true}});
}

TEST(JetText, HoldsCharactersBeyondTheBasicPlane) {
  ExpectAll({{"\x3D\xD8\0\xDE"s, "\U0001F600", true},
             {"A\0\x40\xD8\0\xDC"
              "B\0"s,
              "A\U00020000B", true},
             {"\xFF\xDB\xFF\xDF", "\U0010FFFF", true}});
}

TEST(JetText, GoesOnBehindAZeroCharacter) {
  ExpectAll({{"A\0\0\0B\0"s, "A\0B"s, true}});
}

TEST(JetText, IsNotWholeWithHalfACharacter) {
  ExpectAll({{"\x3D\xD8"s, "\uFFFD", false},
             {"\x3D\xD8"
              "A\0"s,
              "\uFFFDA", false},
             {"\0\xDE"s, "\uFFFD", false},
             {"\x3D\xD8\x3D\xD8\0\xDE"s, "\uFFFD\U0001F600", false},
             {"A\0B"s, "A\uFFFD", false}});
}

TEST(JetText, IsCompressedBehindItsMark) {
  ExpectAll({{"\xFF\xFE"s, "", true},
             {"\xFF\xFE"
              "Ada"s,
              "Ada", true},
             {"\xFF\xFE"
              "caf\xE9"s,
              "café", true},
             {"\xFF\xFE"
              "A\0\x6C\x9A\0B"s,
              "A马B", true},
             {"\xFF\xFE\0\x3D\xD8\0"s, "\uFFFD", false},
             {"\xFF\xFE\0\x6C"s, "\uFFFD", false}});
}

}  // namespace
