#include "core/game/ScoreAnalysis.h"

#include <gmock/gmock.h>

#include <limits>
#include <memory>
#include <utility>

#include "tests/support/Described.h"
#include "tests/support/RandomGame.h"
#include "tests/support/Reckoning.h"
#include "tests/support/ScoredGame.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;

constexpr int Red0 = 1;
constexpr int Red1 = 2;
constexpr int Blue0 = 33;
constexpr int Blue7 = 40;
constexpr int Yellow0 = 65;
constexpr int Red32 = 97;
constexpr int Blue95 = 224;

constexpr std::int32_t Most = std::numeric_limits<std::int32_t>::max();

TEST(CalculateScores, AddsUpTheWorkedExample) {
  ScoredGame venue;
  Player& player = venue.Activate(Red0);
  player.HealCount = 1;
  player.DeathCount = 3;
  player.AmmoAddCount = 2;
  player.PrimaryDamage = 10;
  player.ShotCount = 60;
  player.BonusPoints = 5;
  venue.game.Players(Blue0).HitByPlayer(Red0) = 270;
  venue.game.Players(Red1).HitByPlayer(Red0) = 30;
  venue.CalculateScores();
  EXPECT_EQ(player.TotalDamage, 240);
  EXPECT_EQ(player.AbsoluteDamage, 300);
  EXPECT_EQ(player.Accuracy, 0.5F);
  EXPECT_EQ(player.Soldiering, 289);
  EXPECT_THAT(venue.BoardCells().at(0),
              ElementsAre("1", "Red  0", " 289", "50.00%", " 240", " 60", " 1", " 3", " 2"));
}

TEST(CalculateScores, WithoutPlayersShowsThreeTeamsWithNothing) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    ScoredGame venue(language);
    venue.CalculateScores();
    EXPECT_EQ(venue.Board.RowCount(), 0);
    const bool english = language == Language::English;
    EXPECT_THAT(venue.TeamCells(), ElementsAre(ElementsAre("1", english ? "Red" : "红队", " 0"),
                                               ElementsAre("2", english ? "Blue" : "蓝队", " 0"),
                                               ElementsAre("3", english ? "Yellow" : "黄队", " 0")));
  }
}

TEST(CalculateScores, AgreesWithALongHandReckoningOfRandomGames) {
  for (const double friendlyFire : {-1.0, 0.5, 0.1, -0.37, 2.5e-7, 0.0, 3.0}) {
    for (const int count : {3, 40, 224}) {
      for (const int mode : {MissionList::None, MissionList::FreeForAll}) {
        SCOPED_TRACE(std::to_string(count) + " players, friendly fire " + std::to_string(friendlyFire));
        ScoredGame venue;
        FillRandomly(venue.game, count, 7U * static_cast<unsigned>(count + mode));
        venue.Factors = {1.25, -2, -0.5, 0.75, 1.5, friendlyFire};
        venue.Open();
        venue.Missions->Select(mode);
        venue.Board.SortOrder = count == 40 ? SortOrder::Ascending : SortOrder::Descending;
        ExpectReckonedScores(venue, {.Factors = venue.Factors,
                                     .FreeForAll = mode == MissionList::FreeForAll,
                                     .SortOrder = venue.Board.SortOrder});
      }
    }
  }
}

TEST(CalculateScores, ChangesNothingWhenRepeated) {
  ScoredGame venue;
  venue.AddMission("'Keep', 100.5, 10.5, 0.5, 7, -30.25, 2.5, 0.5, -1.25");
  ExecuteSql(venue.MembersFile(),
             "INSERT INTO Members (DallasID, NickName) VALUES ('AA00000000000001', 'Mole')");
  FillRandomly(venue.game, 90, 3);
  venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
  venue.Activate(Blue7).DallasID = "AA00000000000001";
  venue.Factors = {1.25, -2, -0.5, 0.75, 1.5, 0.5};
  venue.Open();
  venue.Missions->Select(2);
  venue.CalculateScores();
  const auto game = std::make_unique<Game>(venue.game);
  const auto board = venue.BoardCells();
  const auto teams = venue.TeamCells();
  venue.CalculateScores();
  ExpectSameGame(venue.game, *game);
  EXPECT_EQ(venue.BoardCells(), board);
  EXPECT_EQ(venue.TeamCells(), teams);
}

TEST(CalculateScores, TellsTheViewsOfBothListsInTheEnd) {
  ScoredGame venue;
  venue.Activate(Red0);
  int boardRows = 99;
  int teamRows = 99;
  venue.BoardChanged = [&] { boardRows = venue.Board.RowCount(); };
  venue.TeamsChanged = [&] { teamRows = venue.Teams.RowCount(); };
  venue.CalculateScores();
  EXPECT_EQ(boardRows, 1U);
  EXPECT_EQ(teamRows, 3U);
}

