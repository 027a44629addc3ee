#include "core/ScoreAnalysis.h"

#include <gmock/gmock.h>

#include <cmath>
#include <random>

#include "core/NumberForms.h"
#include "tests/core/ScoredGame.h"
#include "tests/platform/linux/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr int Red0 = 1;
constexpr int Red1 = 2;
constexpr int Blue0 = 33;
constexpr int Blue7 = 40;
constexpr int Yellow0 = 65;

/// Half to even, written out.
long long HalfEven(long double value) {
  const long double below = std::floor(value);
  const long double rest = value - below;
  const auto low = static_cast<long long>(below);
  return rest > 0.5L || (rest == 0.5L && low % 2 != 0) ? low + 1 : low;
}

int TeamOf(int index) {
  const int id = index + 31;
  return id < 64 || (id >= 128 && id < 192) ? 1 : id < 96 || id >= 192 ? 2 : 3;
}

/// Fills every counter and hit of `count` players of all teams, from `seed`.
void FillRandomly(Game& game, int count, unsigned seed) {
  std::mt19937 random(seed);
  const auto upTo = [&random](int most) { return static_cast<std::int32_t>(random() % (most + 1u)); };
  std::vector<int> indexes(PlayerCount);
  for (int i = 0; i < PlayerCount; ++i) {
    indexes[i] = i + 1;
  }
  std::shuffle(indexes.begin(), indexes.end(), random);
  indexes.resize(count);
  for (const int index : indexes) {
    Player& player = game.Players(index);
    player.Active = true;
    player.ShotCount = upTo(2000);
    player.HealCount = upTo(9);
    player.DeathCount = upTo(20);
    player.AmmoAddCount = upTo(9);
    player.RespawnCount = upTo(20);
    player.PrimaryDamage = upTo(8) * 5;
    player.BonusPoints = upTo(40) - 20;
    for (const int shooter : indexes) {
      player.HitByPlayer(shooter) = upTo(3) == 0 ? upTo(120) : 0;
    }
  }
}

/// Soldiering of one player without mission points, computed the long way.
long long ExpectedSoldiering(const Game& game, const SoldieringFactors& factors, bool freeForAll, int p) {
  long long total = 0;
  long long absolute = 0;
  for (int q = 1; q <= PlayerCount; ++q) {
    const long long hit = game.Players(q).HitByPlayer(p);
    if (!freeForAll && TeamOf(q) == TeamOf(p)) {
      total = HalfEven(static_cast<long double>(hit) * factors.FriendlyFire + total);
    } else {
      total += hit;
    }
    absolute += hit;
  }
  const Player& player = game.Players(p);
  float accuracy = player.Accuracy;
  if (player.PrimaryDamage != 0) {
    accuracy = player.ShotCount > 0 ? static_cast<float>(static_cast<double>(absolute) / player.PrimaryDamage /
                                                         player.ShotCount)
                                    : 0;
  }
  return HalfEven(player.HealCount * static_cast<long double>(factors.Heal) +
                  total * static_cast<long double>(factors.Damage) +
                  player.DeathCount * static_cast<long double>(factors.Death) +
                  player.AmmoAddCount * static_cast<long double>(factors.Ammo) +
                  accuracy * 100.0L * factors.Accuracy + player.BonusPoints);
}

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
  EXPECT_THAT(venue.Board.Rows().at(0).Cells,
              ElementsAre("1", "Red  0", " 289", "50.00%", " 240", " 60", " 1", " 3", " 2"));
}

TEST(CalculateScores, WithoutPlayersShowsThreeTeamsWithNothing) {
  ScoredGame venue;
  venue.CalculateScores();
  EXPECT_THAT(venue.Board.Rows(), IsEmpty());
  ASSERT_EQ(venue.Teams.Rows().size(), 3u);
  EXPECT_THAT(venue.Teams.Rows()[0].Cells, ElementsAre("1", "Red", " 0"));
  EXPECT_THAT(venue.Teams.Rows()[1].Cells, ElementsAre("2", "Blue", " 0"));
  EXPECT_THAT(venue.Teams.Rows()[2].Cells, ElementsAre("3", "Yellow", " 0"));
}

