#include <gtest/gtest.h>

#include "core/GameFile.h"

namespace {

/// One leaf as it stands in the file.
std::string Leaf(const std::string& name, const std::string& text) {
  return "    <" + name + ">" + text + "</" + name + ">\r\n";
}

class Writing : public testing::Test {
 protected:
  StringTable strings{Language::English};
  Game game{strings};
};

TEST_F(Writing, OfAGameWithoutPlayersLeavesPlayerDataEmpty) {
  game.GameDate = "21/05/2013 14:30";
  game.ObjectiveTeams(2).Name = "Red";
  game.ObjectiveTeams(2).PrimaryAchieved = true;
  game.ObjectiveTeams(3).SecondaryAchieved = true;
  const std::string expected =
      "<GameData><GameHeader>" + Leaf("MissionName", "None") +                                                      //
      "<Team>" + Leaf("PrimaryObjectiveAchieved", "0") + Leaf("SecondryObjectiveAchieved", "0") +                   //
      Leaf("Name", "Red") + "</Team>" +                                                                             //
      "<Team>" + Leaf("PrimaryObjectiveAchieved", "1") + Leaf("SecondryObjectiveAchieved", "0") +                   //
      Leaf("Name", "Red") + "</Team>" +                                                                             //
      "<Team>" + Leaf("PrimaryObjectiveAchieved", "0") + Leaf("SecondryObjectiveAchieved", "1") +                   //
      Leaf("Name", "Yellow") + "</Team>" + Leaf("GameDate", "21/05/2013 14:30") + "</GameHeader><PlayerData/>" +  //
      "</GameData>";
  std::string written = WriteGameFile(game, "None");
  if (const auto at = written.find("<PlayerData />"); at != std::string::npos) {
    written.erase(at + 11, 1);
  }
  EXPECT_EQ(written, expected);
}

TEST_F(Writing, PutsEveryFieldOfAPlayerInItsPlace) {
  Player& player = game.Players(40);
  player.Active = true;
  player.HitByPlayer(1) = 25;
  player.HitByPlayer(2) = -3;
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
  game.Players(41).ShotCount = 5;  // not active
  const std::string expected =
      "<PlayerData><Player>" + Leaf("Index", " 40") + Leaf("PlayerID", "Blue  7") + "<HitData>" +             //
      "<HitByPlayer>" + Leaf("Index", " 1") + Leaf("PlayerID", "Red  0") + Leaf("Amount", " 25") +            //
      "</HitByPlayer>" +                                                                                      //
      "<HitByPlayer>" + Leaf("Index", " 224") + Leaf("PlayerID", "Blue  95") + Leaf("Amount", " 7") +         //
      "</HitByPlayer></HitData>" +                                                                            //
      Leaf("ShotCount", " 42") + Leaf("TotalDamage", "-60") + Leaf("TotalDamage", "-60") +                    //
      Leaf("Soldiering", " 3") + Leaf("HealCount", " 4") + Leaf("AmmoAddCount", " 5") +                       //
      Leaf("AdminKillCount", " 6") + Leaf("RespawnCount", " 7") + Leaf("DeathCount", " 8") +                  //
      Leaf("RunCounter", " 9") + Leaf("Active", "1") + Leaf("Committed", "1") + Leaf("RemainingHealth", " 10") +  //
      Leaf("RemainingClips", " 11") + Leaf("RemainingAmmo", " 12") + Leaf("SecondaryDamage", " 13") +         //
      Leaf("PrimaryDamage", " 14") + Leaf("Accuracy", " .5") + Leaf("Rank", " 15") +                          //
      Leaf("MemberIndex", " 16") + Leaf("DallasID", "EFCDAB8967452301") + Leaf("ExplosiveDamage", " 17") +    //
      Leaf("RadiationDamage", " 18") + Leaf("StunCount", " 19") + Leaf("PowerCheatFlag", " 200") +            //
      Leaf("BonusPoints", "-20") + "</Player></PlayerData></GameData>";
  const std::string written = WriteGameFile(game, "None");
  EXPECT_EQ(written.substr(written.find("<PlayerData>")), expected);
}

TEST_F(Writing, EscapesWhatXmlReserves) {
  EXPECT_NE(WriteGameFile(game, "Cat & <Mouse>").find("<MissionName>Cat &amp; &lt;Mouse&gt;</MissionName>"),
            std::string::npos);
}

}  // namespace
