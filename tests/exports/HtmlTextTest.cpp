#include "exports/HtmlText.h"

#include <gtest/gtest.h>

namespace {

constexpr const char* Replaced = "\xEF\xBF\xBD";

TEST(TextInAPage, HasNoMarkup) {
  EXPECT_EQ(HtmlText("<b>Tom & \"Jerry\"</b> 'x'"),
            "&lt;b&gt;Tom &amp; &quot;Jerry&quot;&lt;/b&gt; &#39;x&#39;");
  EXPECT_EQ(HtmlText("&amp;"), "&amp;amp;");
}

TEST(TextInAPage, KeepsLettersOfAllKinds) {
  const std::string text = "\xC3\xA9\xE5\xA4\x9C\xF0\x9F\x98\x80\xC2\xA0";
  EXPECT_EQ(HtmlText(text), text);
  EXPECT_EQ(HtmlText(""), "");
}

TEST(TextInAPage, IsOneLine) {
  EXPECT_EQ(HtmlText("a\tb\r\nc"), "a b  c");
}

TEST(TextInAPage, HoldsNothingThatAPageMayNotHold) {
  for (const char* bad : {"\x01", "\x1F", "\x7F", "\xC2\x80", "\xC2\x9F", "\xEF\xB7\x90", "\xEF\xB7\xAF",
                          "\xEF\xBF\xBE", "\xEF\xBF\xBF", "\xF4\x8F\xBF\xBF", "\xE9", "\xFF"}) {
    EXPECT_EQ(HtmlText(std::string("a") + bad + "b"), std::string("a") + Replaced + "b") << bad;
  }
  EXPECT_EQ(HtmlText(std::string("\0", 1)), Replaced);
  EXPECT_EQ(HtmlText("\xE2\x82"), std::string(Replaced) + Replaced);  // cut within a character
  EXPECT_EQ(HtmlText("\xEF\xB7\x8F"), "\xEF\xB7\x8F");                // next to those
}

TEST(TextInAPage, KeepsNamesFromTurningTheirSurroundings) {
  EXPECT_EQ(HtmlName("\xE2\x80\xAE<a>"), "<bdi>\xE2\x80\xAE&lt;a&gt;</bdi>");
}

}  // namespace