TEST(CalculateScores, AgreesWithALongHandCalculationOfRandomGames) {
  for (const double friendlyFire : {-1.0, 0.5, 0.1, -0.37, 2.5e-7, 0.0, 3.0}) {
    for (const int count : {3, 40, 224}) {
      for (const int mode : {MissionList::None, MissionList::FreeForAll}) {
        ScoredGame venue;
        FillRandomly(venue.game, count, 7u * count + mode);
        venue.Factors = {1.25, -2, -0.5, 0.75, 1.5, friendlyFire};
        venue.Open();
        venue.Missions->Select(mode);
        venue.CalculateScores();
        ASSERT_EQ(venue.Board.Rows().size(), static_cast<std::size_t>(count));
        for (int index = 1; index <= PlayerCount; ++index) {
          if (venue.game.Players(index).Active) {
            ASSERT_EQ(venue.game.Players(index).Soldiering,
                      ExpectedSoldiering(venue.game, venue.Factors, mode == MissionList::FreeForAll, index))
                << index << " of " << count << ", friendly fire " << friendlyFire;
          }
        }
      }
    }
  }
}

TEST(CalculateScores, ChangesNothingWhenRepeated) {
  ScoredGame venue;
  FillRandomly(venue.game, 60, 3);
  venue.CalculateScores();
  const auto rowsBefore = venue.Column(BoardColumn::Player);
  const auto scoresBefore = venue.Column(BoardColumn::Soldiering);
  venue.CalculateScores();
  EXPECT_EQ(venue.Column(BoardColumn::Player), rowsBefore);
  EXPECT_EQ(venue.Column(BoardColumn::Soldiering), scoresBefore);
}

TEST(CalculateScores, RoundsOwnTeamHitsCellByCell) {
  ScoredGame venue;
  venue.Factors.FriendlyFire = 0.5;
  venue.Activate(Red0);
  venue.game.Players(Red1).HitByPlayer(Red0) = 1;
  venue.game.Players(3).HitByPlayer(Red0) = 1;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, 0);
  EXPECT_EQ(venue.game.Players(Red0).AbsoluteDamage, 2);
}

TEST(CalculateScores, TakesOwnTeamHitsOffAndSortsNegativeScoresLast) {
  ScoredGame venue;
  venue.Activate(Red0);
  venue.Activate(Blue0);
  venue.game.Players(Red1).HitByPlayer(Red0) = 50;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, -50);
  EXPECT_THAT(venue.Column(BoardColumn::Soldiering), ElementsAre(" 0", "-50"));
}

TEST(CalculateScores, CountsOwnTeamHitsInFullInFreeForAll) {
  ScoredGame venue;
  venue.Activate(Red0);
  venue.game.Players(Red1).HitByPlayer(Red0) = 50;
  venue.game.Players(Red0).HitByPlayer(Red0) = 7;
  venue.Open();
  venue.Missions->Select(MissionList::FreeForAll);
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, 57);
}

TEST(CalculateScores, TakesSelfHitsForFriendlyFire) {
  ScoredGame venue;
  venue.Activate(Red0).HitByPlayer(Red0) = 7;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, -7);
}

TEST(CalculateScores, CountsHitsOnPlayersWhoAreNotActive) {
  ScoredGame venue;
  venue.Activate(Red0);
  venue.game.Players(Yellow0).HitByPlayer(Red0) = 11;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, 11);
}

TEST(CalculateScores, RewritesTheDamageOfInactivePlayersToo) {
  ScoredGame venue;
  venue.game.Players(Red0).TotalDamage = 99;
  venue.game.Players(Red0).AbsoluteDamage = 99;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).TotalDamage, 0);
  EXPECT_EQ(venue.game.Players(Red0).AbsoluteDamage, 0);
}

