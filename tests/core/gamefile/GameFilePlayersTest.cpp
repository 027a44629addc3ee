#include <gmock/gmock.h>

#include <iterator>
#include <optional>
#include <random>
#include <string>
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
  EXPECT_THAT(ActiveIn("<GameData><PlayerData>" + PlayerOf(3) +
                       "</PlayerData><PlayerData><Player ><Index>9</Index><Active>1</Active></Player >"
                       "</PlayerData></GameData>")
                  .value(),
              ElementsAre(3, 9));
}

TEST_F(Players, MakeTheWholeFileInvalidWhenOneIsMalformed) {
  for (const char* fault : {"<Index>5</Inde>", "<Player>", "</Player>", "<A", "</PlayerData>", "<!--"}) {
    EXPECT_FALSE(ActiveIn(InData(PlayerOf(3) + PlayerOf(4) + fault + PlayerOf(7))).has_value()) << fault;
  }
}

TEST_F(Players, HaveNoDocumentTypeOrDeclarationBetweenOrBehindThem) {
  for (const char* fault : {"<!DOCTYPE GameData>", "<?xml version='1.0'?>"}) {
    EXPECT_FALSE(ActiveIn(InData(fault + PlayerOf(3))).has_value()) << fault;
    EXPECT_FALSE(ActiveIn(InData(PlayerOf(3) + fault + PlayerOf(7))).has_value()) << fault;
    EXPECT_FALSE(ActiveIn(InData(PlayerOf(3) + PlayerOf(7) + fault)).has_value()) << fault;
    EXPECT_FALSE(ActiveIn(InData(PlayerOf(3)) + fault).has_value()) << fault;
    EXPECT_THAT(ActiveIn(fault + InData(PlayerOf(3) + PlayerOf(7))).value(), ElementsAre(3, 7)) << fault;
    EXPECT_FALSE(ActiveIn(fault + (fault + InData(PlayerOf(3)))).has_value()) << fault;
  }
  EXPECT_THAT(
      ActiveIn("<?xml version='1.0'?>\r\n<!DOCTYPE GameData [<!ELEMENT GameData ANY>]>" + InData(PlayerOf(3)))
          .value(),
      ElementsAre(3));
  EXPECT_FALSE(ActiveIn("<!DOCTYPE GameData><?xml version='1.0'?>" + InData(PlayerOf(3))).has_value());
}

/// Makes game files of parts that stand in their usual order, or in any.
class RandomFiles : public Players {
 protected:
  std::string Next() {
    std::string file = "<GameData><PlayerData>";
    for (int parts = Below(8); parts > 0; --parts) {
      file += Below(3) == 0 ? Oddity() : Player();
    }
    file += "</PlayerData></GameData>";
    for (int faults = Below(3) - 1; faults > 0; --faults) {
      file.insert(static_cast<std::size_t>(Below(static_cast<int>(file.size()))), Oddity());
    }
    if (Below(4) == 0) {
      file.erase(static_cast<std::size_t>(Below(static_cast<int>(file.size()))),
                 static_cast<std::size_t>(Below(12)));
    }
    return file;
  }

  /// What comes of a file: its active players and the sum of their shots, or how it fails.
  std::string OutcomeOf(const std::string& file) {
    std::optional<std::vector<int>> active;
    if (const int fault = NumberThrownBy([&] { active = ActiveIn(file); }); fault != 0) {
      return "fault " + std::to_string(fault);
    }
    if (!active) {
      return "refused";
    }
    std::string outcome;
    for (const int index : *active) {
      outcome += std::to_string(index) + ": " + std::to_string(game.Players(index).ShotCount) + ' ';
    }
    return outcome;
  }

 private:
  int Below(int limit) { return static_cast<int>(random_() % static_cast<unsigned>(limit)); }

  std::string Player() {
    return "<Player><Index>" + std::to_string(1 + Below(225)) + "</Index><Active>1</Active><ShotCount>" +
           std::to_string(Below(9)) + "</ShotCount></Player>";
  }

  std::string Oddity() {
    static constexpr const char* oddities[] = {"<Player ><Index>5</Index><Active>1</Active></Player >",
                                               "<Player>",
                                               "</Player>",
                                               "<Player/>",
                                               "<Player >",
                                               "<!--",
                                               "-->",
                                               "<!-- <Player> -->",
                                               "<![CDATA[",
                                               "]]>",
                                               "<![CDATA[</Player>]]>",
                                               "<?pi ?>",
                                               "<?xml?>",
                                               "<!DOCTYPE a>",
                                               "<!DOCTYPE a [<!-- <Player> -->]>",
                                               "text",
                                               "&amp;",
                                               "&#0;",
                                               "\r\n ",
                                               "<Other>",
                                               "</Other>",
                                               "<Other/>",
                                               "<PlayerData>",
                                               "</PlayerData>",
                                               "</PlayerData><PlayerData>",
                                               "<GameData>",
                                               "</GameData>",
                                               "<A b='<Player>'/>",
                                               "<A b=\"</Player>\">",
                                               "<ShotCount>x</ShotCount>",
                                               "<",
                                               ">",
                                               "'",
                                               "\"",
                                               "/"};
    return oddities[static_cast<std::size_t>(Below(static_cast<int>(std::size(oddities))))];
  }

  std::mt19937 random_{19};
};

// A blank behind the name changes nothing in XML, but such players are not cut out to be parsed one by one.
TEST_F(RandomFiles, AreReadAlikeWithTheirPlayersCutOutAndInOneTree) {
  int read = 0;
  int refused = 0;
  int faults = 0;
  for (int file = 0; file < 5'000; ++file) {
    const std::string bytes = Next();
    std::string inOneTree = bytes;
    for (std::size_t at = 0; (at = inOneTree.find("<Player>", at)) != std::string::npos; ++at) {
      inOneTree.replace(at, 8, "<Player >");
    }
    const std::string outcome = OutcomeOf(bytes);
    ASSERT_EQ(outcome, OutcomeOf(inOneTree)) << bytes;
    (outcome == "refused" ? refused : outcome.starts_with("fault") ? faults : read) += 1;
  }
  EXPECT_GT(read, 500);
  EXPECT_GT(refused, 500);
  EXPECT_GT(faults, 50);
}

TEST_F(Players, AfterAFaultyNumberMustStillBeWellFormed) {
  const std::string faulty = "<Player><Index>x</Index></Player>";
  EXPECT_EQ(NumberThrownBy([&] { ActiveIn(InData(PlayerOf(3) + faulty + PlayerOf(7))); }), 13);
  EXPECT_TRUE(game.Players(3).Active);
  EXPECT_FALSE(game.Players(7).Active);
  EXPECT_FALSE(ActiveIn(InData(PlayerOf(3) + faulty + "<A>")).has_value());
}

}  // namespace
