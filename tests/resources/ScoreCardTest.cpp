#include <gtest/gtest.h>

#include <string>

#include "tests/resources/DefaultFile.h"

namespace {

/// `text` as the binary document format stores names: length and characters, 16 bits each, little-endian.
std::string StoredName(const std::string& text) {
  std::string stored = {static_cast<char>(text.size()), '\0'};
  for (const char c : text) {
    stored += c;
    stored += '\0';
  }
  return stored;
}

TEST(DefaultScoreCard, IsACompoundFileWithAWordDocument) {
  const std::string bytes = DefaultFileBytes("score_card_default.doc");
  EXPECT_EQ(bytes.substr(0, 8), "\xD0\xCF\x11\xE0\xA1\xB1\x1A\xE1");
  EXPECT_NE(bytes.find(StoredName("WordDocument").substr(2)), std::string::npos);
}

TEST(DefaultScoreCard, HoldsEveryBookmarkThatASheetFills) {
  const std::string bytes = DefaultFileBytes("score_card_default.doc");
  for (const char* name :
       {"Victory",    "PlayerTeam",    "PlayerID", "PlayerName",  "NickName", "AvgGames", "AvgAccuracy",
        "AvgDamage",  "AvgSoldiering", "ClanName", "MissionName", "Date",     "Rank",     "TotalDamage",
        "Soldiering", "ShotsFired",    "Accuracy", "WIA",         "KIA",      "AmmoAdds"}) {
    EXPECT_NE(bytes.find(StoredName(name)), std::string::npos) << name;
  }
}

}  // namespace
