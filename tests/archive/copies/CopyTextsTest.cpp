#include "archive/copies/CopyTexts.h"

#include <gtest/gtest.h>

namespace {

TEST(CopyTexts, TellTheDifferenceInWords) {
  const StringTable english(Language::English);
  EXPECT_EQ(DifferenceText(12, 0, english), "12 rows more");
  EXPECT_EQ(DifferenceText(5, 4, english), "1 row more");
  EXPECT_EQ(DifferenceText(4, 4, english), "as many rows");
  EXPECT_EQ(DifferenceText(4, 5, english), "1 row fewer");
  EXPECT_EQ(DifferenceText(0, 30, english), "30 rows fewer");
  EXPECT_EQ(DifferenceText(0, 30, StringTable(Language::SimplifiedChinese)), "少 30 行");
}

TEST(CopyTexts, TellEachReasonAndStepOtherwise) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable strings(language);
    EXPECT_NE(TextOf(CopyKind::FirstChange, strings), TextOf(CopyKind::ByHand, strings));
    EXPECT_NE(TextOf(CopyKind::ByHand, strings), TextOf(CopyKind::BeforeRestore, strings));
    EXPECT_NE(TextOf(CopyKind::BeforeRestore, strings), TextOf(CopyKind::Weekly, strings));
    EXPECT_NE(TextOf(CopyKind::FirstChange, strings), TextOf(CopyKind::Weekly, strings));
    EXPECT_NE(TextOf(CopyStep::Checking, strings), TextOf(CopyStep::KeepingPresent, strings));
    EXPECT_NE(TextOf(CopyStep::KeepingPresent, strings), TextOf(CopyStep::Copying, strings));
  }
}

}  // namespace
