#include <gtest/gtest.h>

#include <array>

#include "exports/Csv.h"
#include "platform/Utf8.h"

namespace {

constexpr std::array<CsvSeparator, 3> AllSeparators = {CsvSeparator::Comma, CsvSeparator::Semicolon,
                                                       CsvSeparator::Tab};

/// Writes `texts` as rows of two cells and expects that they are read back exactly.
void ExpectSame(const std::vector<std::string>& texts, CsvSeparator separator, bool byteOrderMark) {
  CsvWriter writer(separator, byteOrderMark);
  for (const std::string& text : texts) {
    writer.Text(text);
    writer.Text("x" + text);
    writer.EndRow();
  }
  const std::string bytes = writer.Take();
  CsvReader reader(bytes, separator);
  for (const std::string& text : texts) {
    ASSERT_TRUE(reader.Next()) << text;
    ASSERT_EQ(reader.Row().size(), 2U) << text;
    ASSERT_EQ(reader.Row()[0].Text, text);
    ASSERT_FALSE(reader.Row()[0].IsNull());
    ASSERT_EQ(reader.Row()[1].Text, "x" + text);
  }
  EXPECT_FALSE(reader.Next());
  EXPECT_FALSE(reader.Fault());
}

TEST(Csv, ReadsBackEveryCodePoint) {
  std::vector<std::string> texts;
  for (char32_t character = 0; character <= 0x10FFFF; ++character) {
    if (character >= 0xD800 && character <= 0xDFFF) {
      continue;
    }
    Utf8::Append(texts.emplace_back(), character);
  }
  ExpectSame(texts, CsvSeparator::Comma, false);
}

TEST(Csv, ReadsBackEveryTextOfThreeOddLetters) {
  const std::vector<std::string> letters = {"",   "'",  "\"",   "=", "-", "\t", "\r",       "\n",
                                            " ",  ",",  ";",    "a", "1", "王", "\xC2\xA0", "\xEF\xBB\xBF",
                                            "＝", "\v", "sep=", "+"};
  std::vector<std::string> texts;
  for (const std::string& first : letters) {
    for (const std::string& second : letters) {
      for (const std::string& third : letters) {
        texts.push_back(first + second + third);
      }
    }
  }
  for (const CsvSeparator separator : AllSeparators) {
    ExpectSame(texts, separator, false);
    ExpectSame(texts, separator, true);
  }
}

TEST(Csv, LeavesNoTextThatASpreadsheetWouldRun) {
  for (const std::string start : {"", " ", "\t", "\r", "\n", "\xC2\xA0", "\xE3\x80\x80", "\xEF\xBB\xBF"}) {
    for (const std::string sign : {"=", "+", "-", "@", "＝", "＋", "－", "＠"}) {
      EXPECT_TRUE(NeedsCsvGuard(start + sign + "1")) << start << sign;
      EXPECT_FALSE(NeedsCsvGuard("a" + start + sign)) << start << sign;
    }
  }
}

}  // namespace
