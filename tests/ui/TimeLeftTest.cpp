#include "ui/TimeLeft.h"

#include <gtest/gtest.h>

namespace {

using std::chrono::milliseconds;
using std::chrono::seconds;

TEST(TimeLeftOfAJob, GoesOnAtTheSpeedSoFar) {
  EXPECT_EQ(TimeLeft(seconds(10), 1, 4), seconds(30));
  EXPECT_EQ(TimeLeft(seconds(20), 3, 4), milliseconds(6666));
}

TEST(TimeLeftOfAJob, IsUnknownInTheFirstSecondAndBeforeTheFirstStep) {
  EXPECT_EQ(TimeLeft(milliseconds(999), 5, 10), std::nullopt);
  EXPECT_EQ(TimeLeft(seconds(1), 5, 10), seconds(1));
  EXPECT_EQ(TimeLeft(seconds(60), 0, 10), std::nullopt);
}

TEST(TimeLeftOfAJob, IsNothingAtTheEnd) {
  EXPECT_EQ(TimeLeft(seconds(0), 10, 10), seconds(0));
  EXPECT_EQ(TimeLeft(seconds(9), 11, 10), seconds(0));
  EXPECT_EQ(TimeLeft(seconds(9), 0, 0), seconds(0));
}

}  // namespace
