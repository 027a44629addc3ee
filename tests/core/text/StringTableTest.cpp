#include "core/text/StringTable.h"

#include <gtest/gtest.h>

#include <algorithm>
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
  for (const int number : {-1, 0, 100, 219, 100000}) {
    try {
      texts.Text(number);
      ADD_FAILURE() << number;
    } catch (const RuntimeError& error) {
      EXPECT_EQ(error.Number(), 9);
    }
  }
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
