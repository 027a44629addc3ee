#include <gmock/gmock.h>

#include <memory>

#include "core/gamefile/GameFile.h"
#include "tests/support/Described.h"
#include "tests/support/RandomGame.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::string Repeated(const std::string& text, int times) {
  std::string repeated;
  for (int i = 0; i < times; ++i) {
    repeated += text;
  }
  return repeated;
}

/// `text` as UTF-16 after a byte-order mark.
std::string InUtf16(const std::u16string& text, bool lowByteFirst) {
  std::string bytes;
  for (const char16_t unit : u'\uFEFF' + text) {
    const char high = static_cast<char>(unit >> 8);
    const char low = static_cast<char>(unit & 0xFF);
    bytes += lowByteFirst ? low : high;
    bytes += lowByteFirst ? high : low;
  }
  return bytes;
}

class Reading : public testing::Test {
 protected:
  bool Read(const std::string& bytes) {
    return ReadGameFile(bytes, game, [this](const std::string& mission) { missions.push_back(mission); });
  }

  int FaultIn(const std::string& bytes) {
    return NumberThrownBy([&] { Read(bytes); });
  }

  static std::string WithHeader(const std::string& contents) {
    return "<GameData><GameHeader>" + contents + "</GameHeader></GameData>";
  }

  static std::string Leaf(const std::string& name, const std::string& text) {
    std::string leaf = '<' + name + '>';
    leaf.append(text).append("</").append(name).append(">");
    return leaf;
  }

  /// A game file with `contents` inside its only player.
  static std::string WithPlayer(const std::string& contents) {
    return "<GameData><PlayerData><Player>" + contents + "</Player></PlayerData></GameData>";
  }

  static std::string WithHit(const std::string& contents) {
    return WithPlayer("<Index>1</Index><HitData><HitByPlayer>" + contents + "</HitByPlayer></HitData>");
  }

  /// Expects RuntimeError `number` for a player 1 with `text` in the leaf `name`.
  void ExpectFault(int number, const std::string& name, const std::string& text) {
    EXPECT_EQ(FaultIn(WithPlayer("<Index>1</Index>" + Leaf(name, text))), number) << name << " is " << text;
  }

  StringTable strings{Language::English};
  Game game{strings};
  std::vector<std::string> missions;
};

TEST_F(Reading, GivesTheHeaderItsDefaults) {
  game.ObjectiveTeams(2) = {"Yellow", true, true};
  ASSERT_TRUE(Read("<GameData/>"));
  EXPECT_THAT(missions, ElementsAre("None"));
  EXPECT_EQ(game.GameDate, "N/A");
  EXPECT_EQ(game.ObjectiveTeams(2).Name, "Yellow");
  EXPECT_TRUE(game.ObjectiveTeams(2).PrimaryAchieved && game.ObjectiveTeams(2).SecondaryAchieved);
  ASSERT_TRUE(Read(WithHeader("")));
  EXPECT_THAT(missions, ElementsAre("None", "None"));
}

TEST_F(Reading, GivesEveryFieldOfAPlayerItsDefault) {
  FillRandomly(game, PlayerCount, 1);
  Player& player = game.Players(7);
  player.AbsoluteDamage = player.TotalDamage = player.Soldiering = player.MemberIndex = 9;
  player.Rank = 9;
  Player expected;
  expected.HitByPlayer = player.HitByPlayer;
  expected.DallasID = "0";
  ASSERT_TRUE(Read(WithPlayer("<Index>7</Index>")));
  EXPECT_EQ(Described(player), Described(expected));
}

