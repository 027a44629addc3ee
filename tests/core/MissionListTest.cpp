#include "core/MissionList.h"

#include <gmock/gmock.h>

#include "core/FieldValue.h"
#include "tests/core/ScoredGame.h"
#include "tests/platform/linux/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class ListOfMissions : public testing::Test {
 protected:
  ListOfMissions() {
    ExecuteSql(venue.ScenariosFile(),
               "INSERT INTO Table1 (ID, MissionName) VALUES (3, 'Bridge'), (5, 'Keep'), (9, 'Bridge')");
    venue.Open();
  }

  std::vector<std::string> Texts() const {
    std::vector<std::string> texts;
    for (const MissionList::Item& item : venue.Missions->Items()) {
      texts.push_back(item.Text);
    }
    return texts;
  }

  ScoredGame venue;
};

TEST_F(ListOfMissions, BeginsWithTheTwoFixedEntries) {
  EXPECT_THAT(Texts(), ElementsAre("None", "Free For All", "Bridge", "Keep", "Bridge"));
  EXPECT_EQ(venue.Missions->ListIndex(), MissionList::None);
  EXPECT_EQ(venue.Missions->Text(), "None");
}

TEST_F(ListOfMissions, StandsOnNoneAfterEachFill) {
  venue.Missions->Select(3);
  venue.Missions->FillMissionList();
  EXPECT_EQ(venue.Missions->ListIndex(), MissionList::None);
}

TEST_F(ListOfMissions, HasNoRecordForTheFixedEntries) {
  for (const int index : {MissionList::None, MissionList::FreeForAll}) {
    venue.Missions->Select(index);
    EXPECT_FALSE(venue.Missions->ActivateCurrentMissionRecord());
  }
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(ListOfMissions, MovesTheCursorToTheRowOfTheEntry) {
  venue.Missions->Select(4);
  ASSERT_TRUE(venue.Missions->ActivateCurrentMissionRecord());
  EXPECT_EQ(TextOf(venue.Missions->Row().Fields("ID")), "9");
  venue.Missions->Select(3);
  ASSERT_TRUE(venue.Missions->ActivateCurrentMissionRecord());
  EXPECT_EQ(TextOf(venue.Missions->Row().Fields("MissionName")), "Keep");
}

TEST_F(ListOfMissions, SaysWhenTheRowIsGone) {
  venue.Missions->Select(3);
  ExecuteSql(venue.ScenariosFile(), "DELETE FROM Table1 WHERE ID = 5");
  EXPECT_FALSE(venue.Missions->ActivateCurrentMissionRecord());
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Could not locate selected Mission in Mission Database",
                                                "Mission Database Error", BoxIcon::Exclamation, BoxButtons::Ok}));
}

TEST_F(ListOfMissions, RefusesIndexesOutside) {
  EXPECT_EQ(NumberThrownBy([this] { venue.Missions->Select(-1); }), 9);
  EXPECT_EQ(NumberThrownBy([this] { venue.Missions->Select(5); }), 9);
}

TEST(EmptyMissionTable, LeavesTheTwoFixedEntries) {
  ScoredGame venue;
  venue.Open();
  EXPECT_EQ(venue.Missions->Items().size(), 2u);
  EXPECT_EQ(venue.Missions->Text(), "None");
}

}  // namespace
