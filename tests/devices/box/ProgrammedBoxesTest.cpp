#include "devices/box/ProgrammedBoxes.h"

#include <gtest/gtest.h>

namespace {

TEST(ProgrammedBoxes, KeepsThemInOrder) {
  ProgrammedBoxes boxes;
  boxes.Add({"14:30:05", {.BoxType = 1}, BoxResult::Accepted});
  boxes.Add({"14:30:09", {.BoxType = 2}, BoxResult::Rejected});
  ASSERT_EQ(boxes.All().size(), 2U);
  EXPECT_EQ(boxes.All()[0].Entries.BoxType, 1);
  EXPECT_EQ(boxes.All()[1].Result, BoxResult::Rejected);
  EXPECT_EQ(boxes.Count(), 2U);
}

TEST(ProgrammedBoxes, LetsTheOldestGoAndCountsOn) {
  ProgrammedBoxes boxes;
  for (std::size_t i = 0; i < ProgrammedBoxes::Most + 3; ++i) {
    boxes.Add({std::to_string(i), {}, BoxResult::Accepted});
  }
  EXPECT_EQ(boxes.All().size(), ProgrammedBoxes::Most);
  EXPECT_EQ(boxes.All().front().Time, "3");
  EXPECT_EQ(boxes.Count(), ProgrammedBoxes::Most + 3);
}

}  // namespace