TEST(Soldiering, RoundsHalvesToTheEvenNumber) {
  const std::pair<double, int> cases[] = {{2.5, 2}, {3.5, 4},  {-2.5, -2},   {-3.5, -4},
                                          {0.5, 0}, {-0.5, 0}, {2.500001, 3}};
  for (const auto& [sum, expected] : cases) {
    ScoredGame venue;
    venue.Factors.Heal = sum;
    venue.Activate(Red0).HealCount = 1;
    venue.CalculateScores();
    EXPECT_EQ(venue.game.Players(Red0).Soldiering, expected) << sum;
  }
}

TEST(Soldiering, IsRoundedOnceForTheWholeSum) {
  ScoredGame venue;
  venue.Factors = {.Damage = 0.5, .Death = 0.5, .Heal = 0.5, .Ammo = 0.5, .Accuracy = 0, .FriendlyFire = -1};
  Player& player = venue.Activate(Red0);
  player.HealCount = player.DeathCount = player.AmmoAddCount = 1;
  venue.game.Players(Blue0).HitByPlayer(Red0) = 1;
  venue.CalculateScores();
  EXPECT_EQ(player.Soldiering, 2);
}

TEST(Soldiering, TakesEachCountByItsOwnFactor) {
  ScoredGame venue;
  venue.Factors = {
      .Damage = 100000, .Death = 10000, .Heal = 1000, .Ammo = 100, .Accuracy = 0.1, .FriendlyFire = -1};
  Player& player = venue.Activate(Red0);
  player.HealCount = 2;
  player.DeathCount = 3;
  player.AmmoAddCount = 4;
  player.Accuracy = 0.5F;  // kept: no primary damage
  player.BonusPoints = 6;
  player.RespawnCount = player.AdminKillCount = player.StunCount = player.ExplosiveDamage = 7;
  venue.game.Players(Blue0).HitByPlayer(Red0) = 1;
  venue.CalculateScores();
  EXPECT_EQ(player.Soldiering, 132411);
}

// 0.3 is a little below three tenths: five times that is below 1.5, but exactly 1.5 in double precision,
// which would round to 2.
TEST(Soldiering, IsReckonedInMoreThanDoublePrecision) {
  const std::pair<double SoldieringFactors::*, std::int32_t Player::*> cases[] = {
      {&SoldieringFactors::Heal, &Player::HealCount},
      {&SoldieringFactors::Death, &Player::DeathCount},
      {&SoldieringFactors::Ammo, &Player::AmmoAddCount}};
  for (const auto& [factor, count] : cases) {
    ScoredGame venue;
    venue.Factors = {0, 0, 0, 0, 0, 0};
    venue.Factors.*factor = 0.3;
    venue.Activate(Red0).*count = 5;
    venue.CalculateScores();
    EXPECT_EQ(venue.game.Players(Red0).Soldiering, 1);
  }
  ScoredGame venue;
  venue.Factors = {.Damage = 0.3, .Death = 0, .Heal = 0, .Ammo = 0, .Accuracy = 0.03, .FriendlyFire = 0.3};
  venue.game.Players(Blue0).HitByPlayer(Red0) = 5;
  venue.Activate(Red0);
  venue.Activate(Red1).Accuracy = 0.5F;
  venue.game.Players(Yellow0).HitByPlayer(Yellow0) = 5;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).Soldiering, 1);
  EXPECT_EQ(venue.game.Players(Red1).Soldiering, 1);
  EXPECT_EQ(venue.game.Players(Yellow0).TotalDamage, 1);
}

TEST(Soldiering, LosesNoPointInASumOfLargeFigures) {
  constexpr double twoTo53 = 9007199254740992.0;
  ScoredGame venue;
  venue.Factors = {.Damage = 1, .Death = -twoTo53, .Heal = twoTo53, .Ammo = 0, .Accuracy = 0};
  Player& player = venue.Activate(Red0);
  player.HealCount = player.DeathCount = 1;
  venue.game.Players(Blue0).HitByPlayer(Red0) = 1;
  venue.CalculateScores();
  EXPECT_EQ(player.Soldiering, 1);
}

TEST(Soldiering, OutsideTheRangeIsAnOverflow) {
  for (const double factor : {1e300, -1e300, 2147483648.0, -2147483649.0}) {
    ScoredGame venue;
    venue.Factors.Heal = factor;
    venue.Activate(Red0).HealCount = 1;
    EXPECT_EQ(NumberThrownBy([&venue] { venue.CalculateScores(); }), 6) << factor;
  }
}