TEST_F(Reading, TakesEveryFieldFromItsLeafInAnyOrder) {
  ASSERT_TRUE(Read(WithPlayer(
      "<BonusPoints>-26</BonusPoints><PowerCheatFlag>25</PowerCheatFlag><StunCount>24</StunCount>"
      "<RadiationDamage>23</RadiationDamage><ExplosiveDamage>22</ExplosiveDamage>"
      "<DallasID>EFCDAB8967452301</DallasID><MemberIndex>20</MemberIndex><Rank>-19</Rank>"
      "<Accuracy> .5</Accuracy><PrimaryDamage>17</PrimaryDamage><SecondaryDamage>16</SecondaryDamage>"
      "<RemainingAmmo>15</RemainingAmmo><RemainingClips>14</RemainingClips>"
      "<RemainingHealth>13</RemainingHealth><Committed>1</Committed><Active>1</Active>"
      "<RunCounter>10</RunCounter><DeathCount>9</DeathCount><RespawnCount>8</RespawnCount>"
      "<AdminKillCount>7</AdminKillCount><AmmoAddCount>6</AmmoAddCount><HealCount>5</HealCount>"
      "<Soldiering>4</Soldiering><AbsoluteDamage>3</AbsoluteDamage><TotalDamage>-2</TotalDamage>"
      "<TotalDamage>77</TotalDamage><ShotCount>2147483647</ShotCount>"
      "<HitData><HitByPlayer><Amount>-5</Amount><PlayerID>x</PlayerID><Index>224</Index></HitByPlayer>"
      "<HitByPlayer><Index>1</Index><Amount>8</Amount></HitByPlayer>"
      "<HitByPlayer><Index>1</Index><Amount>6</Amount></HitByPlayer></HitData>"
      "<PlayerID>Red  0</PlayerID><Index> 40</Index>")));
  Player expected;
  expected.ShotCount = 2147483647;
  expected.TotalDamage = -2;
  expected.AbsoluteDamage = 3;
  expected.Soldiering = 4;
  expected.HealCount = 5;
  expected.AmmoAddCount = 6;
  expected.AdminKillCount = 7;
  expected.RespawnCount = 8;
  expected.DeathCount = 9;
  expected.RunCounter = 10;
  expected.Active = true;
  expected.Committed = true;
  expected.RemainingHealth = 13;
  expected.RemainingClips = 14;
  expected.RemainingAmmo = 15;
  expected.SecondaryDamage = 16;
  expected.PrimaryDamage = 17;
  expected.Accuracy = 0.5F;
  expected.Rank = -19;
  expected.MemberIndex = 20;
  expected.DallasID = "EFCDAB8967452301";
  expected.ExplosiveDamage = 22;
  expected.RadiationDamage = 23;
  expected.StunCount = 24;
  expected.PowerCheatFlag = 25;
  expected.BonusPoints = -26;
  expected.HitByPlayer(224) = -5;
  expected.HitByPlayer(1) = 6;
  EXPECT_EQ(Described(game.Players(40)), Described(expected));
}

TEST_F(Reading, TakesTheHeader) {
  ASSERT_TRUE(Read(WithHeader(
      "<MissionName>Keep</MissionName>"
      "<Team><Index>x</Index><Name>Blue</Name><PrimaryObjectiveAchieved> 1 </PrimaryObjectiveAchieved>"
      "<SecondryObjectiveAchieved>0</SecondryObjectiveAchieved></Team>"
      "<Team><PrimaryObjectiveAchieved>-1</PrimaryObjectiveAchieved>"
      "<SecondryObjectiveAchieved>1.0</SecondryObjectiveAchieved></Team>"
      "<GameDate>1/2/2003 4:05</GameDate>")));
  EXPECT_THAT(missions, ElementsAre("Keep"));
  EXPECT_EQ(game.GameDate, "1/2/2003 4:05");
  EXPECT_EQ(game.ObjectiveTeams(1).Name, "Blue");
  EXPECT_TRUE(game.ObjectiveTeams(1).PrimaryAchieved);
  EXPECT_FALSE(game.ObjectiveTeams(1).SecondaryAchieved);
  EXPECT_EQ(game.ObjectiveTeams(2).Name, "Error");
  EXPECT_FALSE(game.ObjectiveTeams(2).PrimaryAchieved);
  EXPECT_TRUE(game.ObjectiveTeams(2).SecondaryAchieved);
  EXPECT_EQ(game.ObjectiveTeams(3).Name, "Yellow");
}

TEST_F(Reading, CallsForTheMissionBeforeItReadsAnythingElse) {
  game.GameDate = "before";
  std::string dateAtTheCall;
  ASSERT_TRUE(ReadGameFile(WithHeader("<GameDate>after</GameDate><MissionName>Keep</MissionName>"), game,
                           [&](const std::string&) { dateAtTheCall = game.GameDate; }));
  EXPECT_EQ(dateAtTheCall, "before");
}

TEST_F(Reading, TakesTheFirstOfTwoHeadersAndThePlayersOfAllPlayerDatas) {
  ASSERT_TRUE(
      Read("<GameData><PlayerData><Player><Index>1</Index><Active>1</Active></Player></PlayerData>"
           "<GameHeader><MissionName>Keep</MissionName></GameHeader>"
           "<GameHeader><MissionName>Other</MissionName><GameDate>x</GameDate></GameHeader>"
           "<PlayerData><Player><Index>2</Index><Active>1</Active></Player></PlayerData></GameData>"));
  EXPECT_THAT(missions, ElementsAre("Keep"));
  EXPECT_EQ(game.GameDate, "N/A");
  EXPECT_TRUE(game.Players(1).Active && game.Players(2).Active);
}

