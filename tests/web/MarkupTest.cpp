#include "web/Markup.h"

#include <gtest/gtest.h>

namespace {

TEST(EscapedText, HoldsNoMarkupOfItsOwn) {
  EXPECT_EQ(Escaped(R"(<script>alert("1")</script> & 'x')"),
            "&lt;script&gt;alert(&quot;1&quot;)&lt;/script&gt; &amp; &#39;x&#39;");
}

TEST(EscapedText, KeepsLettersOfAllScripts) {
  EXPECT_EQ(Escaped("Zoë 蓝队 שלום 🎯"), "Zoë 蓝队 שלום 🎯");
}

TEST(EscapedText, LosesMarksThatTurnTheDirection) {
  EXPECT_EQ(Escaped("a\u202Eb\u2066c\u200Fd\u061Ce\u2029f"), "abcdef");
}

TEST(EscapedText, LosesControlsAndWhatIsNoCharacter) {
  using namespace std::string_view_literals;
  EXPECT_EQ(Escaped("a\0b\x1B"
                    "c\x7F"
                    "d\u0085\uFEFF\uFFFE\xFF\xC3"sv),
            "abcd");
}

TEST(EscapedText, HasBlanksForTabsAndEndsOfLines) {
  EXPECT_EQ(Escaped("a\tb\nc\rd"), "a b c d");
}

TEST(EscapedText, CanBeLong) {
  EXPECT_EQ(Escaped(std::string(10'000, '<')).size(), 40'000U);
}

TEST(IsolatedText, StandsInAnElementThatKeepsItsDirection) {
  EXPECT_EQ(Isolated("א<"), "<bdi>א&lt;</bdi>");
}

}  // namespace
