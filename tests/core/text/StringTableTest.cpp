#include "core/text/StringTable.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <string>

#include "core/text/TextEncoding.h"
#include "platform/RuntimeError.h"

namespace {

TEST(StringTable, GivesEnglishTextsToTheLetter) {
  const StringTable texts(Language::English);
  EXPECT_EQ(texts.TextLanguage(), Language::English);
  EXPECT_EQ(texts.Text(101), "Could not locate selected Mission in Mission Database");
  EXPECT_EQ(texts.Text(109), "W.I.A.");
  EXPECT_EQ(texts.Text(127), "Error occured in transmission, please try again.");
  EXPECT_EQ(texts.Text(148),
            "Hold the mouse over an objective to  see a description of what the objective is.");
  EXPECT_EQ(texts.Text(192), "Primary  Objective");
  EXPECT_EQ(texts.Text(218), "About");
}

TEST(StringTable, KeepsATrailingBlank) {
  EXPECT_EQ(
      StringTable(Language::English).Text(169),
      "These values determine how the value of Soldiering is calculated.  For every point of each quantity "
      "listed on the left, the number inside the corresponding box will be multiplied by the count of that "
      "quantity and then added to the soldiering value. ");
}

TEST(StringTable, HasEveryTextInBothLanguages) {
  const StringTable english(Language::English);
  const StringTable chinese(Language::SimplifiedChinese);
  EXPECT_EQ(chinese.TextLanguage(), Language::SimplifiedChinese);
  int different = 0;
  for (int number = StringTable::FirstText; number <= StringTable::LastText; ++number) {
    EXPECT_FALSE(english.Text(number).empty()) << number;
    EXPECT_FALSE(chinese.Text(number).empty()) << number;
    EXPECT_TRUE(IsUtf8(chinese.Text(number))) << number;
    different += english.Text(number) != chinese.Text(number) ? 1 : 0;
  }
  EXPECT_GT(different, 100);
  EXPECT_EQ(chinese.Text(114), "红队");
}

TEST(StringTable, HasTeamNamesByWhichPlayerTextsCanBeParsed) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable texts(language);
    for (int number = 114; number <= 116; ++number) {
      EXPECT_EQ(texts.Text(number).find_first_of(" :"), std::string::npos) << number;
    }
    EXPECT_NE(texts.Text(114), texts.Text(115));
    EXPECT_NE(texts.Text(115), texts.Text(116));
    EXPECT_NE(texts.Text(114), texts.Text(116));
  }
}

TEST(StringTable, ReportsANumberOutsideTheTable) {
  const StringTable texts(Language::English);
  for (const int number : {-1, 0, 100, 219, 300, 349, 100000}) {
    try {
      texts.Text(number);
      ADD_FAILURE() << number;
    } catch (const RuntimeError& error) {
      EXPECT_EQ(error.Number(), 9);
    }
  }
}

struct NamedText {
  OwnText Text;
  const char* Name;
};

constexpr NamedText OwnTexts[] = {
#define OWN_TEXT(number, name, english, simplifiedChinese) {OwnText::name, #name},
#include "resources/StringTable.inc"
};

/// The placeholders in a text, "%1%2", each once, ascending.
std::string PlacesIn(const std::string& text) {
  std::string places;
  for (char digit = '0'; digit <= '9'; ++digit) {
    const std::string place{'%', digit};
    places += text.find(place) != std::string::npos ? place : "";
  }
  return places;
}

TEST(StringTable, HasEveryTextOfItsOwnInBothLanguages) {
  const StringTable english(Language::English);
  const StringTable chinese(Language::SimplifiedChinese);
  ASSERT_GE(std::size(OwnTexts), 20U);
  for (const NamedText& own : OwnTexts) {
    EXPECT_GE(static_cast<int>(own.Text), 301) << own.Name;
    EXPECT_FALSE(english.Text(own.Text).empty()) << own.Name;
    EXPECT_FALSE(IsUtf8(chinese.Text(own.Text)) &&
                 CharacterCount(chinese.Text(own.Text)) == chinese.Text(own.Text).size())
        << own.Name << " has no character of its language";
    EXPECT_TRUE(IsUtf8(chinese.Text(own.Text))) << own.Name;
  }
}

TEST(StringTable, HasTheSamePlacesForValuesInBothLanguages) {
  const StringTable english(Language::English);
  const StringTable chinese(Language::SimplifiedChinese);
  for (const NamedText& own : OwnTexts) {
    const std::string places = PlacesIn(english.Text(own.Text));
    EXPECT_EQ(PlacesIn(chinese.Text(own.Text)), places) << own.Name;
    EXPECT_EQ(places, std::string("%1%2%3%4%5%6%7%8%9").substr(0, places.size())) << own.Name;
  }
}

TEST(StringTable, GivesATextOfItsOwnByNameAndNumber) {
  EXPECT_EQ(StringTable(Language::English).Text(OwnText::Copy), "Copy");
  EXPECT_EQ(StringTable(Language::SimplifiedChinese).Text(OwnText::Copy), "复制");
  EXPECT_EQ(StringTable(Language::English).Text(302), "Stop");
}

TEST(LanguageOf, IsChineseForEveryChineseLocale) {
  for (const char* name : {"zh", "zh_CN", "zh-Hans", "ZH", "Zh_cn.UTF-8", "zh_TW"}) {
    EXPECT_EQ(LanguageOf(name), Language::SimplifiedChinese) << name;
  }
}

TEST(LanguageOf, IsEnglishForAllOthers) {
  for (const char* name : {"", "C", "z", "en_US", "de_DE.UTF-8", "ja", "hz", "C.UTF-8", "xzh"}) {
    EXPECT_EQ(LanguageOf(name), Language::English) << name;
  }
}

TEST(Language, HasTheNumbersOfTheSystem) {
  EXPECT_EQ(static_cast<int>(Language::English), 1033);
  EXPECT_EQ(static_cast<int>(Language::SimplifiedChinese), 2052);
}

}  // namespace
