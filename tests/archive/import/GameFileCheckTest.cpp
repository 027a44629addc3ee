#include "archive/import/GameFileCheck.h"

#include <gtest/gtest.h>

#include "core/gamefile/GameFile.h"
#include "tests/support/RandomGame.h"

namespace {

class CheckedFile : public testing::Test {
 protected:
  std::optional<GameFileTrouble> Check(const std::string& bytes) {
    game = {.Game = Game(strings), .Mission = {}};
    return ReadCheckedGame(bytes, strings, game, [this] { ++breaths; });
  }

  /// Fault, line and text of a file.
  std::string Told(const std::string& bytes) {
    const std::optional<GameFileTrouble> trouble = Check(bytes);
    return trouble ? std::to_string(trouble->Line) + ": " + TextOf(*trouble, strings) : "a game";
  }

  static std::string WithPlayers(const std::string& players) {
    return "<GameData>\n<GameHeader><MissionName>Flag</MissionName></GameHeader>\n<PlayerData>\n" + players +
           "</PlayerData>\n</GameData>\n";
  }
  static constexpr const char* Good = "<Player>\n<Index>1</Index>\n<Active>1</Active>\n</Player>\n";

  StringTable strings{Language::English};
  GameInFile game{.Game = Game(strings), .Mission = {}};
  int breaths = 0;
};

TEST_F(CheckedFile, IsReadWithWhatFollowsFromItsFigures) {
  EXPECT_EQ(
      Told(WithPlayers("<Player><Index>1</Index><Active>1</Active><Soldiering>7</Soldiering></Player>"
                       "<Player><Index>2</Index><Active>1</Active><Soldiering>-3</Soldiering></Player>"
                       "<Player><Index>40</Index><Active>1</Active><Soldiering>5</Soldiering></Player>"
                       "<Player><Index>3</Index><Active>0</Active><Soldiering>9</Soldiering></Player>")),
      "a game");
  EXPECT_EQ(game.Mission, "Flag");
  EXPECT_EQ(game.Game.TeamTotals(1), 4);
  EXPECT_EQ(game.Game.TeamTotals(2), 5);
  EXPECT_GT(breaths, 0);
}

TEST_F(CheckedFile, IsAnyThatTheProgramWrites) {
  Game full(strings);
  FillRandomly(full, PlayerCount, 3);
  EXPECT_EQ(Told(WriteGameFile(full, "A & B")), "a game");
  EXPECT_EQ(game.Mission, "A & B");
}

TEST_F(CheckedFile, TellsTheLineWhereXmlBreaksOff) {
  const std::string damaged = "It is damaged, or no XML at all.";
  EXPECT_EQ(Told(""), "1: " + damaged);
  EXPECT_EQ(Told("no XML\nat all"), "1: " + damaged);
  EXPECT_EQ(Told("<GameData>\n<PlayerData>\n<Player></PlayerData></GameData>"), "3: " + damaged);
  EXPECT_EQ(Told(WithPlayers(Good) + "<GameData/>\n"), "10: " + damaged);
  EXPECT_EQ(Told(std::string("<GameData>\n\0</GameData>", 23)), "2: " + damaged);
  const std::string whole = WithPlayers(Good);
  EXPECT_EQ(Told(whole.substr(0, whole.find("</Player>"))), "6: " + damaged);
}

TEST_F(CheckedFile, TellsAnotherKindOfXml) {
  EXPECT_EQ(Told("<?xml version='1.0'?>\n<html><body/></html>"),
            "2: It is XML, but no game: it begins with html.");
  EXPECT_EQ(Told("<gamedata/>"), "1: It is XML, but no game: it begins with gamedata.");
}

TEST_F(CheckedFile, TellsAGameWithoutPlayers) {
  const std::string nobody = "0: Nobody took part in this game.";
  EXPECT_EQ(Told("<GameData/>"), nobody);
  EXPECT_EQ(Told(WithPlayers("<Player><Index>1</Index></Player>")), nobody);
}

TEST_F(CheckedFile, TellsTheElementThatIsNoNumber) {
  EXPECT_EQ(Told(WithPlayers(Good + std::string("<Player>\n<Index>2</Index>\n<Active>1</Active>\n"
                                                "<ShotCount>many</ShotCount>\n</Player>\n"))),
            "11: There is no number where one belongs: ShotCount: many");
  EXPECT_EQ(Told(WithPlayers("<Player>\n<Index>one</Index></Player>")),
            "5: There is no number where one belongs: Index: one");
}

TEST_F(CheckedFile, TellsTheElementThatIsOutOfItsRange) {
  EXPECT_EQ(Told(WithPlayers("<Player>\n<Index>2</Index>\n<Rank>40000</Rank>\n</Player>")),
            "6: A number is out of its range: Rank: 40000");
}

TEST_F(CheckedFile, TellsPlayersTeamsAndShootersThatCannotBe) {
  EXPECT_EQ(Told(WithPlayers("<Player>\n<Index>225</Index></Player>")),
            "5: A game has no such player or team: Index: 225");
  EXPECT_EQ(Told(WithPlayers("<Player>\n<ShotCount>5</ShotCount></Player>")),
            "4: A game has no such player or team: Player");
  EXPECT_EQ(Told(WithPlayers("<Player><Index>2</Index><HitData>\n<HitByPlayer><Index>3</Index>"
                             "<Amount>4</Amount></HitByPlayer>\n<HitByPlayer><Index>0</Index>"
                             "<Amount>4</Amount></HitByPlayer>\n</HitData></Player>")),
            "6: A game has no such player or team: HitByPlayer");
  const std::string team =
      "<Team><Name>X</Name><PrimaryObjectiveAchieved>1</PrimaryObjectiveAchieved>"
      "<SecondryObjectiveAchieved>0</SecondryObjectiveAchieved></Team>\n";
  EXPECT_EQ(Told("<GameData><GameHeader>\n" + team + team + team + team + "</GameHeader></GameData>"),
            "5: A game has no such player or team: Team");
  EXPECT_EQ(Told("<GameData><GameHeader>\n" + team + "<Team/>\n" + team + "</GameHeader></GameData>"),
            "3: There is no number where one belongs: Team");
}

TEST_F(CheckedFile, TellsSumsThatCannotBe) {
  const auto player = [](int index) {
    return "<Player><Index>" + std::to_string(index) +
           "</Index><Active>1</Active><Soldiering>2000000000</Soldiering></Player>";
  };
  EXPECT_EQ(Told(WithPlayers(player(1) + player(2))),
            "0: The scores of a team, or the damage of a player, add up to more than there can be.");
  EXPECT_EQ(Told(WithPlayers(player(1) + player(40))), "a game");
}

TEST_F(CheckedFile, HasATextForEachFaultInBothLanguages) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable texts(language);
    for (int fault = 0; fault <= static_cast<int>(GameFileFault::SumTooLarge); ++fault) {
      EXPECT_FALSE(TextOf({.Fault = static_cast<GameFileFault>(fault), .What = "x"}, texts).empty());
    }
    EXPECT_THROW(TextOf({.Fault = static_cast<GameFileFault>(9)}, texts), std::out_of_range);
  }
}

}  // namespace
