#include "core/text/TextEncoding.h"

#include <gtest/gtest.h>

#include "platform/Letters.h"

#include <string>

namespace {

TEST(IsUtf8, AcceptsWellFormedTexts) {
  for (const char* text : {"", "a", "plain text, longer than eight bytes", "Müller", "红队",
                           "\xF0\x9F\x98\x80", "\xC2\x80", "\xDF\xBF", "\xE0\xA0\x80", "\xED\x9F\xBF",
                           "\xEE\x80\x80", "\xEF\xBF\xBF", "\xF0\x90\x80\x80", "\xF4\x8F\xBF\xBF"}) {
    EXPECT_TRUE(IsUtf8(text)) << text;
  }
  EXPECT_TRUE(IsUtf8(std::string_view("a\0b", 3)));
}

TEST(IsUtf8, RefusesMalformedSequences) {
  for (const char* text : {"\x80", "\xBF", "\xC3", "\xC3(", "\xE2\x82", "\xE2\x82(", "\xF0\x9F\x98",
                           "\xF0\x9F\x98(",                                             // truncated
                           "\xC0\x80", "\xC1\xBF", "\xE0\x9F\xBF", "\xF0\x8F\xBF\xBF",  // overlong
                           "\xED\xA0\x80", "\xED\xBF\xBF",                              // surrogates
                           "\xF4\x90\x80\x80", "\xF5\x80\x80\x80", "\xFF", "\xFE"}) {
    EXPECT_FALSE(IsUtf8(text)) << text;
  }
}

TEST(IsUtf8, FindsAFaultAtEveryPlaceOfALongText) {
  for (std::size_t at = 0; at < 40; ++at) {
    std::string text(40, 'x');
    EXPECT_TRUE(IsUtf8(text));
    text[at] = '\xE9';
    EXPECT_FALSE(IsUtf8(text)) << at;
    EXPECT_TRUE(IsUtf8(text.replace(at, 1, "é"))) << at;
  }
}

TEST(Windows1252ToUtf8, TranslatesLettersAndPunctuation) {
  EXPECT_EQ(Windows1252ToUtf8("plain"), "plain");
  EXPECT_EQ(Windows1252ToUtf8("M\xFCller"), "Müller");
  EXPECT_EQ(Windows1252ToUtf8("\x80 \x93q\x94 \x99 \x9F \xA0 \xFF"), "€ “q” ™ Ÿ \xC2\xA0 ÿ");
}

TEST(Windows1252ToUtf8, KeepsUndefinedBytesAsControlCharacters) {
  EXPECT_EQ(Windows1252ToUtf8("\x81\x8D\x8F\x90\x9D"), "\xC2\x81\xC2\x8D\xC2\x8F\xC2\x90\xC2\x9D");
}

TEST(Windows1252ToUtf8, AlwaysGivesUtf8) {
  std::string all;
  for (int byte = 0; byte < 256; ++byte) {
    all += static_cast<char>(byte);
  }
  EXPECT_FALSE(IsUtf8(all));
  const std::string utf8 = Windows1252ToUtf8(all);
  EXPECT_TRUE(IsUtf8(utf8));
  EXPECT_EQ(utf8.substr(0, 128), all.substr(0, 128));
}

TEST(LowerAscii, TouchesAsciiLettersOnly) {
  EXPECT_EQ(LowerAscii('A'), 'a');
  EXPECT_EQ(LowerAscii('Z'), 'z');
  EXPECT_EQ(LowerAscii('['), '[');
  EXPECT_EQ(LowerAscii('@'), '@');
  EXPECT_EQ(LowerAscii('\xC4'), '\xC4');
}

}  // namespace