TEST(CalculateScores, RoundsHalvesToTheEvenScore) {
  const std::pair<double, int> cases[] = {{0.025, 2}, {0.035, 4}, {-0.025, -2}};
  for (const auto& [factor, expected] : cases) {
    ScoredGame venue;
    venue.Factors = {0, 0, 0, 0, 0, -1};
    venue.Factors.Heal = factor * 100;
    venue.Activate(Red0).HealCount = 1;
    venue.CalculateScores();
    EXPECT_EQ(venue.game.Players(Red0).Soldiering, expected);
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
    venue.CalculateScores();
    EXPECT_EQ(player.Accuracy, 0);
    EXPECT_EQ(venue.Cell(0, BoardColumn::Accuracy), "N/A");
  }
}

TEST(Accuracy, IsStoredWith32Bits) {
  ScoredGame venue;
  Player& player = venue.Activate(Red0);
  player.PrimaryDamage = 10;
  player.ShotCount = 3;
  venue.game.Players(Blue0).HitByPlayer(Red0) = 10;
  venue.CalculateScores();
  EXPECT_EQ(player.Accuracy, static_cast<float>(10.0 / 10 / 3));
  EXPECT_EQ(venue.Cell(0, BoardColumn::Accuracy), "33.33%");
}

TEST(CalculateScores, FailsOnASumThatLeavesTheRange) {
  ScoredGame venue;
  venue.Activate(Red0);
  venue.game.Players(Blue0).HitByPlayer(Red0) = 2147483647;
  venue.game.Players(Blue7).HitByPlayer(Red0) = 1;
  EXPECT_EQ(NumberThrownBy([&venue] { venue.CalculateScores(); }), 6);
  ScoredGame weighted;
  weighted.Factors.Heal = 1e300;
  weighted.Activate(Red0).HealCount = 1;
  EXPECT_EQ(NumberThrownBy([&weighted] { weighted.CalculateScores(); }), 6);
  ScoredGame friendly;
  friendly.Factors.FriendlyFire = 1e9;
  friendly.game.Players(Red1).HitByPlayer(Red0) = 3;
  EXPECT_EQ(NumberThrownBy([&friendly] { friendly.CalculateScores(); }), 6);
}

TEST(TeamTotals, SumTheActivePlayersOfEachTeam) {
  ScoredGame venue;
  venue.Activate(Red0).BonusPoints = 5;
  venue.Activate(97).BonusPoints = 7;    // red 32
  venue.Activate(224).BonusPoints = 11;  // blue 95
  venue.game.Players(Yellow0).BonusPoints = 100;
  venue.CalculateScores();
  EXPECT_EQ(venue.game.TeamTotals(1), 12);
  EXPECT_EQ(venue.game.TeamTotals(2), 11);
  EXPECT_EQ(venue.game.TeamTotals(3), 0);
  EXPECT_THAT(venue.Teams.Rows()[0].Cells, ElementsAre("1", "Red", " 12"));
}

TEST(Ranks, GoIntoThePlayersOwnRecordsUpToNumber31) {
  ScoredGame venue;
  venue.Activate(32).BonusPoints = 1;       // red 31
  venue.Activate(64).BonusPoints = 3;       // blue 31
  venue.Activate(Yellow0).BonusPoints = 2;  // yellow 0
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(64).Rank, 1);
  EXPECT_EQ(venue.game.Players(Yellow0).Rank, 2);
  EXPECT_EQ(venue.game.Players(32).Rank, 3);
}

TEST(Ranks, OfNumbersFrom32UpGoIntoAnotherRecord) {
  ScoredGame venue;
  venue.Activate(97);   // red 32: base 1 + 32
  venue.Activate(161).BonusPoints = 9;  // blue 32: base 33 + 32
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(33).Rank, 2);
  EXPECT_EQ(venue.game.Players(65).Rank, 1);
  EXPECT_EQ(venue.game.Players(97).Rank, 0);
  EXPECT_THAT(venue.Column(BoardColumn::Rank), ElementsAre("1", "2"));
}

TEST(Ranks, AreConsecutiveAlsoForEqualScores) {
  ScoredGame venue;
  for (const int index : {3, 1, 2}) {
    venue.Activate(index);
  }
  venue.CalculateScores();
  EXPECT_THAT(venue.Column(BoardColumn::Player), ElementsAre("Red  0", "Red  1", "Red  2"));
  EXPECT_THAT(venue.Column(BoardColumn::Rank), ElementsAre("1", "2", "3"));
}