TEST(Accuracy, KeepsItsEarlierValueWithoutPrimaryDamageAndStillScores) {
  ScoredGame venue;
  Player& player = venue.Activate(Red0);
  player.Accuracy = 0.25F;
  player.ShotCount = 10;
  venue.CalculateScores();
  EXPECT_EQ(player.Accuracy, 0.25F);
  EXPECT_EQ(player.Soldiering, 25);
  EXPECT_EQ(venue.Cell(0, BoardColumn::Accuracy), "Error");
}

TEST(Accuracy, IsNothingWithoutShots) {
  for (const int shots : {0, -5}) {
    ScoredGame venue;
    Player& player = venue.Activate(Red0);
    player.Accuracy = 0.25F;
    player.PrimaryDamage = 10;
    player.ShotCount = shots;
    venue.game.Players(Blue0).HitByPlayer(Red0) = 100;
    venue.CalculateScores();
    EXPECT_EQ(player.Accuracy, 0);
    EXPECT_EQ(player.Soldiering, 100);
    EXPECT_EQ(venue.Cell(0, BoardColumn::Accuracy), "N/A");
  }
}

TEST(Accuracy, IsRoundedTo32BitsBeforeItEntersTheSum) {
  ScoredGame venue;
  venue.Factors.Accuracy = 1e8;
  venue.Factors.Damage = 0;
  Player& player = venue.Activate(Red0);
  player.PrimaryDamage = 10;
  player.ShotCount = 10;
  venue.game.Players(Blue0).HitByPlayer(Red0) = 10;
  venue.CalculateScores();
  EXPECT_EQ(player.Accuracy, 0.1F);
  EXPECT_EQ(player.Soldiering, 1'000'000'015);  // 0.1F is 0.100000001490116...
  EXPECT_EQ(venue.Cell(0, BoardColumn::Accuracy), "10.00%");
}

TEST(Accuracy, DividesByThePrimaryDamageFirst) {
  ScoredGame venue;
  venue.Factors.Damage = 0;
  Player& player = venue.Activate(Red0);
  player.PrimaryDamage = 15;
  player.ShotCount = 1'484'648'573;
  venue.game.Players(Blue0).HitByPlayer(Red0) = 589'027'389;
  venue.CalculateScores();
  EXPECT_EQ(player.Accuracy, 0.0264496896F);  // the other order and one division give 0.0264496878F
}

TEST(Accuracy, OfShotsThatAllMissedIsShownAsZero) {
  ScoredGame venue;
  Player& player = venue.Activate(Red0);
  player.PrimaryDamage = 10;
  player.ShotCount = 1;
  venue.CalculateScores();
  EXPECT_EQ(player.Accuracy, 0);
  EXPECT_EQ(venue.Cell(0, BoardColumn::Accuracy), "0.00%");
}

TEST(Accuracy, CountsOwnTeamHitsInFull) {
  ScoredGame venue;
  Player& player = venue.Activate(Red0);
  player.PrimaryDamage = 10;
  player.ShotCount = 3;
  venue.game.Players(Red1).HitByPlayer(Red0) = 10;
  venue.game.Players(Blue0).HitByPlayer(Red0) = 10;
  venue.CalculateScores();
  EXPECT_EQ(player.Accuracy, 0.6666666865F);
  EXPECT_EQ(venue.Cell(0, BoardColumn::Accuracy), "66.67%");
}

TEST(TeamTotals, SumTheActivePlayersOfEachTeam) {
  ScoredGame venue;
  venue.Activate(Red0).BonusPoints = 5;
  venue.Activate(Red32).BonusPoints = 7;
  venue.Activate(Blue95).BonusPoints = -11;
  venue.game.Players(Yellow0).BonusPoints = 100;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.TeamTotals(1), 12);
  EXPECT_EQ(venue.game.TeamTotals(2), -11);
  EXPECT_EQ(venue.game.TeamTotals(3), 0);
  EXPECT_THAT(venue.TeamCells(), ElementsAre(ElementsAre("1", "Red", " 12"), ElementsAre("2", "Yellow", " 0"),
                                             ElementsAre("3", "Blue", "-11")));
}

TEST(TeamTotals, StayInDescendingOrderWhateverTheBoardDoes) {
  ScoredGame venue;
  venue.Activate(Blue0).BonusPoints = 9;
  venue.CalculateScores();
  SortByHeader(venue.Board, 1, venue.game);
  venue.CalculateScores();
  EXPECT_EQ(venue.TeamCells().at(0).at(1), "Blue");
}

TEST(TeamTotals, OutsideTheRangeAreAnOverflow) {
  ScoredGame venue;
  venue.Activate(Red0).BonusPoints = Most;
  venue.Activate(Red1).BonusPoints = 1;
  EXPECT_EQ(NumberThrownBy([&venue] { venue.CalculateScores(); }), 6);
}

}  // namespace
