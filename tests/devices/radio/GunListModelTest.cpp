#include "devices/radio/GunListModel.h"

#include <gmock/gmock.h>

#include <QAbstractItemModelTester>
#include <QSignalSpy>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class GunList : public testing::Test {
 protected:
  void Put(std::size_t index, ScoreStatus status = ScoreStatus::Pending) {
    GunEntry& gun = guns[index];
    gun.Present = true;
    gun.PlayerID = static_cast<std::int16_t>(index + FirstGunId);
    gun.PlayerName = "Gun " + std::to_string(index);
    gun.ScoreStatus = status;
  }

  std::vector<std::string> Column(int column) const {
    std::vector<std::string> cells;
    for (int row = 0; row < list.rowCount(); ++row) {
      cells.push_back(list.index(row, column).data().toString().toStdString());
    }
    return cells;
  }

  GunTable guns;
  GunListModel list{QStringLiteral("Player"), nullptr};
  QAbstractItemModelTester tester{&list, QAbstractItemModelTester::FailureReportingMode::Fatal};
};

TEST_F(GunList, AddsEachGunAtItsPlace) {
  for (const std::size_t index : {8U, 1U, 100U, 40U}) {
    Put(index);
    list.Show(guns, 128);
  }
  EXPECT_THAT(Column(0), ElementsAre("Gun 1", "Gun 8", "Gun 40", "Gun 100"));
}

TEST_F(GunList, ChangesARowInItsPlace) {
  Put(1);
  Put(8);
  list.Show(guns, 128);
  const QPersistentModelIndex second = list.index(1, 0);
  Put(1, ScoreStatus::Ok);
  list.Show(guns, 128);
  EXPECT_THAT(Column(4), ElementsAre("Scores OK", "Scores Pending"));
  EXPECT_EQ(second.row(), 1);
}

TEST_F(GunList, TellsItsViewOfEachRowThatChanged) {
  Put(1);
  Put(8);
  list.Show(guns, 128);
  const QSignalSpy changes(&list, &QAbstractItemModel::dataChanged);
  list.Show(guns, 128);
  EXPECT_EQ(changes.count(), 0);
  Put(8, ScoreStatus::Ok);
  list.Show(guns, 128);
  ASSERT_EQ(changes.count(), 1);
  EXPECT_EQ(changes[0][0].toModelIndex(), list.index(1, 0));
  EXPECT_EQ(changes[0][1].toModelIndex(), list.index(1, list.columnCount() - 1));
}

TEST_F(GunList, IsEmptyOnceCleared) {
  Put(1);
  list.Show(guns, 128);
  list.Clear();
  EXPECT_THAT(Column(0), IsEmpty());
  Put(8);
  list.Show(guns, 128);
  EXPECT_THAT(Column(0), ElementsAre("Gun 1", "Gun 8"));
}

}  // namespace
