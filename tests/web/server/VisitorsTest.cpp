#include "web/server/Visitors.h"

#include <gtest/gtest.h>

#include "web/PageStream.h"

namespace {

using namespace std::chrono_literals;

const Visitors::Time Start{};

TEST(VisitorsOfTheLastMinute, AreCountedOnceForEachAddress) {
  Visitors visitors;
  visitors.Note("a", Start);
  visitors.Note("a", Start + 1s);
  visitors.Note("b", Start + 2s);
  EXPECT_EQ(visitors.Count(Start + 2s), 2U);
}

TEST(VisitorsOfTheLastMinute, AreForgottenAMinuteAfterTheirLastRequest) {
  Visitors visitors;
  visitors.Note("a", Start);
  visitors.Note("b", Start);
  visitors.Note("a", Start + 30s);
  EXPECT_EQ(visitors.Count(Start + 59s), 2U);
  EXPECT_EQ(visitors.Count(Start + 60s), 1U);
  EXPECT_EQ(visitors.Count(Start + 90s), 0U);
}

TEST(VisitorsOfTheLastMinute, AreNeverMoreThanAReportMayTell) {
  Visitors visitors;
  for (std::uint32_t i = 0; i < MostVisitors + 100; ++i) {
    visitors.Note(std::to_string(i), Start);
  }
  EXPECT_EQ(visitors.Count(Start), MostVisitors);
}

}  // namespace
