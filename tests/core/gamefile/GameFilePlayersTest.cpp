#include <gmock/gmock.h>

#include <memory>
#include <optional>
#include <vector>

#include "core/gamefile/GameFile.h"
#include "tests/support/Thrown.h"

// How players are found in game files that were written by other programs or by hand.

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::string PlayerOf(int index) {
  return "<Player><Index>" + std::to_string(index) + "</Index><Active>1</Active></Player>";
}

class Players : public testing::Test {
 protected:
  /// Indexes of the active players in a file; nullopt if it is refused.
  std::optional<std::vector<int>> ActiveIn(const std::string& bytes) {
    game.Clear();
    if (!ReadGameFile(bytes, game, [](const std::string&) {})) {
      return std::nullopt;
    }
    std::vector<int> active;
    for (int index = 1; index <= PlayerCount; ++index) {
      if (game.Players(index).Active) {
        active.push_back(index);
      }
    }
    return active;
  }

  static std::string InData(const std::string& contents) {
    return "<GameData><GameHeader/><PlayerData>" + contents + "</PlayerData></GameData>";
  }

  StringTable strings{Language::English};
  Game game{strings};
};

TEST_F(Players, AreAllThatStandInPlayerData) {
  EXPECT_THAT(ActiveIn(InData(PlayerOf(3) + PlayerOf(7) + PlayerOf(224))).value(), ElementsAre(3, 7, 224));
  EXPECT_THAT(ActiveIn(InData("\r\n  " + PlayerOf(3) + "\r\n  " + PlayerOf(7) + "\r\n")).value(),
              ElementsAre(3, 7));
  EXPECT_THAT(ActiveIn(InData("")).value(), IsEmpty());
}

TEST_F(Players, InCommentsAndTextSectionsDoNotCount) {
  EXPECT_THAT(ActiveIn(InData("<!--" + PlayerOf(3) + "-->" + PlayerOf(7))).value(), ElementsAre(7));
  EXPECT_THAT(ActiveIn(InData(PlayerOf(3) + "<!--" + PlayerOf(7) + "-->")).value(), ElementsAre(3));
  EXPECT_THAT(ActiveIn(InData("<!--" + PlayerOf(3) + "-->")).value(), IsEmpty());
  EXPECT_THAT(ActiveIn(InData("<![CDATA[" + PlayerOf(3) + "]]>" + PlayerOf(7))).value(), ElementsAre(7));
  EXPECT_THAT(
      ActiveIn("<GameData><!--" + PlayerOf(3) + "--><PlayerData>" + PlayerOf(7) + "</PlayerData></GameData>")
          .value(),
      ElementsAre(7));
}

TEST_F(Players, ElsewhereDoNotCount) {
  EXPECT_THAT(ActiveIn("<GameData>" + PlayerOf(3) + "<PlayerData>" + PlayerOf(7) + "</PlayerData></GameData>")
                  .value(),
              ElementsAre(7));
  EXPECT_THAT(ActiveIn("<GameData><PlayerData/><Other>" + PlayerOf(3) + "</Other></GameData>").value(),
              IsEmpty());
  EXPECT_THAT(ActiveIn(InData("<Other>" + PlayerOf(3) + PlayerOf(7) + "</Other>")).value(), IsEmpty());
  EXPECT_THAT(
      ActiveIn(InData("<Player><Index>3</Index><Active>1</Active>" + PlayerOf(7) + "</Player>")).value(),
      ElementsAre(3));
}

TEST_F(Players, MayBeWrittenInOtherWays) {
  const std::string other = "<Player kind='x'><Index>3</Index><Active>1</Active></Player >";
  EXPECT_THAT(ActiveIn(InData(other)).value(), ElementsAre(3));
  EXPECT_THAT(ActiveIn(InData(other + PlayerOf(7))).value(), ElementsAre(3, 7));
  EXPECT_THAT(ActiveIn(InData(PlayerOf(7) + other)).value(), ElementsAre(3, 7));
  EXPECT_THAT(ActiveIn(InData(PlayerOf(7) + other + PlayerOf(9))).value(), ElementsAre(3, 7, 9));
}

TEST_F(Players, OfSeveralPlayerDatasCountTogether) {
  const std::string twice =
      "<PlayerData>" + PlayerOf(3) + "</PlayerData><PlayerData>" + PlayerOf(7) + "</PlayerData>";
  EXPECT_THAT(ActiveIn("<GameData>" + twice + "</GameData>").value(), ElementsAre(3, 7));
  EXPECT_THAT(ActiveIn("<GameData><PlayerData>" + PlayerOf(3) + PlayerOf(5) +
                       "</PlayerData><PlayerData><Player a='1'><Index>9</Index><Active>1</Active></Player>"
                       "</PlayerData></GameData>")
                  .value(),
              ElementsAre(3, 5, 9));
}

TEST_F(Players, MakeTheWholeFileInvalidWhenOneIsMalformed) {
  for (const char* fault : {"<Index>5</Inde>", "<Player>", "</Player>", "<A", "</PlayerData>", "<!--"}) {
    EXPECT_FALSE(ActiveIn(InData(PlayerOf(3) + PlayerOf(4) + fault + PlayerOf(7))).has_value()) << fault;
  }
}

TEST_F(Players, AfterAFaultyNumberMustStillBeWellFormed) {
  const std::string faulty = "<Player><Index>x</Index></Player>";
  EXPECT_EQ(NumberThrownBy([&] { ActiveIn(InData(PlayerOf(3) + faulty + PlayerOf(7))); }), 13);
  EXPECT_TRUE(game.Players(3).Active);
  EXPECT_FALSE(game.Players(7).Active);
  EXPECT_FALSE(ActiveIn(InData(PlayerOf(3) + faulty + "<A>")).has_value());
}

}  // namespace