TEST_F(Reading, FailsWithoutAnObjectiveFlag) {
  const std::string primary = "<PrimaryObjectiveAchieved>1</PrimaryObjectiveAchieved>";
  const std::string secondary = "<SecondryObjectiveAchieved>1</SecondryObjectiveAchieved>";
  EXPECT_EQ(FaultIn(WithHeader("<Team>" + primary + "</Team>")), 13);
  EXPECT_EQ(FaultIn(WithHeader("<Team>" + secondary + "</Team>")), 13);
  EXPECT_EQ(FaultIn(WithHeader("<Team>" + primary + "<SecondaryObjectiveAchieved/></Team>")), 13);
  EXPECT_EQ(FaultIn(WithHeader("<Team>" + primary + secondary + "</Team>")), 0);
}

TEST_F(Reading, FailsAtAFourthTeamAfterTheFirstThree) {
  const auto team = [](const std::string& name) {
    return "<Team><Name>" + name +
           "</Name><PrimaryObjectiveAchieved>0</PrimaryObjectiveAchieved>"
           "<SecondryObjectiveAchieved>0</SecondryObjectiveAchieved></Team>";
  };
  EXPECT_EQ(FaultIn(WithHeader(team("A") + team("B") + team("C"))), 0);
  EXPECT_EQ(FaultIn(WithHeader(team("D") + team("E") + team("F") + team("G"))), 9);
  EXPECT_EQ(game.ObjectiveTeams(3).Name, "F");
}

TEST_F(Reading, TakesTheDateBeforeTheTeams) {
  game.GameDate = "before";
  EXPECT_EQ(FaultIn(WithHeader("<Team></Team><GameDate>after</GameDate>")), 13);
  EXPECT_EQ(game.GameDate, "after");
}

TEST_F(Reading, FailsAtAnIndexOutsideTheTable) {
  EXPECT_EQ(FaultIn(WithPlayer("")), 9);
  EXPECT_EQ(FaultIn(WithPlayer("<Index>0</Index>")), 9);
  EXPECT_EQ(FaultIn(WithPlayer("<Index>225</Index>")), 9);
  EXPECT_EQ(FaultIn(WithPlayer("<Index>-1</Index>")), 9);
  EXPECT_EQ(FaultIn(WithPlayer("<Index>seven</Index>")), 13);
  EXPECT_EQ(FaultIn(WithPlayer("<Index></Index>")), 13);
  EXPECT_EQ(FaultIn(WithPlayer("<Index>1 2</Index>")), 13);
  EXPECT_EQ(FaultIn(WithPlayer("<Index>99999999999</Index>")), 6);
  EXPECT_EQ(FaultIn(WithPlayer("<Index>\n 224\t</Index>")), 0);
}

TEST_F(Reading, FailsAtAHitOutsideTheTable) {
  EXPECT_EQ(FaultIn(WithHit("")), 9);
  EXPECT_EQ(FaultIn(WithHit("<Index>225</Index><Amount>1</Amount>")), 9);
  EXPECT_EQ(FaultIn(WithHit("<Index>x</Index>")), 13);
  EXPECT_EQ(FaultIn(WithHit("<Index>2</Index><Amount>x</Amount>")), 13);
  EXPECT_EQ(FaultIn(WithHit("<Index>2</Index><Amount>2147483648</Amount>")), 6);
}

TEST_F(Reading, FailsAtAFieldThatIsNoNumber) {
  for (const char* field :
       {"ShotCount",       "TotalDamage",     "AbsoluteDamage",  "Soldiering",     "HealCount",
        "AmmoAddCount",    "AdminKillCount",  "RespawnCount",    "DeathCount",     "RunCounter",
        "Active",          "Committed",       "RemainingHealth", "RemainingClips", "RemainingAmmo",
        "SecondaryDamage", "PrimaryDamage",   "Accuracy",        "Rank",           "MemberIndex",
        "ExplosiveDamage", "RadiationDamage", "StunCount",       "PowerCheatFlag", "BonusPoints"}) {
    ExpectFault(13, field, "many");
    ExpectFault(13, field, "");
    ExpectFault(6, field, "1E999");
  }
}

