#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <string>
#include <string_view>

namespace {

struct Text {
  int Number;
  std::string_view English;
  std::string_view Chinese;
};

constexpr auto Texts = std::to_array<Text>({
#define TEXT(number, english, chinese) {number, english, chinese},
#include "resources/StringTable.inc"
#undef TEXT
});

const Text& TextOf(int number) {
  const auto* found =
      std::find_if(Texts.begin(), Texts.end(), [&](const Text& t) { return t.Number == number; });
  EXPECT_NE(found, Texts.end()) << number;
  return found != Texts.end() ? *found : Texts.front();
}

bool HasHanCharacter(std::string_view text) {
  // In UTF-8, U+4E00 to U+9FFF begin with a byte from E4 to E9.
  return std::any_of(text.begin(), text.end(), [](char c) {
    const auto byte = static_cast<unsigned char>(c);
    return byte >= 0xE4 && byte <= 0xE9;
  });
}

TEST(StringTableTexts, RunFrom101To218WithoutGapsOrDoubles) {
  ASSERT_EQ(Texts.size(), 118U);
  for (std::size_t i = 0; i < Texts.size(); ++i) {
    EXPECT_EQ(Texts[i].Number, 101 + static_cast<int>(i));
  }
}

TEST(StringTableTexts, AreCompleteInBothLanguages) {
  for (const Text& text : Texts) {
    EXPECT_FALSE(text.English.empty()) << text.Number;
    EXPECT_TRUE(std::all_of(text.English.begin(), text.English.end(), [](char c) {
      return c >= ' ' && c <= '~';
    })) << text.Number;
    EXPECT_TRUE(HasHanCharacter(text.Chinese)) << text.Number;
  }
}

TEST(StringTableTexts, HoldNoAccessKeysOrPlaceholders) {
  for (const Text& text : Texts) {
    EXPECT_EQ(text.English.find_first_of("&%"), std::string_view::npos) << text.Number;
    EXPECT_EQ(text.Chinese.find_first_of("&%"), std::string_view::npos) << text.Number;
  }
}

TEST(StringTableTexts, TeamNamesHoldNeitherBlankNorColon) {
  for (const int number : {114, 115, 116}) {
    EXPECT_EQ(TextOf(number).English.find_first_of(" :"), std::string_view::npos) << number;
    EXPECT_EQ(TextOf(number).Chinese.find_first_of(" :"), std::string_view::npos) << number;
    EXPECT_EQ(TextOf(number).Chinese.find("："), std::string_view::npos) << number;
    EXPECT_EQ(TextOf(number).Chinese.find("　"), std::string_view::npos) << number;
  }
}

TEST(StringTableTexts, TeamNamesDiffer) {
  EXPECT_NE(TextOf(114).Chinese, TextOf(115).Chinese);
  EXPECT_NE(TextOf(115).Chinese, TextOf(116).Chinese);
  EXPECT_NE(TextOf(114).Chinese, TextOf(116).Chinese);
}

TEST(StringTableTexts, DescriptionLimitReads1000InEnglishAnd500InChinese) {
  EXPECT_EQ(TextOf(175).English,
            "Mission Description is too long, maximum is 1000 characters. Save aborted.");
  EXPECT_NE(TextOf(175).Chinese.find("500"), std::string_view::npos);
  EXPECT_EQ(TextOf(175).Chinese.find("1000"), std::string_view::npos);
}

TEST(StringTableTexts, KeepTheirBlanksAndSpellings) {
  EXPECT_EQ(TextOf(127).English, "Error occured in transmission, please try again.");
  EXPECT_EQ(TextOf(148).English,
            "Hold the mouse over an objective to  see a description of what the objective is.");
  EXPECT_EQ(TextOf(192).English, "Primary  Objective");
  EXPECT_EQ(
      TextOf(169).English,
      "These values determine how the value of Soldiering is calculated.  For every point of each quantity "
      "listed on the left, the number inside the corresponding box will be multiplied by the count of that "
      "quantity and then added to the soldiering value. ");
}

TEST(StringTableTexts, OneEnglishTextHasOneChineseText) {
  for (const Text& a : Texts) {
    for (const Text& b : Texts) {
      if (a.English == b.English) {
        EXPECT_EQ(a.Chinese, b.Chinese) << a.Number << " and " << b.Number;
      }
    }
  }
}

}  // namespace