TEST(Ranks, RunUpwardAfterAClickOnOneOfTheFirstTwoColumns) {
  for (const int header : {1, 2}) {
    ScoredGame venue;
    venue.Activate(Red0).BonusPoints = 5;
    venue.Activate(Blue0).BonusPoints = 9;
    venue.CalculateScores();
    SortByHeader(venue.Board, header, venue.game);
    venue.CalculateScores();
    EXPECT_THAT(venue.Column(BoardColumn::Soldiering), ElementsAre(" 5", " 9"));
    EXPECT_EQ(venue.game.Players(Red0).Rank, 1);
    SortByHeader(venue.Board, 5, venue.game);
    venue.CalculateScores();
    EXPECT_THAT(venue.Column(BoardColumn::Soldiering), ElementsAre(" 9", " 5"));
  }
}

class MissionScores : public testing::Test {
 protected:
  MissionScores() {
    ExecuteSql(venue.ScenariosFile(),
               "INSERT INTO Table1 (MissionName, PrimaryObjectivePointsA, SecondaryObjectivePointsA, "
               "PrimaryObjectivePointsB, SecondaryObjectivePointsB, PrimaryObjectivePointsC, "
               "SecondaryObjectivePointsC, RespawnPenalty, HealPenalty) "
               "VALUES ('Test', 100, 10, 200, 20, 400, 40, 0, 0)");
    venue.Factors = {0, 0, 0, 0, 0, -1};
    venue.Activate(Red0);
    venue.Activate(Blue0);
    venue.Activate(Yellow0);
  }

  void Score() {
    venue.Open();
    venue.Missions->Select(2);
    venue.CalculateScores();
  }

  int ScoreOf(int index) { return venue.game.Players(index).Soldiering; }

  ScoredGame venue;
};

TEST_F(MissionScores, PayOnlyTheTeamThatPlaysTheSet) {
  venue.game.ObjectiveTeams(2).PrimaryAchieved = true;
  Score();
  EXPECT_EQ(ScoreOf(Red0), 0);
  EXPECT_EQ(ScoreOf(Blue0), 200);
  EXPECT_EQ(ScoreOf(Yellow0), 0);
}

TEST_F(MissionScores, FollowPermutedSets) {
  venue.game.ObjectiveTeams(1).Name = "Yellow";
  venue.game.ObjectiveTeams(1).SecondaryAchieved = true;
  venue.game.ObjectiveTeams(3).Name = "Red";
  venue.game.ObjectiveTeams(3).PrimaryAchieved = true;
  Score();
  EXPECT_EQ(ScoreOf(Red0), 400);
  EXPECT_EQ(ScoreOf(Yellow0), 10);
}

TEST_F(MissionScores, PayBothSetsOfOneTeam) {
  venue.game.ObjectiveTeams(2).Name = "Red";
  venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
  venue.game.ObjectiveTeams(2).PrimaryAchieved = true;
  Score();
  EXPECT_EQ(ScoreOf(Red0), 300);
  EXPECT_EQ(ScoreOf(Blue0), 0);
}

TEST_F(MissionScores, PayNobodyForASetOfAnUnknownTeam) {
  venue.game.ObjectiveTeams(1).Name = "red";
  venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
  Score();
  EXPECT_EQ(ScoreOf(Red0), 0);
}

TEST_F(MissionScores, TakePenaltiesFromEverybodyRoundedOneByOne) {
  ExecuteSql(venue.ScenariosFile(), "UPDATE Table1 SET RespawnPenalty = 0.5, HealPenalty = 1.5");
  venue.game.Players(Red0).RespawnCount = 1;   // 0 - .5 -> 0
  venue.game.Players(Red0).HealCount = 1;      // 0 - 1.5 -> -2
  venue.game.Players(Blue0).RespawnCount = 3;  // -1.5 -> -2
  venue.game.Players(Blue0).HealCount = 1;     // -3.5 -> -4
  Score();
  EXPECT_EQ(ScoreOf(Red0), -2);
  EXPECT_EQ(ScoreOf(Blue0), -4);
  EXPECT_EQ(ScoreOf(Yellow0), 0);
}

