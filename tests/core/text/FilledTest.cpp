#include "core/text/Filled.h"

#include <gtest/gtest.h>

namespace {

TEST(Filled, PutsEachValueInItsPlaceWhateverTheOrder) {
  EXPECT_EQ(Filled("Sheet %1 of %2", {"3", "40"}), "Sheet 3 of 40");
  EXPECT_EQ(Filled("%2 / %1", {"3", "40"}), "40 / 3");
  EXPECT_EQ(Filled("%1, %1%1", {"ab"}), "ab, abab");
}

TEST(Filled, TakesAValueAsItStands) {
  EXPECT_EQ(Filled("%1: %2", {"/a%2/%1", "100%"}), "/a%2/%1: 100%");
}

TEST(Filled, LeavesWhatIsNoPlaceOrHasNoValue) {
  EXPECT_EQ(Filled("50 % of %0 and %2%", {"x"}), "50 % of %0 and %2%");
  EXPECT_EQ(Filled("", {"x"}), "");
  EXPECT_EQ(Filled("%9", {"x"}), "%9");
}

TEST(Filled, KeepsLettersOfOtherLanguagesWhole) {
  EXPECT_EQ(Filled("第 %1 张，共 %2 张", {"一", "二"}), "第 一 张，共 二 张");
}

}  // namespace
