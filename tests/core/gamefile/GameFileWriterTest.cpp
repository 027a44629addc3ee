#include <gmock/gmock.h>

#include <algorithm>
#include <memory>
#include <string_view>
#include <utility>

#include "core/gamefile/GameFile.h"
#include "tests/support/Described.h"
#include "tests/support/RandomGame.h"

namespace {

using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

class Writing : public testing::Test {
 protected:
  /// The expected file from its lines: CR LF after each leaf and nowhere else.
  static std::string WithFileBreaks(const std::string& lines) {
    std::string bytes;
    for (const char letter : lines) {
      bytes += letter == '\n' ? "\r\n" : std::string(1, letter);
    }
    return bytes;
  }

  std::string Written() const { return WriteGameFile(game, "None"); }

  StringTable strings{Language::English};
  Game game{strings};
};

TEST_F(Writing, OfAGameWithoutPlayersLeavesPlayerDataEmpty) {
  game.GameDate = "21/05/2013 14:30";
  game.Players(3).ShotCount = 5;  // not active
  game.ObjectiveTeams(2).Name = "Red";
  game.ObjectiveTeams(2).PrimaryAchieved = true;
  game.ObjectiveTeams(3).SecondaryAchieved = true;
  EXPECT_EQ(Written(), WithFileBreaks(R"(<GameData><GameHeader>    <MissionName>None</MissionName>
<Team>    <PrimaryObjectiveAchieved>0</PrimaryObjectiveAchieved>
    <SecondryObjectiveAchieved>0</SecondryObjectiveAchieved>
    <Name>Red</Name>
</Team><Team>    <PrimaryObjectiveAchieved>1</PrimaryObjectiveAchieved>
    <SecondryObjectiveAchieved>0</SecondryObjectiveAchieved>
    <Name>Red</Name>
</Team><Team>    <PrimaryObjectiveAchieved>0</PrimaryObjectiveAchieved>
    <SecondryObjectiveAchieved>1</SecondryObjectiveAchieved>
    <Name>Yellow</Name>
</Team>    <GameDate>21/05/2013 14:30</GameDate>
</GameHeader><PlayerData></PlayerData></GameData>)"));
}

TEST_F(Writing, PutsEveryFieldOfAPlayerInItsPlace) {
  Player& player = game.Players(40);
  player.Active = true;
  player.HitByPlayer(1) = 25;
  player.HitByPlayer(2) = -3;
  player.HitByPlayer(40) = 1;
  player.HitByPlayer(224) = 7;
  player.ShotCount = 42;
  player.TotalDamage = -60;
  player.AbsoluteDamage = 99;
  player.Soldiering = 3;
  player.HealCount = 4;
  player.AmmoAddCount = 5;
  player.AdminKillCount = 6;
  player.RespawnCount = 7;
  player.DeathCount = 8;
  player.RunCounter = 9;
  player.Committed = true;
  player.RemainingHealth = 10;
  player.RemainingClips = 11;
  player.RemainingAmmo = 12;
  player.SecondaryDamage = 13;
  player.PrimaryDamage = 14;
  player.Accuracy = 0.5F;
  player.Rank = 15;
  player.MemberIndex = 16;
  player.DallasID = "EFCDAB8967452301";
  player.ExplosiveDamage = 17;
  player.RadiationDamage = 18;
  player.StunCount = 19;
  player.PowerCheatFlag = 200;
  player.BonusPoints = -20;
  const std::string written = Written();
  EXPECT_EQ(written.substr(written.find("<PlayerData>")),
            WithFileBreaks(R"(<PlayerData><Player>    <Index> 40</Index>
    <PlayerID>Blue  7</PlayerID>
<HitData><HitByPlayer>    <Index> 1</Index>
    <PlayerID>Red  0</PlayerID>
    <Amount> 25</Amount>
</HitByPlayer><HitByPlayer>    <Index> 40</Index>
    <PlayerID>Blue  7</PlayerID>
    <Amount> 1</Amount>
</HitByPlayer><HitByPlayer>    <Index> 224</Index>
    <PlayerID>Blue  95</PlayerID>
    <Amount> 7</Amount>
</HitByPlayer></HitData>    <ShotCount> 42</ShotCount>
    <TotalDamage>-60</TotalDamage>
    <TotalDamage>-60</TotalDamage>
    <Soldiering> 3</Soldiering>
    <HealCount> 4</HealCount>
    <AmmoAddCount> 5</AmmoAddCount>
    <AdminKillCount> 6</AdminKillCount>
    <RespawnCount> 7</RespawnCount>
    <DeathCount> 8</DeathCount>
    <RunCounter> 9</RunCounter>
    <Active>1</Active>
    <Committed>1</Committed>
    <RemainingHealth> 10</RemainingHealth>
    <RemainingClips> 11</RemainingClips>
    <RemainingAmmo> 12</RemainingAmmo>
    <SecondaryDamage> 13</SecondaryDamage>
    <PrimaryDamage> 14</PrimaryDamage>
    <Accuracy> .5</Accuracy>
    <Rank> 15</Rank>
    <MemberIndex> 16</MemberIndex>
    <DallasID>EFCDAB8967452301</DallasID>
    <ExplosiveDamage> 17</ExplosiveDamage>
    <RadiationDamage> 18</RadiationDamage>
    <StunCount> 19</StunCount>
    <PowerCheatFlag> 200</PowerCheatFlag>
    <BonusPoints>-20</BonusPoints>
</Player></PlayerData></GameData>)"));
}

TEST_F(Writing, ListsPlayersByIndexWithOrWithoutHits) {
  game.Players(105).Active = true;
  game.Players(2).Active = true;
  const std::string written = Written();
  const std::size_t red1 =
      written.find("<Player>    <Index> 2</Index>\r\n    <PlayerID>Red  1</PlayerID>\r\n");
  const std::size_t red40 =
      written.find("<Player>    <Index> 105</Index>\r\n    <PlayerID>Red  40</PlayerID>\r\n");
  ASSERT_NE(red40, std::string::npos);
  EXPECT_LT(red1, red40);
  EXPECT_THAT(written.substr(red40),
              HasSubstr("</PlayerID>\r\n<HitData></HitData>    <ShotCount> 0</ShotCount>"));
  EXPECT_THAT(written.substr(red40), HasSubstr("    <Committed>0</Committed>\r\n"));
  EXPECT_THAT(written.substr(red40), HasSubstr("    <DallasID>0000000000000000</DallasID>\r\n"));
}

TEST_F(Writing, GivesTheSameBytesPlayerByPlayer) {
  FillRandomly(game, 60, 3);
  std::string bytes;
  std::size_t longest = 0;
  WriteGameFile(game, "<Flag>", [&](std::string_view piece) {
    bytes += piece;
    longest = std::max(longest, piece.size());
  });
  EXPECT_EQ(bytes, WriteGameFile(game, "<Flag>"));
  EXPECT_LT(longest, bytes.size() / 20);
}

TEST_F(Writing, LeavesOutDeclarationAndAbsoluteDamage) {
  game.Players(1).Active = true;
  EXPECT_THAT(Written(), StartsWith("<GameData>"));
  EXPECT_THAT(Written(), Not(HasSubstr("AbsoluteDamage")));
}

TEST_F(Writing, GivesAnAccuracyAtMostSevenDigitsAndNoZeroBeforeThePoint) {
  const std::pair<float, const char*> cases[] = {
      {0, " 0"},       {1, " 1"},         {1.0F / 3, " .3333333"},
      {0.25F, " .25"}, {-0.5F, "-.5"},    {1234567.25F, " 1234567"},
      {2.5F, " 2.5"},  {1E-5F, " 1E-05"}, {0.0264496896F, " .02644969"}};
  for (const auto& [accuracy, text] : cases) {
    game.Players(1).Active = true;
    game.Players(1).Accuracy = accuracy;
    EXPECT_THAT(Written(), HasSubstr("<Accuracy>" + std::string(text) + "</Accuracy>"));
  }
}

TEST_F(Writing, EscapesWhatXmlReserves) {
  game.ObjectiveTeams(1).Name = "<]]>";
  game.GameDate = "a & \"b\" 'c'\rd";
  const std::string written = WriteGameFile(game, "Cat & <Mouse>");
  EXPECT_THAT(written, HasSubstr("<MissionName>Cat &amp; &lt;Mouse&gt;</MissionName>"));
  EXPECT_THAT(written, HasSubstr("<Name>&lt;]]&gt;</Name>"));
  EXPECT_THAT(written, HasSubstr("<GameDate>a &amp; \"b\" 'c'&#13;d</GameDate>"));
}

TEST_F(Writing, IsInUtf8) {
  const StringTable chinese(Language::SimplifiedChinese);
  Game chineseGame(chinese);
  chineseGame.Players(40).Active = true;
  chineseGame.Players(40).HitByPlayer(1) = 5;
  const std::string written = WriteGameFile(chineseGame, "城堡");
  EXPECT_THAT(written, HasSubstr("<MissionName>城堡</MissionName>"));
  EXPECT_THAT(written, HasSubstr("<Name>红队</Name>"));
  EXPECT_THAT(written, HasSubstr("<PlayerID>蓝队  7</PlayerID>"));
  EXPECT_THAT(written, HasSubstr("<PlayerID>红队  0</PlayerID>"));
}

class SavedGame : public testing::Test {
 protected:
  /// Saves `saved`, loads it into `loaded` and returns the name of its mission.
  std::string Reload(const Game& saved, const std::string& missionName) {
    std::string mission;
    EXPECT_TRUE(ReadGameFile(WriteGameFile(saved, missionName), *loaded,
                             [&mission](const std::string& name) { mission = name; }));
    return mission;
  }

  StringTable strings{Language::English};
  std::unique_ptr<Game> loaded = std::make_unique<Game>(strings);
};

TEST_F(SavedGame, GivesBackEveryField) {
  for (const int count : {0, 1, 75, PlayerCount}) {
    const auto saved = std::make_unique<Game>(strings);
    FillRandomly(*saved, count, static_cast<unsigned>(count));
    saved->GameDate = "2026/11/21 下午 3:05";
    saved->ObjectiveTeams(1) = {"红队", true, false};
    saved->ObjectiveTeams(3) = {"Blue", false, true};
    int number = 0;
    for (Player& player : saved->Players) {
      ++number;
      player.TotalDamage = player.Soldiering = -number;
      player.MemberIndex = player.Rank = static_cast<std::int16_t>(number);
      player.DallasID = "EFCDAB89674523" + std::to_string(10 + number % 90);
    }
    loaded = std::make_unique<Game>(strings);
    EXPECT_EQ(Reload(*saved, "城堡 & <夜>"), "城堡 & <夜>");
    for (Player& player : saved->Players) {
      if (!player.Active) {
        player = Player();
      }
    }
    ExpectSameGame(*loaded, *saved);
  }
}

TEST_F(SavedGame, LosesNegativeHits) {
  Game saved(strings);
  saved.Players(1).Active = true;
  saved.Players(1).HitByPlayer(9) = -4;
  saved.Players(1).HitByPlayer(10) = 4;
  Reload(saved, "None");
  EXPECT_EQ(loaded->Players(1).HitByPlayer(9), 0);
  EXPECT_EQ(loaded->Players(1).HitByPlayer(10), 4);
}

TEST_F(SavedGame, IsNotSpoiltByBytesThatAreNoCharacter) {
  Game saved(strings);
  ASSERT_TRUE(
      ReadGameFile("<GameData><GameHeader><MissionName>任</MissionName><GameDate>&#xD800;</GameDate></"
                   "GameHeader></GameData>",
                   saved, [](const std::string&) {}));
  EXPECT_EQ(Reload(saved, "任"), "任");
  EXPECT_EQ(loaded->GameDate, saved.GameDate);
}

}  // namespace
