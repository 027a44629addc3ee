#include <gmock/gmock.h>

#include <random>

#include "core/GameFile.h"
#include "tests/platform/linux/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class Reading : public testing::Test {
 protected:
  bool Read(const std::string& bytes) {
    return ReadGameFile(bytes, game, [this](const std::string& mission) { missions.push_back(mission); });
  }

  /// A game with this text within its only player.
  bool ReadPlayer(const std::string& contents) {
    return Read("<GameData><PlayerData><Player>" + contents + "</Player></PlayerData></GameData>");
  }

  int FaultOf(const std::string& contents) {
    return NumberThrownBy([&] { ReadPlayer(contents); });
  }

  StringTable strings{Language::English};
  Game game{strings};
  std::vector<std::string> missions;
};

TEST_F(Reading, GivesDefaultsForAllThatIsMissing) {
  ASSERT_TRUE(Read("<GameData/>"));
  EXPECT_THAT(missions, ElementsAre("None"));
  EXPECT_EQ(game.GameDate, "N/A");
  EXPECT_EQ(game.ObjectiveTeams(1).Name, "Red");
  ASSERT_TRUE(ReadPlayer("<Index>7</Index>"));
  EXPECT_FALSE(game.Players(7).Active);
  EXPECT_EQ(game.Players(7).BonusPoints, 0);
  EXPECT_EQ(game.Players(7).DallasID, "0");
}

TEST_F(Reading, TakesTheHeader) {
  ASSERT_TRUE(
      Read("<GameData><GameHeader><MissionName>Keep</MissionName>"
           "<Team><Index>x</Index><Name>Blue</Name><PrimaryObjectiveAchieved> 1 </PrimaryObjectiveAchieved>"
           "<SecondryObjectiveAchieved>0</SecondryObjectiveAchieved></Team>"
           "<Team><PrimaryObjectiveAchieved>-1</PrimaryObjectiveAchieved>"
           "<SecondryObjectiveAchieved>1.0</SecondryObjectiveAchieved></Team>"
           "<GameDate>1/2/2003 4:05</GameDate></GameHeader></GameData>"));
  EXPECT_THAT(missions, ElementsAre("Keep"));
  EXPECT_EQ(game.GameDate, "1/2/2003 4:05");
  EXPECT_EQ(game.ObjectiveTeams(1).Name, "Blue");
  EXPECT_TRUE(game.ObjectiveTeams(1).PrimaryAchieved);
  EXPECT_FALSE(game.ObjectiveTeams(1).SecondaryAchieved);
  EXPECT_EQ(game.ObjectiveTeams(2).Name, "Error");
  EXPECT_FALSE(game.ObjectiveTeams(2).PrimaryAchieved);
  EXPECT_TRUE(game.ObjectiveTeams(2).SecondaryAchieved);
}

TEST_F(Reading, FailsWithoutAnObjectiveFlag) {
  EXPECT_EQ(NumberThrownBy([this] { Read("<GameData><GameHeader><Team/></GameHeader></GameData>"); }), 13);
}

TEST_F(Reading, FailsAtAFourthTeam) {
  const std::string team =
      "<Team><PrimaryObjectiveAchieved>0</PrimaryObjectiveAchieved>"
      "<SecondryObjectiveAchieved>0</SecondryObjectiveAchieved></Team>";
  EXPECT_TRUE(Read("<GameData><GameHeader>" + team + team + team + "</GameHeader></GameData>"));
  EXPECT_EQ(NumberThrownBy([&] {
              Read("<GameData><GameHeader>" + team + team + team + team + "</GameHeader></GameData>");
            }),
            9);
}

TEST_F(Reading, FailsAtAnIndexOutsideTheTable) {
  EXPECT_EQ(FaultOf(""), 9);
  EXPECT_EQ(FaultOf("<Index>0</Index>"), 9);
  EXPECT_EQ(FaultOf("<Index>225</Index>"), 9);
  EXPECT_EQ(FaultOf("<Index>-1</Index>"), 9);
  EXPECT_EQ(FaultOf("<Index>seven</Index>"), 13);
  EXPECT_EQ(FaultOf("<Index>99999999999</Index>"), 6);
  EXPECT_EQ(FaultOf("<Index>\n 224 </Index>"), 0);
}

