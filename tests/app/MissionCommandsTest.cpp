#include <optional>

#include "tests/missions/EditorSteps.h"
#include "tests/support/Venue.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// The mission editor, opened from the main window, whose list of missions follows.
class Editor : public EditorSteps<Venue> {
 protected:
  Editor() { venue.Start(); }

  void Execute() override { venue.Trigger("mnuSetupMissions"); }

  std::optional<OtherConnection> held;
};

TEST_F(Editor, MakesANewMissionAndGoesOnEditingIt) {
  Open([this] {
    NewMission("Four");
    EXPECT_THAT(Entries(), ElementsAre("One", "Two", "Three", "Four"));
    EXPECT_EQ(List().currentRow(), 3);
    EXPECT_EQ(ShownName(), "Four");
    EXPECT_EQ(ShownDescription(), "Enter Mission Details");
    EXPECT_EQ(EditCaption(), "Editing");
    EXPECT_FALSE(Locked());
    EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
    Describe("All against all");
    Type("PrimaryPoints0", "9");
    Press("Save");
    EXPECT_EQ(List().currentRow(), 3);
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Saved()));
  EXPECT_THAT(Names(), ElementsAre("One", "Two", "Three", "Four"));
  EXPECT_EQ(Stored("MissionDescription", "Four"), "All against all");
  EXPECT_EQ(Stored("MissionDescription2", "Four"), "NULL");
  EXPECT_EQ(Stored("RespawnPenalty", "Four"), "0.0");
  EXPECT_EQ(venue.ActiveMission().itemText(5), QStringLiteral("Four"));
}

TEST_F(Editor, StaysUsableWithoutAnyMission) {
  Open([this] {
    for (int mission = 0; mission < 3; ++mission) {
      Press("Delete");
    }
    EXPECT_THAT(Entries(), IsEmpty());
    EXPECT_EQ(ShownName(), "");
    EXPECT_EQ(ShownDescription(), "");
    Press("Delete");
    venue.Boxes.Boxes.clear();
    Press("Save");
    EXPECT_THAT(venue.Boxes.Boxes,
                ElementsAre(EntryError("Mission Description cannot be empty. Save aborted.")));
    NewMission("First again");
    EXPECT_THAT(Entries(), ElementsAre("First again"));
    EXPECT_EQ(ShownDescription(), "Enter Mission Details");
  });
  EXPECT_THAT(Names(), ElementsAre("First again"));
  EXPECT_EQ(venue.ActiveMission().count(), 3);
}

TEST_F(Editor, OpensWithoutAnyMission) {
  venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1");
  Open([this] {
    EXPECT_THAT(Entries(), IsEmpty());
    Press("Edit");
    Press("Delete");
  });
  EXPECT_EQ(venue.ActiveMission().count(), 2);
}

TEST_F(Editor, LeavesTheActiveMissionOnNone) {
  venue.ActiveMission().setCurrentIndex(3);
  Open([this] { Press("SelectExit"); });
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 0);
  EXPECT_FALSE(venue.Find<QAction>("mnuMissionResults").isEnabled());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Editor, ClosedWhileAnotherProgramHoldsTheFileLeavesMissionWindowAndGameInAgreement) {
  venue.LoadGame(GameFile(PlayerOf(1, "<RespawnCount>4</RespawnCount>"), "One"));
  ASSERT_EQ(venue.Row("ScoreDisplay", 0)[2], "-10");
  Open([this] {
    Press("Delete");
    held.emplace(venue.DataFile("scenarios.mdb"));
    held->Execute("BEGIN EXCLUSIVE");
  });
  held.reset();
  EXPECT_EQ(venue.ActiveMission().currentText(), QStringLiteral("One"));
  EXPECT_EQ(venue.ActiveMission().count(), 5);
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[2], "-10");
  venue.Boxes.Boxes.clear();
  venue.ActiveMission().setCurrentIndex(3);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[2], " 0");
  Open([] {});
  EXPECT_EQ(venue.ActiveMission().count(), 4);
  EXPECT_EQ(venue.ActiveMission().currentText(), QStringLiteral("None"));
}

TEST_F(Editor, ClosedByItsCloseBoxAsksNothingInAnyState) {
  Open([] {});
  Open([this] {
    Press("Edit");
    Describe("never saved");
  });
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(Stored("MissionDescription", "One"), "First text");
  Open([this] { NewMission("Four"); });
  EXPECT_THAT(Names(), ElementsAre("One", "Two", "Three", "Four"));
  EXPECT_EQ(venue.ActiveMission().count(), 6);
}

}  // namespace
