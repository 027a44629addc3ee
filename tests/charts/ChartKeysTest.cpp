#include "charts/ChartKeys.h"

#include <gtest/gtest.h>

#include <Qt>

namespace {

TEST(ChartKeys, LeadToTheNextPlacesByTheArrowsOfTheirOrder) {
  EXPECT_EQ(PlaceByKey(Qt::Key_Left, 5, 30, ChartOrder::Across), 4);
  EXPECT_EQ(PlaceByKey(Qt::Key_Right, 5, 30, ChartOrder::Across), 6);
  EXPECT_EQ(PlaceByKey(Qt::Key_Up, 5, 30, ChartOrder::Down), 4);
  EXPECT_EQ(PlaceByKey(Qt::Key_Down, 5, 30, ChartOrder::Down), 6);
}

TEST(ChartKeys, LeadTenFurtherAndToTheEndsInBothOrders) {
  for (const ChartOrder order : {ChartOrder::Across, ChartOrder::Down}) {
    EXPECT_EQ(PlaceByKey(Qt::Key_PageUp, 15, 30, order), 5);
    EXPECT_EQ(PlaceByKey(Qt::Key_PageDown, 15, 30, order), 25);
    EXPECT_EQ(PlaceByKey(Qt::Key_Home, 15, 30, order), 0);
    EXPECT_EQ(PlaceByKey(Qt::Key_End, 15, 30, order), 29);
  }
}

TEST(ChartKeys, LeadNowhereBeyondTheEnds) {
  EXPECT_EQ(PlaceByKey(Qt::Key_Left, 0, 3, ChartOrder::Across), 0);
  EXPECT_EQ(PlaceByKey(Qt::Key_PageDown, 1, 3, ChartOrder::Down), 2);
  EXPECT_EQ(PlaceByKey(Qt::Key_End, 0, 1, ChartOrder::Down), 0);
}

TEST(ChartKeys, LeaveAllOtherKeysToOthers) {
  EXPECT_EQ(PlaceByKey(Qt::Key_Up, 5, 30, ChartOrder::Across), std::nullopt);
  EXPECT_EQ(PlaceByKey(Qt::Key_Right, 5, 30, ChartOrder::Down), std::nullopt);
  EXPECT_EQ(PlaceByKey(Qt::Key_Tab, 5, 30, ChartOrder::Down), std::nullopt);
}

}  // namespace
