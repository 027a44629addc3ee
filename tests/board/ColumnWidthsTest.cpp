#include "board/ColumnWidths.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;

const std::vector<double> Shares = {0.25, 0.5, 0.25};
const std::vector<int> Nothing(3, 0);

TEST(ColumnWidths, AreTheSharesWhereThereIsRoom) {
  EXPECT_THAT(ColumnWidths(400, Shares, {50, 100, 20}, Nothing), ElementsAre(100, 200, 100));
}

TEST(ColumnWidths, AreNeverLessThanTheLeast) {
  EXPECT_THAT(ColumnWidths(400, Shares, {50, 260, 20}, Nothing), ElementsAre(70, 260, 70));
  EXPECT_THAT(ColumnWidths(400, Shares, {90, 260, 20}, Nothing), ElementsAre(90, 260, 50));
}

TEST(ColumnWidths, ExceedTheRoomThatIsTooSmall) {
  EXPECT_THAT(ColumnWidths(100, Shares, {50, 160, 20}, Nothing), ElementsAre(50, 160, 20));
}

TEST(ColumnWidths, GiveWhatIsWantedAsFarAsTheOthersCanSpareIt) {
  EXPECT_THAT(ColumnWidths(400, Shares, {50, 60, 20}, {0, 190, 0}), ElementsAre(100, 200, 100));
  EXPECT_THAT(ColumnWidths(400, Shares, {50, 60, 20}, {0, 260, 0}), ElementsAre(70, 260, 70));
  EXPECT_THAT(ColumnWidths(400, Shares, {50, 60, 20}, {0, 900, 0}), ElementsAre(50, 330, 20));
  EXPECT_THAT(ColumnWidths(100, Shares, {50, 60, 20}, {0, 90, 0}), ElementsAre(50, 60, 20));
}

}  // namespace
