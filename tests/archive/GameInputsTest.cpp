#include "archive/GameInputs.h"

#include <gtest/gtest.h>

#include <functional>
#include <set>

#include "tests/archive/ArchiveVenue.h"

namespace {

class Inputs : public testing::Test {
 protected:
  std::string Hash() const { return GameInputsHash(GameInputs(venue.Game, "Flag")); }

  ArchiveVenue venue;
};

TEST_F(Inputs, SurviveTheGameFile) {
  for (const unsigned seed : {1U, 2U, 3U}) {
    Game game(venue.Strings);
    FillRandomly(game, 60, seed);
    game.GameDate = "21.11.2026 20:15 \"<&>\"";
    game.ObjectiveTeams(2).SecondaryAchieved = true;
    game.Players(1).Active = true;
    game.Players(1).HitByPlayer(3) = -5;
    EXPECT_EQ(GameInputs(venue.Read(WriteGameFile(game, "Flag")), "Flag"), GameInputs(game, "Flag"));
  }
}

TEST_F(Inputs, AreNotWhatIsCalculatedFromThem) {
  const std::string before = Hash();
  Player& player = venue.Game.Players(ArchiveVenue::Blue7);
  player.Rank = 7;
  player.Soldiering = 1;
  player.TotalDamage = 1;
  player.AbsoluteDamage = 1;
  player.Accuracy = 0.5F;
  venue.Game.TeamTotals(2) = 9;
  venue.Game.Players(3).ShotCount = 8;  // took no part
  EXPECT_EQ(Hash(), before);
}

TEST_F(Inputs, ChangeWithEveryOneOfThem) {
  using Change = std::function<void(Player&, Game&)>;
  const std::vector<Change> changes = {
      [](Player& p, Game&) { ++p.ShotCount; },
      [](Player& p, Game&) { ++p.HealCount; },
      [](Player& p, Game&) { ++p.AmmoAddCount; },
      [](Player& p, Game&) { ++p.AdminKillCount; },
      [](Player& p, Game&) { ++p.RespawnCount; },
      [](Player& p, Game&) { ++p.RemainingHealth; },
      [](Player& p, Game&) { ++p.RemainingClips; },
      [](Player& p, Game&) { ++p.RemainingAmmo; },
      [](Player& p, Game&) { ++p.DeathCount; },
      [](Player& p, Game&) { ++p.SecondaryDamage; },
      [](Player& p, Game&) { ++p.PrimaryDamage; },
      [](Player& p, Game&) { ++p.RunCounter; },
      [](Player& p, Game&) { p.MemberIndex = 6; },
      [](Player& p, Game&) { p.Committed = false; },
      [](Player& p, Game&) { --p.BonusPoints; },
      [](Player& p, Game&) { ++p.ExplosiveDamage; },
      [](Player& p, Game&) { ++p.RadiationDamage; },
      [](Player& p, Game&) { ++p.StunCount; },
      [](Player& p, Game&) { ++p.PowerCheatFlag; },
      [](Player& p, Game&) { p.DallasID = "CC00000000000001"; },
      [](Player& p, Game&) { p.HitByPlayer(3) = 10; },
      [](Player& p, Game&) {
        p.HitByPlayer(31) = 0;
        p.HitByPlayer(3) = 1;
      },
      [](Player& p, Game&) { p.Active = false; },
      [](Player&, Game& g) { g.Players(3).Active = true; },
      [](Player&, Game& g) { g.GameDate += " "; },
      [](Player&, Game& g) { g.ObjectiveTeams(1).PrimaryAchieved = true; },
      [](Player&, Game& g) { g.ObjectiveTeams(3).SecondaryAchieved = true; },
      [](Player&, Game& g) { g.ObjectiveTeams(2).Name = "Red"; },
  };
  std::set<std::string> hashes = {Hash(), GameInputsHash(GameInputs(venue.Game, "Flags"))};
  for (const Change& change : changes) {
    const Game before = venue.Game;
    change(venue.Game.Players(ArchiveVenue::Blue7), venue.Game);
    hashes.insert(Hash());
    venue.Game = before;
  }
  EXPECT_EQ(hashes.size(), changes.size() + 2);
}

TEST_F(Inputs, HoldAnAccuracyThatIsNotCalculated) {
  Player& player = venue.Game.Players(ArchiveVenue::Blue7);
  player.PrimaryDamage = 0;
  const std::string before = Hash();
  player.Accuracy = 0.75F;
  EXPECT_NE(Hash(), before);
}

}  // namespace