TEST_F(Reading, FailsAtAFieldThatDoesNotFit) {
  EXPECT_EQ(FaultOf("<Index>1</Index><ShotCount>many</ShotCount>"), 13);
  EXPECT_EQ(FaultOf("<Index>1</Index><ShotCount>2147483648</ShotCount>"), 6);
  EXPECT_EQ(FaultOf("<Index>1</Index><Rank>32768</Rank>"), 6);
  EXPECT_EQ(FaultOf("<Index>1</Index><PowerCheatFlag>256</PowerCheatFlag>"), 6);
  EXPECT_EQ(FaultOf("<Index>1</Index><Accuracy>1E99</Accuracy>"), 6);
  EXPECT_EQ(FaultOf("<Index>1</Index><Active/>"), 13);
  EXPECT_EQ(FaultOf("<Index>1</Index><HitData><HitByPlayer/></HitData>"), 9);
  EXPECT_EQ(FaultOf("<Index>1</Index><HitData><HitByPlayer><Index>2</Index><Amount>x</Amount></HitByPlayer></HitData>"),
            13);
}

TEST_F(Reading, KeepsWhatWasReadBeforeAFault) {
  EXPECT_EQ(NumberThrownBy([this] {
              Read("<GameData><PlayerData><Player><Index>1</Index><ShotCount>5</ShotCount></Player>"
                   "<Player><Index>0</Index></Player></PlayerData></GameData>");
            }),
            9);
  EXPECT_EQ(game.Players(1).ShotCount, 5);
}

TEST_F(Reading, TakesFlagsForTrueOnlyWhenTheyAreOne) {
  ASSERT_TRUE(ReadPlayer("<Index>1</Index><Active>1</Active><Committed>2</Committed>"));
  EXPECT_TRUE(game.Players(1).Active);
  EXPECT_FALSE(game.Players(1).Committed);
}

TEST_F(Reading, TakesTheFirstOfTwoLeaves) {
  ASSERT_TRUE(ReadPlayer("<Index>1</Index><ShotCount>1</ShotCount><ShotCount>2</ShotCount>"));
  EXPECT_EQ(game.Players(1).ShotCount, 1);
}

TEST_F(Reading, FindsHitDataAtAnyDepth) {
  ASSERT_TRUE(
      ReadPlayer("<Index>1</Index><HitData><HitByPlayer><Index> 3</Index><Amount> 9</Amount></HitByPlayer></HitData>"
                 "<Deeper><HitData><HitByPlayer><Index>4</Index></HitByPlayer></HitData></Deeper>"
                 "<HitByPlayer><Index>5</Index><Amount>8</Amount></HitByPlayer>"));
  EXPECT_EQ(game.Players(1).HitByPlayer(3), 9);
  EXPECT_EQ(game.Players(1).HitByPlayer(4), 0);
  EXPECT_EQ(game.Players(1).HitByPlayer(5), 0);
}

TEST_F(Reading, JoinsTextAroundCommentsAndSections) {
  ASSERT_TRUE(ReadPlayer("<Index>1<!-- one -->2</Index><DallasID><![CDATA[AB]]>CD</DallasID>"));
  EXPECT_EQ(game.Players(12).DallasID, "ABCD");
}

TEST_F(Reading, RefusesWhatIsNoGameFile) {
  const std::string bad[] = {"",
                             "   ",
                             "no XML",
                             "<GameData>",
                             "<GameData><PlayerData></GameData></PlayerData>",
                             "<Playlist/>",
                             "<gamedata/>",
                             "<GameData/><GameData/>",
                             "text <GameData/>",
                             "<GameData/> text",
                             std::string("<GameData/>\0", 12),
                             std::string(1000, '\0'),
                             "\x89PNG\r\n\x1a\n"};
  for (const std::string& bytes : bad) {
    EXPECT_FALSE(Read(bytes)) << bytes;
  }
  EXPECT_THAT(missions, IsEmpty());
}

