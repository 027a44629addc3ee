#include "archive/past/PastSearch.h"

#include <gmock/gmock.h>

namespace {

using testing::IsEmpty;

/// Whether a game of that time is within the filter's period.
bool Lists(const GameFilter& filter, const std::string& played) {
  return (filter.From.empty() || played >= filter.From) && (filter.Before.empty() || played < filter.Before);
}

TEST(PastSearches, LimitNothingByThemselves) {
  const GameFilter filter = FilterOf({}, ListedPast::All);
  EXPECT_EQ(filter.From, "");
  EXPECT_EQ(filter.Before, "");
  EXPECT_EQ(filter.Mission, "");
  EXPECT_THAT(filter.Members, IsEmpty());
  EXPECT_EQ(filter.Player, 0);
  EXPECT_FALSE(filter.Deleted);
  EXPECT_TRUE(FilterOf({}, ListedPast::Deleted).Deleted);
}

TEST(PastSearches, TakeTheWholeMonth) {
  const GameFilter filter = FilterOf({}, ListedPast::Month, "2026-11");
  EXPECT_FALSE(Lists(filter, "2026-10-31 23:59:59"));
  EXPECT_TRUE(Lists(filter, "2026-11-01 00:00:00"));
  EXPECT_TRUE(Lists(filter, "2026-11-30 23:59:59"));
  EXPECT_FALSE(Lists(filter, "2026-12-01 00:00:00"));
}

TEST(PastSearches, TakeTheWholeOfTheLastDay) {
  const GameFilter filter = FilterOf({.From = "2026-11-20", .Until = "2026-11-21"}, ListedPast::All);
  EXPECT_FALSE(Lists(filter, "2026-11-19 23:59:59"));
  EXPECT_TRUE(Lists(filter, "2026-11-20 00:00:00"));
  EXPECT_TRUE(Lists(filter, "2026-11-21 23:59:59"));
  EXPECT_FALSE(Lists(filter, "2026-11-22 00:00:00"));
}

TEST(PastSearches, TakeWhatPeriodAndMonthHaveInCommon) {
  const PastSearch search{.From = "2026-11-20", .Until = "2026-12-05"};
  const GameFilter november = FilterOf(search, ListedPast::Month, "2026-11");
  EXPECT_FALSE(Lists(november, "2026-11-19 12:00:00"));
  EXPECT_TRUE(Lists(november, "2026-11-30 12:00:00"));
  EXPECT_FALSE(Lists(november, "2026-12-01 12:00:00"));
  const GameFilter december = FilterOf(search, ListedPast::Month, "2026-12");
  EXPECT_FALSE(Lists(december, "2026-11-30 12:00:00"));
  EXPECT_TRUE(Lists(december, "2026-12-05 12:00:00"));
  EXPECT_FALSE(Lists(december, "2026-12-06 12:00:00"));
}

TEST(PastSearches, PassTheRestOn) {
  const GameFilter filter =
      FilterOf({.Mission = "Flag", .Members = {5, 6}, .Player = 40}, ListedPast::Deleted, "2026-11");
  EXPECT_EQ(filter.From, "");
  EXPECT_EQ(filter.Mission, "Flag");
  EXPECT_EQ(filter.Members, (std::vector<std::int32_t>{5, 6}));
  EXPECT_EQ(filter.Player, 40);
}

TEST(PastSearches, KnowTheDayOfATime) {
  EXPECT_EQ(DayOf("2026-11-21 20:15:30"), "2026-11-21");
  EXPECT_EQ(DayOf(""), "");
}

TEST(GamesThatGo, LeaveTheNextOneBelowElseTheOneAbove) {
  EXPECT_EQ(GameAfter({9, 8, 7, 6}, {8}), 7);
  EXPECT_EQ(GameAfter({9, 8, 7, 6}, {9}), 8);
  EXPECT_EQ(GameAfter({9, 8, 7, 6}, {6}), 7);
  EXPECT_EQ(GameAfter({9, 8, 7, 6}, {9, 7}), 6);
  EXPECT_EQ(GameAfter({9, 8, 7, 6}, {7, 6}), 8);
  EXPECT_EQ(GameAfter({9, 8, 7, 6}, {9, 6}), 7);
  EXPECT_EQ(GameAfter({9}, {9}), 0);
  EXPECT_EQ(GameAfter({}, {}), 0);
}

}  // namespace
