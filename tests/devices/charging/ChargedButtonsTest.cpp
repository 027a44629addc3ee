#include "devices/charging/ChargedButtons.h"

#include <gtest/gtest.h>

namespace {

ChargedButton Button(const std::string& dallasId, ChargeResult result) {
  return {"14:30:05", 0, dallasId, result};
}

TEST(ChargedButtons, KeepsThemInOrder) {
  ChargedButtons buttons;
  EXPECT_TRUE(buttons.Add(Button("A", ChargeResult::Charged)));
  EXPECT_TRUE(buttons.Add(Button("B", ChargeResult::Different)));
  ASSERT_EQ(buttons.All().size(), 2U);
  EXPECT_EQ(buttons.All()[0].DallasID, "A");
  EXPECT_EQ(buttons.All()[1].DallasID, "B");
}

TEST(ChargedButtons, TakesRepeatedTriesOfAnUnreadButtonForOne) {
  ChargedButtons buttons;
  EXPECT_TRUE(buttons.Add(Button("A", ChargeResult::NotRead)));
  EXPECT_FALSE(buttons.Add(Button("A", ChargeResult::NotRead)));
  EXPECT_TRUE(buttons.Add(Button("B", ChargeResult::NotRead)));
  EXPECT_TRUE(buttons.Add(Button("A", ChargeResult::NotRead)));
  EXPECT_TRUE(buttons.Add(Button("A", ChargeResult::Charged)));
  EXPECT_TRUE(buttons.Add(Button("A", ChargeResult::Charged)));
  EXPECT_EQ(buttons.Count(), 5U);
}

TEST(ChargedButtons, TakesAnUnreadButtonThatWasTouchedAgainForAnother) {
  ChargedButtons buttons;
  EXPECT_TRUE(buttons.Add(Button("A", ChargeResult::NotRead)));
  buttons.BeginTouch();
  EXPECT_TRUE(buttons.Add(Button("A", ChargeResult::NotRead)));
  EXPECT_FALSE(buttons.Add(Button("A", ChargeResult::NotRead)));
  EXPECT_EQ(buttons.Count(), 2U);
}

TEST(ChargedButtons, LetsTheOldestGoAndCountsOn) {
  ChargedButtons buttons;
  for (std::size_t i = 0; i < ChargedButtons::Most + 3; ++i) {
    buttons.Add(Button(std::to_string(i), ChargeResult::Charged));
  }
  EXPECT_EQ(buttons.All().size(), ChargedButtons::Most);
  EXPECT_EQ(buttons.All().front().DallasID, "3");
  EXPECT_EQ(buttons.Count(), ChargedButtons::Most + 3);
}

}  // namespace