TEST_F(Reading, RefusesAGameCutShortAnywhere) {
  game.Players(1).Active = true;
  const std::string whole = WriteGameFile(game, "None");
  Game other(strings);
  for (std::size_t size = 0; size < whole.size(); ++size) {
    ASSERT_FALSE(ReadGameFile(whole.substr(0, size), other, [](const std::string&) {})) << size;
  }
}

TEST_F(Reading, TakesDeclarationsCommentsAndMarks) {
  EXPECT_TRUE(Read("\xEF\xBB\xBF<?xml version=\"1.0\"?><!-- game --><GameData/>\r\n"));
}

TEST_F(Reading, TakesWindows1252AndUtf16) {
  ASSERT_TRUE(Read("<GameData><GameHeader><MissionName>Caf\xE9</MissionName></GameHeader></GameData>"));
  const std::u16string wide = u"<GameData><GameHeader><MissionName>任务</MissionName></GameHeader></GameData>";
  std::string bytes = "\xFF\xFE";
  for (const char16_t unit : wide) {
    bytes += {static_cast<char>(unit & 255), static_cast<char>(unit >> 8)};
  }
  ASSERT_TRUE(Read(bytes));
  EXPECT_THAT(missions, ElementsAre("Café", "任务"));
}

TEST_F(Reading, SurvivesDeepNesting) {
  constexpr int depth = 300'000;
  std::string open;
  std::string close;
  for (int i = 0; i < depth; ++i) {
    open += "<a>";
    close += "</a>";
  }
  EXPECT_TRUE(ReadPlayer("<Index>1</Index>" + open + close));
  EXPECT_FALSE(Read("<GameData>" + open));
}

TEST_F(Reading, GivesBackEveryFieldOfASavedGame) {
  std::mt19937 random(5);
  const auto any = [&random](int most) { return static_cast<std::int32_t>(random() % (most + 1u)); };
  for (int index = 1; index <= PlayerCount; index += 3) {
    Player& player = game.Players(index);
    player.Active = true;
    for (std::int32_t* field :
         {&player.ShotCount, &player.TotalDamage, &player.Soldiering, &player.HealCount, &player.AmmoAddCount,
          &player.AdminKillCount, &player.RespawnCount, &player.RemainingHealth, &player.RemainingClips,
          &player.RemainingAmmo, &player.DeathCount, &player.SecondaryDamage, &player.PrimaryDamage, &player.RunCounter,
          &player.MemberIndex, &player.BonusPoints, &player.ExplosiveDamage, &player.RadiationDamage,
          &player.StunCount}) {
      *field = any(100'000) - 50'000;
    }
    player.Accuracy = static_cast<float>(any(64)) / 64;
    player.Rank = static_cast<std::int16_t>(any(224));
    player.Committed = any(1) == 1;
    player.DallasID = "EFCDAB8967452301";
    player.PowerCheatFlag = static_cast<std::uint8_t>(any(255));
    for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
      player.HitByPlayer(shooter) = any(9);
    }
  }
  game.Players(1).HitByPlayer(9) = -4;
  game.ObjectiveTeams(1).Name = "红队";
  game.GameDate = "2026/11/21 下午 3:05";
  const std::string saved = WriteGameFile(game, "城堡 & <夜>");
  Game loaded(strings);
  ASSERT_TRUE(ReadGameFile(saved, loaded, [this](const std::string& mission) { missions.push_back(mission); }));
  EXPECT_THAT(missions, ElementsAre("城堡 & <夜>"));
  EXPECT_EQ(loaded.Players(1).HitByPlayer(9), 0);
  EXPECT_EQ(WriteGameFile(loaded, "城堡 & <夜>"), saved);
}

}  // namespace