TEST_F(Reading, FailsAtAFieldThatDoesNotFit) {
  ExpectFault(6, "ShotCount", "2147483648");
  ExpectFault(0, "ShotCount", "-2147483648");
  ExpectFault(6, "Rank", "32768");
  ExpectFault(0, "Rank", "-32768");
  ExpectFault(6, "PowerCheatFlag", "256");
  ExpectFault(6, "PowerCheatFlag", "-1");
  ExpectFault(6, "Accuracy", "1E39");
  ExpectFault(0, "Accuracy", "3E38");
}

TEST_F(Reading, RoundsFractionsToTheEvenNumber) {
  ASSERT_TRUE(
      Read(WithPlayer("<Index>1.5</Index><ShotCount>2.5</ShotCount><HealCount>3.5</HealCount>"
                      "<DeathCount>-2.5</DeathCount>")));
  EXPECT_EQ(game.Players(2).ShotCount, 2);
  EXPECT_EQ(game.Players(2).HealCount, 4);
  EXPECT_EQ(game.Players(2).DeathCount, -2);
}

TEST_F(Reading, KeepsWhatWasReadBeforeAFault) {
  EXPECT_EQ(FaultIn("<GameData><GameHeader><GameDate>x</GameDate></GameHeader><PlayerData>"
                    "<Player><Index>1</Index><ShotCount>5</ShotCount></Player>"
                    "<Player><Index>2</Index><ShotCount>6</ShotCount><HealCount>y</HealCount></Player>"
                    "<Player><Index>3</Index><ShotCount>7</ShotCount></Player></PlayerData></GameData>"),
            13);
  EXPECT_EQ(game.GameDate, "x");
  EXPECT_EQ(game.Players(1).ShotCount, 5);
  EXPECT_EQ(game.Players(2).ShotCount, 6);
  EXPECT_EQ(game.Players(3).ShotCount, 0);
}

TEST_F(Reading, TakesFlagsForTrueOnlyWhenTheyAreOne) {
  const std::pair<const char*, bool> cases[] = {{"1", true},    {" 1 ", true}, {"1.0", true}, {"+1", true},
                                                {"2", false},   {"-1", false}, {"0", false},  {"1.2", false},
                                                {"0.6", false}, {"10", false}};
  for (const auto& [text, expected] : cases) {
    ASSERT_TRUE(Read(WithPlayer("<Index>1</Index>" + Leaf("Active", text) + Leaf("Committed", text))));
    EXPECT_EQ(game.Players(1).Active, expected) << text;
    EXPECT_EQ(game.Players(1).Committed, expected) << text;
  }
  ExpectFault(13, "Active", "True");
}

TEST_F(Reading, FindsHitDataAtAnyDepth) {
  ASSERT_TRUE(Read(WithPlayer(
      "<Index>1</Index><HitData><HitByPlayer><Index> 3</Index><Amount> 9</Amount></HitByPlayer></HitData>"
      "<Deeper><HitData><Index>9</Index><HitByPlayer><Index>4</Index><Amount>2</Amount></HitByPlayer></"
      "HitData></Deeper>"
      "<HitData><HitByPlayer><Index>6</Index></HitByPlayer></HitData>"
      "<HitByPlayer><Index>5</Index><Amount>8</Amount></HitByPlayer>"
      "<HitData><Other><HitByPlayer><Index>7</Index><Amount>8</Amount></HitByPlayer></Other></HitData>")));
  EXPECT_EQ(game.Players(1).HitByPlayer(3), 9);
  EXPECT_EQ(game.Players(1).HitByPlayer(4), 2);
  for (const int none : {5, 6, 7, 9}) {
    EXPECT_EQ(game.Players(1).HitByPlayer(none), 0) << none;
  }
}

TEST_F(Reading, JoinsTextAroundCommentsAndSections) {
  ASSERT_TRUE(
      Read(WithPlayer("<Index>1<!-- one -->2</Index><DallasID><![CDATA[<AB>]]>C<?pi x?>D</DallasID>")));
  EXPECT_EQ(game.Players(12).DallasID, "<AB>CD");
}

TEST_F(Reading, KeepsBlanksWithinTexts) {
  ASSERT_TRUE(Read(WithHeader("<MissionName> a  b </MissionName><GameDate>  </GameDate>")));
  EXPECT_THAT(missions, ElementsAre(" a  b "));
  EXPECT_EQ(game.GameDate, "  ");
}

