#include "sheets/SheetTexts.h"

#include <gmock/gmock.h>

#include "tests/support/ScoredGame.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;

class Texts : public testing::Test {
 protected:
  void Totals(std::int32_t red, std::int32_t blue, std::int32_t yellow) {
    venue.game.TeamTotals(1) = red;
    venue.game.TeamTotals(2) = blue;
    venue.game.TeamTotals(3) = yellow;
  }

  ScoredGame venue;
};

TEST_F(Texts, TheHighestTotalWinsAndOfEqualsTheLowerTeam) {
  Totals(100, 100, 50);
  EXPECT_EQ(WinningTeam(venue.game), 1);
  Totals(-5, 3, 4);
  EXPECT_EQ(WinningTeam(venue.game), 3);
}

TEST_F(Texts, NobodyWinsWithoutATotalAboveZero) {
  Totals(0, -1, 0);
  EXPECT_EQ(WinningTeam(venue.game), 0);
  EXPECT_THAT(ResultTexts(venue.game, 1, 0)[0], Pair(testing::StrEq("Victory"), "Team Lost!"));
}

TEST_F(Texts, TheLastAchievedPrimaryObjectiveDecidesBeforeAnyTotal) {
  Totals(0, 0, 500);
  venue.game.ObjectiveTeams(2) = {"Blue", true, false};
  EXPECT_EQ(WinningTeam(venue.game), 2);
  venue.game.ObjectiveTeams(3) = {"Red", true, false};
  EXPECT_EQ(WinningTeam(venue.game), 1);
  venue.game.ObjectiveTeams(3) = {"Red", false, true};
  EXPECT_EQ(WinningTeam(venue.game), 2);
  venue.game.ObjectiveTeams(2) = {"Nobody", true, false};
  EXPECT_EQ(WinningTeam(venue.game), 3);
}

TEST_F(Texts, TheResultNamesTeamAndNumber) {
  const BookmarkTexts texts = ResultTexts(venue.game, 166, 2);  // Blue 37
  EXPECT_THAT(texts, ElementsAre(Pair(testing::StrEq("Victory"), "Team Won!"),
                                 Pair(testing::StrEq("PlayerTeam"), "Blue"),
                                 Pair(testing::StrEq("PlayerID"), " 37 ")));
}

TEST(WithoutWeekday, DropsAllUpToTheBlankBehindTheFirstComma) {
  EXPECT_EQ(WithoutWeekday("Sunday, November 15, 2026"), "November 15, 2026");
  EXPECT_EQ(WithoutWeekday("15 November 2026"), "15 November 2026");
  EXPECT_EQ(WithoutWeekday("2026年11月15日"), "2026年11月15日");
  EXPECT_EQ(WithoutWeekday("a,年b"), "b");
  EXPECT_EQ(WithoutWeekday("a,"), "");
  EXPECT_EQ(WithoutWeekday("a,b"), "");
  EXPECT_EQ(WithoutWeekday(""), "");
}

TEST_F(Texts, OfAMemberTellTheHistory) {
  ExecuteSql(
      venue.MembersFile(),
      "INSERT INTO Members (ContactID, FirstName, LastName, NickName, Clan, TotalGamesPlayed, "
      "AveragePrimAccuracy, AverageDamage, AverageSoldiering) VALUES "
      "(1, 'Ann', 'Lee', 'Mole', 'Owls', 12, 0.5, 12.345, 0.125), (2, 'Bo', 'Ray', NULL, '', 0, 0, 0, 0)");
  venue.Open();
  EXPECT_THAT(
      MemberTexts(*venue.Members->LoadMember(1), venue.Members->LoadHistory(1)),
      ElementsAre(Pair(testing::StrEq("PlayerName"), "Ann Lee"), Pair(testing::StrEq("NickName"), "Mole"),
                  Pair(testing::StrEq("AvgGames"), "12"), Pair(testing::StrEq("AvgAccuracy"), "50.00%"),
                  Pair(testing::StrEq("AvgDamage"), "12.34"), Pair(testing::StrEq("AvgSoldiering"), "0.12"),
                  Pair(testing::StrEq("ClanName"), "Owls")));
  const BookmarkTexts unnamed = MemberTexts(*venue.Members->LoadMember(2), venue.Members->LoadHistory(2));
  EXPECT_EQ(unnamed[1].second, "None");
  EXPECT_EQ(unnamed[6].second, "None");
  EXPECT_EQ(unnamed[3].second, "0.00%");
}

TEST_F(Texts, OfAGuestLeaveTheNicknameAlone) {
  EXPECT_THAT(
      GuestTexts(),
      ElementsAre(Pair(testing::StrEq("PlayerName"), "Guest"), Pair(testing::StrEq("AvgGames"), "N/A"),
                  Pair(testing::StrEq("AvgAccuracy"), "N/A"), Pair(testing::StrEq("AvgDamage"), "N/A"),
                  Pair(testing::StrEq("AvgSoldiering"), "N/A"), Pair(testing::StrEq("ClanName"), "N/A")));
}

