#include "core/text/AltLetters.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;

TEST(AltLetters, AreTheFirstOfAWordWhereTheyAreFree) {
  EXPECT_THAT(WithAltLetters({"Save and Exit", "Cancel", "Clear", "Save"}),
              ElementsAre("&Save and Exit", "&Cancel", "C&lear", "S&ave"));
  EXPECT_THAT(WithAltLetters({"Primary Completed", "Primary Completed", "Primary Completed"}),
              ElementsAre("&Primary Completed", "Primary &Completed", "P&rimary Completed"));
}

TEST(AltLetters, ThatACaptionHasAreKeptAndNotGivenAgain) {
  EXPECT_THAT(WithAltLetters({"Yes", "&Year", "No"}), ElementsAre("Y&es", "&Year", "&No"));
  EXPECT_THAT(WithAltLetters({"Games", "Get"}, "GA"), ElementsAre("Ga&mes", "G&et"));
}

TEST(AltLetters, StandBehindCaptionsWithoutLatinLetters) {
  EXPECT_THAT(WithAltLetters({"保存", "姓名：", "转换……", "A 队"}, "b"),
              ElementsAre("保存(&C)", "姓名(&D)：", "转换(&E)……", "&A 队"));
}

TEST(AltLetters, AreNotAddedToSigns) {
  EXPECT_THAT(WithAltLetters({"|◀", "▶", "…", "▶ 播放"}), ElementsAre("|◀", "▶", "…", "▶ 播放(&A)"));
}

TEST(AltLetters, AreMissingWhereThereAreNoneLeft) {
  EXPECT_THAT(WithAltLetters({"OK", "KO", "O"}), ElementsAre("&OK", "&KO", "O"));
  EXPECT_THAT(WithAltLetters({"", "...", "fish && chips"}), ElementsAre("", "...", "fish && chips"));
  const std::vector<std::string> many(30, "队");
  const std::vector<std::string> given = WithAltLetters(many);
  EXPECT_EQ(given[25], "队(&Z)");
  EXPECT_EQ(given[26], "队");
}

}  // namespace