TEST_F(Reading, TakesCharactersByReference) {
  ASSERT_TRUE(Read(WithHeader("<MissionName>&lt;&amp;&gt;&quot;&apos;&#x4EFB;&#20219;</MissionName>")));
  EXPECT_THAT(missions, ElementsAre("<&>\"'任任"));
}

TEST_F(Reading, RefusesWhatIsNoGameFileAndChangesNothing) {
  FillRandomly(game, 20, 2);
  game.GameDate = "before";
  const auto before = std::make_unique<Game>(game);
  const std::string bad[] = {"",
                             "   ",
                             "no XML",
                             "<GameData>",
                             "<GameData",
                             "<GameData><PlayerData></GameData></PlayerData>",
                             "<GameData></gamedata>",
                             "<Playlist/>",
                             "<Playlist><GameData/></Playlist>",
                             "<gamedata/>",
                             "<!-- only --><?xml version=\"1.0\"?>",
                             "<GameData/><GameData/>",
                             "<Other/><GameData/>",
                             "text <GameData/>",
                             "<GameData/> text",
                             "<![CDATA[x]]><GameData/>",
                             std::string("<GameData/>\0", 12),
                             std::string("<GameData>\0</GameData>", 22),
                             std::string(1000, '\0'),
                             "\xFF\xFE",
                             "\xFE\xFF\x3C",
                             "\xEF\xBB\xBF",
                             "\x89PNG\r\n\x1a\n"};
  for (const std::string& bytes : bad) {
    EXPECT_FALSE(Read(bytes)) << bytes;
  }
  EXPECT_THAT(missions, IsEmpty());
  ExpectSameGame(game, *before);
}

TEST_F(Reading, RefusesAGameCutShortAnywhere) {
  game.Players(1).Active = true;
  game.Players(1).HitByPlayer(2) = 5;
  const std::string whole = WriteGameFile(game, "任务");
  const auto before = std::make_unique<Game>(game);
  for (std::size_t size = 0; size < whole.size(); ++size) {
    ASSERT_FALSE(Read(whole.substr(0, size))) << size;
  }
  ExpectSameGame(game, *before);
  EXPECT_TRUE(Read(whole));
}

TEST_F(Reading, TakesDeclarationsCommentsAndMarks) {
  EXPECT_TRUE(Read(
      "\xEF\xBB\xBF<?xml version=\"1.0\"?>\r\n<!-- game -->\r\n<!DOCTYPE GameData><GameData a=\"1\"/>\r\n"));
  EXPECT_TRUE(Read("\n  <GameData></GameData>  \n<!-- end -->"));
}

TEST_F(Reading, TakesWindows1252AndUtf16) {
  ASSERT_TRUE(Read(WithHeader("<MissionName>Caf\xE9 \x80</MissionName>")));
  const std::u16string wide =
      u"<GameData><GameHeader><MissionName>任务𝄞</MissionName></GameHeader></GameData>";
  ASSERT_TRUE(Read(InUtf16(wide, true)));
  ASSERT_TRUE(Read(InUtf16(wide, false)));
  EXPECT_THAT(missions, ElementsAre("Café €", "任务𝄞", "任务𝄞"));
}

TEST_F(Reading, OfOneTextInWindows1252KeepsTheOthers) {
  ASSERT_TRUE(Read(WithHeader("<MissionName>任务</MissionName><GameDate>Caf\xE9</GameDate>")));
  EXPECT_THAT(missions, ElementsAre("任务"));
  EXPECT_EQ(game.GameDate, "Café");
}

TEST_F(Reading, SurvivesAMillionLevels) {
  constexpr int depth = 1'000'000;
  const std::string open = Repeated("<a>", depth);
  const std::string close = Repeated("</a>", depth);
  EXPECT_TRUE(Read(WithPlayer("<Index>1</Index>" + open + close)));
  EXPECT_FALSE(Read("<GameData>" + open));
  EXPECT_FALSE(Read(open + close));
  const std::string hits = Repeated("<HitData><HitByPlayer><Amount>2</Amount><Index>1", depth / 3);
  const std::string ends = Repeated("</Index></HitByPlayer></HitData>", depth / 3);
  EXPECT_TRUE(Read(WithPlayer("<Index>1</Index>" + hits + ends)));
  EXPECT_EQ(game.Players(1).HitByPlayer(1), 2);
  EXPECT_EQ(FaultIn(WithHeader("<Team><Name>" + open + close + "</Name></Team>")), 13);
}

}  // namespace
