#include "archive/history/MemberSessions.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;

MemberGame SessionOn(const std::string& played, std::int64_t soldiering, std::optional<double> accuracy,
                     std::int64_t damage) {
  MemberGame game;
  game.Played = played;
  game.Soldiering = soldiering;
  game.Accuracy = accuracy;
  game.Damage = damage;
  return game;
}

class ThreeSessions : public testing::Test {
 protected:
  const MemberSessions sessions = SessionsFrom({SessionOn("2026-11-21 20:15:00", -30, 0.0, 7),
                                                SessionOn("2026-11-02 19:00:00", 100, 0.25, 9),
                                                SessionOn("2026-09-30 23:59:59", 100, std::nullopt, 9)});
};

TEST_F(ThreeSessions, HaveTheMeanOfEachAndAllBefore) {
  EXPECT_THAT(sessions.MeansSoFar, ElementsAre(170.0 / 3, 100, 100));
}

TEST_F(ThreeSessions, HaveBestsTheEarlierOfEqualOnes) {
  EXPECT_EQ(sessions.BestSoldiering, 2U);
  EXPECT_EQ(sessions.MostDamage, 2U);
  EXPECT_EQ(sessions.BestAccuracy, 1U);
}

TEST_F(ThreeSessions, AreAddedUpByMonthWithoutEmptyOnes) {
  ASSERT_EQ(sessions.Months.size(), 2U);
  const MonthOfMember& november = sessions.Months[0];
  EXPECT_EQ(november.Month, "2026-11");
  EXPECT_EQ(november.Games, 2);
  EXPECT_EQ(november.Mean(), 35);
  EXPECT_EQ(november.SoldieringBest, 100);
  EXPECT_EQ(november.Damage, 16);
  EXPECT_EQ(november.Accuracy(), 0.25);
  EXPECT_EQ(sessions.Months[1].Month, "2026-09");
  EXPECT_EQ(sessions.Months[1].Accuracy(), std::nullopt);
}

TEST(SessionsFrom, OfAMonthOfLossesTellTheSmallestLossAsBest) {
  const MemberSessions sessions = SessionsFrom(
      {SessionOn("2026-11-21 20:15:00", -30, 0.5, 0), SessionOn("2026-11-20 20:15:00", -50, 0.5, 0)});
  EXPECT_EQ(sessions.Months.at(0).SoldieringBest, -30);
  EXPECT_EQ(sessions.BestSoldiering, 0U);
}

TEST(SessionsFrom, NoGamesAreNothing) {
  const MemberSessions sessions = SessionsFrom({});
  EXPECT_TRUE(sessions.Months.empty());
  EXPECT_TRUE(sessions.MeansSoFar.empty());
  EXPECT_FALSE(sessions.BestSoldiering || sessions.BestAccuracy || sessions.MostDamage);
}

}  // namespace
