#include "ui/ResultList.h"

#include <gtest/gtest.h>

namespace {

TEST(ResultList, HasTheNewestRowAtTheTopForTheKeyboard) {
  ResultList list;
  list.SetCaptions({QStringLiteral("No."), QStringLiteral("Result")}, 0);
  list.AddRow({QStringLiteral("1"), QStringLiteral("old")}, true, 9);
  list.AddRow({QStringLiteral("2"), QStringLiteral("new")}, true, 9);
  EXPECT_EQ(list.horizontalHeaderItem(1)->text(), QStringLiteral("Result"));
  EXPECT_EQ(list.item(0, 1)->text(), QStringLiteral("new"));
  EXPECT_EQ(list.item(1, 1)->text(), QStringLiteral("old"));
  EXPECT_EQ(list.currentRow(), 0);
  EXPECT_TRUE(list.selectedItems().isEmpty());
}

TEST(ResultList, TintsFailures) {
  ResultList list;
  list.SetCaptions({QStringLiteral("Result")}, 0);
  list.AddRow({QStringLiteral("good")}, true, 9);
  list.AddRow({QStringLiteral("bad")}, false, 9);
  EXPECT_EQ(list.item(1, 0)->background().style(), Qt::NoBrush);
  EXPECT_NE(list.item(0, 0)->background().style(), Qt::NoBrush);
}

TEST(ResultList, LetsTheOldestRowsGo) {
  ResultList list;
  list.SetCaptions({QStringLiteral("No.")}, 0);
  for (int i = 1; i <= 5; ++i) {
    list.AddRow({QString::number(i)}, true, 3);
  }
  EXPECT_EQ(list.rowCount(), 3);
  EXPECT_EQ(list.item(2, 0)->text(), QStringLiteral("3"));
}

TEST(ResultList, IsNotForWriting) {
  ResultList list;
  EXPECT_EQ(list.editTriggers(), QAbstractItemView::NoEditTriggers);
  EXPECT_FALSE(list.tabKeyNavigation());
}

}  // namespace