TEST_F(Texts, OfTheGameAreInNumberForm) {
  Player& player = venue.game.Players(1);
  player.TotalDamage = -240;
  player.Soldiering = 289;
  player.ShotCount = 60;
  player.Accuracy = 0.5;
  player.HealCount = 1;
  player.DeathCount = 3;
  player.AmmoAddCount = 2;
  EXPECT_THAT(
      GameTexts(player, "Sniper Hunt", "15 November 2026", " 4"),
      ElementsAre(Pair(testing::StrEq("MissionName"), "Sniper Hunt"),
                  Pair(testing::StrEq("Date"), "15 November 2026"), Pair(testing::StrEq("Rank"), " 4"),
                  Pair(testing::StrEq("TotalDamage"), "-240"), Pair(testing::StrEq("Soldiering"), " 289"),
                  Pair(testing::StrEq("ShotsFired"), " 60"), Pair(testing::StrEq("Accuracy"), "50.00%"),
                  Pair(testing::StrEq("WIA"), " 1"), Pair(testing::StrEq("KIA"), " 3"),
                  Pair(testing::StrEq("AmmoAdds"), " 2")));
}

TEST_F(Texts, AnAccuracyOfZeroIsNotAvailable) {
  EXPECT_EQ(GameTexts(venue.game.Players(1), "", "", "")[6].second, "N/A");
}

TEST_F(Texts, OfHitsNameTheOtherPlayerAndMember) {
  ExecuteSql(
      venue.MembersFile(),
      "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES (7, 'Bo', 'Ray', 'Mole')");
  venue.Open();
  venue.game.Players(45).MemberIndex = 7;  // Blue 12
  venue.game.Players(45).HitByPlayer(1) = 40;
  venue.game.Players(1).HitByPlayer(1) = 5;
  venue.game.Players(70).HitByPlayer(1) = -5;
  venue.game.Players(1).HitByPlayer(45) = 8;
  EXPECT_THAT(HitsScored(venue.game, 1, *venue.Members), ElementsAre("Red 0:  5", "Blue 12:  40  (Mole)"));
  EXPECT_THAT(HitsTaken(venue.game, 1, *venue.Members), ElementsAre("Red 0:  5", "Blue 12:  8  (Mole)"));
  EXPECT_THAT(HitsScored(venue.game, 45, *venue.Members), ElementsAre("Red 0:  8"));
}

TEST_F(Texts, OfAHitOnAMissingMemberNameNobodyAndSaySo) {
  venue.Open();
  venue.game.Players(45).MemberIndex = 7;
  venue.game.Players(1).HitByPlayer(45) = 8;
  EXPECT_THAT(HitsTaken(venue.game, 1, *venue.Members), ElementsAre("Blue 12:  8"));
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1u);
  EXPECT_EQ(venue.Boxes.Boxes[0].Text, "Could not locate specified Member in database!");
}

TEST_F(Texts, OfHitsTakenEndWithTheSpecialDamage) {
  venue.Open();
  Player& player = venue.game.Players(1);
  EXPECT_THAT(HitsTaken(venue.game, 1, *venue.Members), IsEmpty());
  player.HitByPlayer(65) = 3;
  player.ExplosiveDamage = 30;
  player.StunCount = 2;
  EXPECT_THAT(HitsTaken(venue.game, 1, *venue.Members),
              ElementsAre("Yellow 0:  3", "Explosive:  30", "Stuns:  2"));
  player.RadiationDamage = 4;
  EXPECT_THAT(HitsTaken(venue.game, 1, *venue.Members),
              ElementsAre("Yellow 0:  3", "Explosive:  30", "Radiation:  4", "Stuns:  2"));
}

TEST(HitSizes, LetATableKeepItsHeight) {
  for (int hits = 1; hits <= 20; ++hits) {
    const std::optional<RowSizes> sizes = SizesForHits(hits, 20);
    ASSERT_TRUE(sizes) << hits;
    EXPECT_EQ(sizes->Used, hits);
    EXPECT_NEAR(hits * sizes->UsedHeight + (20 - hits) * sizes->RestHeight, 20, 1e-9) << hits;
    EXPECT_GE(sizes->UsedHeight, 1) << hits;
    EXPECT_GT(sizes->RestHeight, 0.3) << hits;
    EXPECT_GT(sizes->Letters, 1.1) << hits;
    EXPECT_LT(sizes->Letters, 1.9) << hits;
  }
}

TEST(HitSizes, GrowSmallerWithMoreHits) {
  for (int hits = 2; hits <= 20; ++hits) {
    EXPECT_LE(SizesForHits(hits, 20)->Letters, SizesForHits(hits - 1, 20)->Letters) << hits;
  }
}

TEST(HitSizes, AreTheTemplatesOwnForNoHitsAndForMoreThanAColumn) {
  EXPECT_FALSE(SizesForHits(0, 20));
  EXPECT_FALSE(SizesForHits(21, 20));
}

}  // namespace