TEST_F(MissionScores, AreNotPaidInTheFixedModes) {
  venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
  venue.Open();
  for (const int mode : {MissionList::None, MissionList::FreeForAll}) {
    venue.Missions->Select(mode);
    venue.CalculateScores();
    EXPECT_EQ(ScoreOf(Red0), 0);
  }
}

TEST_F(MissionScores, OfAVanishedMissionAreMissingWithABoxForEachPlayer) {
  venue.game.ObjectiveTeams(1).PrimaryAchieved = true;
  venue.Open();
  venue.Missions->Select(2);
  ExecuteSql(venue.ScenariosFile(), "DELETE FROM Table1");
  venue.CalculateScores();
  EXPECT_EQ(ScoreOf(Red0), 0);
  const FakeMessageBoxes::Box box{"Could not locate selected Mission in Mission Database", "Mission Database Error",
                                  BoxIcon::Exclamation, BoxButtons::Ok};
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(box, box, box));
}

class MemberNames : public testing::Test {
 protected:
  MemberNames() {
    ExecuteSql(venue.MembersFile(),
               "INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName) VALUES "
               "(4, 'AA00000000000001', 'Ann', 'Lee: Jr', NULL), (7, 'BB00000000000001', 'Bo', 'Ray', 'Mole'), "
               "(9, 'BB00000000000001', 'Other', 'One', '')");
  }

  ScoredGame venue;
};

TEST_F(MemberNames, AreFoundByButtonAndStayAssigned) {
  venue.Activate(Red0).DallasID = "BB00000000000001";
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).MemberIndex, 7);
  EXPECT_EQ(venue.Cell(0, BoardColumn::Player), "Red  0: Mole");
}

TEST_F(MemberNames, AreFirstAndLastNameWithoutANickname) {
  venue.Activate(Red0).MemberIndex = 4;
  venue.Activate(97).MemberIndex = 9;
  venue.CalculateScores();
  EXPECT_THAT(venue.Column(BoardColumn::Player), ElementsAre("Red  0: Ann Lee: Jr", "Red  32: Other One"));
  EXPECT_EQ(venue.game.Players(1).Rank, 1);
  EXPECT_EQ(venue.game.Players(33).Rank, 2);
}

TEST_F(MemberNames, AreNotLookedUpWithoutAButton) {
  ExecuteSql(venue.MembersFile(), "UPDATE Members SET DallasID = '0000000000000000'");
  venue.Activate(Red0);
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).MemberIndex, 0);
  EXPECT_EQ(venue.Cell(0, BoardColumn::Player), "Red  0");
}

TEST_F(MemberNames, OfAnUnknownButtonStayEmpty) {
  venue.Activate(Red0).DallasID = "bb00000000000001";
  venue.CalculateScores();
  EXPECT_EQ(venue.game.Players(Red0).MemberIndex, 0);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MemberNames, OfAMemberWhoIsGoneAreMissedInABox) {
  venue.Activate(Red0).MemberIndex = 5;
  venue.CalculateScores();
  EXPECT_EQ(venue.Cell(0, BoardColumn::Player), "Red  0");
  EXPECT_EQ(venue.game.Players(Red0).MemberIndex, 5);
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Could not locate specified Member in database!", "Member Error",
                                                BoxIcon::Exclamation, BoxButtons::Ok}));
}

TEST_F(MemberNames, AppearInChineseBehindTheTeam) {
  ScoredGame chinese(Language::SimplifiedChinese);
  ExecuteSql(chinese.MembersFile(), "INSERT INTO Members (ContactID, NickName) VALUES (1, '小龙')");
  chinese.Activate(Blue7).MemberIndex = 1;
  chinese.CalculateScores();
  EXPECT_EQ(chinese.Cell(0, BoardColumn::Player), chinese.Strings.Text(115) + "  7: 小龙");
  EXPECT_EQ(chinese.game.Players(Blue7).Rank, 1);
}

}  // namespace
