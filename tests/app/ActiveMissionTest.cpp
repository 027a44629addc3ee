#include <gmock/gmock.h>

#include <QLabel>

#include "tests/support/Venue.h"

namespace {

using testing::AllOf;
using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

const FakeMessageBoxes::Box MissionGone{"Could not locate selected Mission in Mission Database",
                                        "Mission Database Error", BoxIcon::Exclamation, BoxButtons::Ok};

/// Red 0 shot 30 at Red 1 and 100 at Blue 0, and respawned three times; all three played.
std::string GameWithFriendlyFire(const std::string& mission = "None") {
  const auto hitByRed0 = [](int amount) {
    return "<HitData><HitByPlayer><Index>1</Index><Amount>" + std::to_string(amount) +
           "</Amount></HitByPlayer></HitData>";
  };
  return GameFile(PlayerOf(1, "<RespawnCount>3</RespawnCount>") + PlayerOf(2, hitByRed0(30)) +
                      PlayerOf(33, hitByRed0(100)),
                  mission);
}

/// Three missions, their numbers not in the order of their names.
class ActiveMission : public testing::Test {
 protected:
  ActiveMission() {
    venue.PutDefaultFiles();
    venue.ChangeDatabase(
        "scenarios.mdb",
        "DELETE FROM Table1;"
        "INSERT INTO Table1 (ID, MissionName, MissionDescription, MissionDescription2, RespawnPenalty) VALUES"
        " (4, 'Zebra', 'One line', ' and more', 2),"
        " (7, 'Alpha', 'First line' || char(13) || char(10) || 'second line', '', 5),"
        " (19, 'Müller''s Mill', '', '', 0)");
    venue.Start();
  }

  std::vector<std::string> Items() const {
    std::vector<std::string> items;
    for (int index = 0; index < venue.ActiveMission().count(); ++index) {
      items.push_back(venue.ActiveMission().itemText(index).toStdString());
    }
    return items;
  }

  std::string ToolTip() const { return venue.Find<QLabel>("ActiveMissionLabel").toolTip().toStdString(); }

  /// Opens the list and chooses the entry that is the active one.
  void ChooseAgain() const {
    QTest::mouseClick(&venue.ActiveMission(), Qt::LeftButton);
    QAbstractItemView& list = *venue.ActiveMission().view();
    ASSERT_TRUE(list.isVisible());
    QTest::keyClick(&list, Qt::Key_Return);
  }

  /// Soldiering of Red 0.
  std::string ScoreOfRed0() const {
    for (int row = 0; row < venue.RowCount("ScoreDisplay"); ++row) {
      if (venue.Row("ScoreDisplay", row)[1] == "Red  0") {
        return venue.Row("ScoreDisplay", row)[2];
      }
    }
    return "not on the board";
  }

  Venue venue;
};

TEST_F(ActiveMission, ListsTheFixedEntriesAndThenTheRows) {
  EXPECT_THAT(Items(), ElementsAre("None", "Free For All", "Zebra", "Alpha", "Müller's Mill"));
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 0);
  EXPECT_FALSE(venue.ActiveMission().isEditable());
}

TEST_F(ActiveMission, NamesTheFixedEntriesInTheLanguageOfTheSystem) {
  Venue chinese(Language::SimplifiedChinese);
  chinese.Start();
  EXPECT_EQ(chinese.ActiveMission().itemText(0), QStringLiteral("无"));
  EXPECT_EQ(chinese.ActiveMission().itemText(1), QStringLiteral("自由混战"));
}

TEST_F(ActiveMission, TellsTheFirstLineOfItsDescription) {
  venue.ActiveMission().setCurrentIndex(3);
  EXPECT_EQ(ToolTip(), "First line");
  venue.ActiveMission().setCurrentIndex(2);
  EXPECT_EQ(ToolTip(), "One line");
  venue.ActiveMission().setCurrentIndex(4);
  EXPECT_EQ(ToolTip(), "");
}

TEST_F(ActiveMission, TellsNothingForTheFixedEntries) {
  for (const int fixed : {0, 1}) {
    venue.ActiveMission().setCurrentIndex(2);
    ASSERT_EQ(ToolTip(), "One line");
    venue.ActiveMission().setCurrentIndex(fixed);
    EXPECT_EQ(ToolTip(), "");
  }
}

TEST_F(ActiveMission, CanBeChosenWithKeysAndMouse) {
  venue.ActiveMission().setFocus();
  QTest::keyClick(&venue.ActiveMission(), Qt::Key_Down);
  QTest::keyClick(&venue.ActiveMission(), Qt::Key_Down);
  EXPECT_EQ(ToolTip(), "One line");
  QTest::keyClick(&venue.ActiveMission(), Qt::Key_A);
  QTest::keyClick(venue.ActiveMission().view(), Qt::Key_Return);
  EXPECT_EQ(ToolTip(), "First line");
  QTest::mouseClick(&venue.ActiveMission(), Qt::LeftButton);
  QAbstractItemView& list = *venue.ActiveMission().view();
  ASSERT_TRUE(list.isVisible());
  QTest::keyClick(&list, Qt::Key_Up);
  EXPECT_EQ(ToolTip(), "First line");
  QTest::keyClick(&list, Qt::Key_Return);
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 2);
  EXPECT_EQ(ToolTip(), "One line");
}

TEST_F(ActiveMission, CalculatesNothingWithoutAGame) {
  venue.ActiveMission().setCurrentIndex(2);
  EXPECT_EQ(venue.RowCount("TeamScores"), 0);
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
}

TEST_F(ActiveMission, ScoresTheGameAnewWhenItChanges) {
  venue.LoadGame(GameWithFriendlyFire());
  EXPECT_EQ(ScoreOfRed0(), " 70");
  venue.ActiveMission().setCurrentIndex(1);
  EXPECT_EQ(ScoreOfRed0(), " 130");
  venue.ActiveMission().setCurrentIndex(2);
  EXPECT_EQ(ScoreOfRed0(), " 64");
  venue.ActiveMission().setCurrentIndex(3);
  EXPECT_EQ(ScoreOfRed0(), " 55");
  venue.ActiveMission().setCurrentIndex(0);
  EXPECT_EQ(ScoreOfRed0(), " 70");
}

TEST_F(ActiveMission, CanBeChosenAgain) {
  venue.LoadGame(GameWithFriendlyFire("Alpha"));
  venue.ChangeDatabase("scenarios.mdb",
                       "UPDATE Table1 SET RespawnPenalty = 20, MissionDescription = 'New text' WHERE ID = 7");
  ChooseAgain();
  EXPECT_EQ(ToolTip(), "New text");
  EXPECT_EQ(ScoreOfRed0(), " 10");
  venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1 WHERE ID = 7");
  ChooseAgain();
  EXPECT_THAT(venue.Boxes.Boxes, AllOf(SizeIs(1 + 3), Each(MissionGone)));
  EXPECT_EQ(ToolTip(), "");
}

TEST_F(ActiveMission, IsClickedOnceWhenAnotherIsChosen) {
  venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1 WHERE ID IN (4, 7)");
  venue.ActiveMission().setFocus();
  QTest::keyClick(&venue.ActiveMission(), Qt::Key_Z);
  QTest::keyClick(venue.ActiveMission().view(), Qt::Key_Return);
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(MissionGone));
  QTest::mouseClick(&venue.ActiveMission(), Qt::LeftButton);
  QTest::keyClick(venue.ActiveMission().view(), Qt::Key_Down);
  QTest::keyClick(venue.ActiveMission().view(), Qt::Key_Return);
  ASSERT_EQ(venue.ActiveMission().currentIndex(), 3);
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(MissionGone, MissionGone));
  ChooseAgain();
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(MissionGone, MissionGone, MissionGone));
}

TEST_F(ActiveMission, IsClickedAgainAlsoAfterTheProgramChoseIt) {
  venue.ActiveMission().setCurrentIndex(3);
  QCoreApplication::processEvents();
  venue.ChangeDatabase("scenarios.mdb", "UPDATE Table1 SET MissionDescription = 'New text' WHERE ID = 7");
  ChooseAgain();
  EXPECT_EQ(ToolTip(), "New text");
}

TEST_F(ActiveMission, IsTheOneOfALoadedGame) {
  venue.LoadGame(GameWithFriendlyFire("Alpha"));
  EXPECT_EQ(venue.ActiveMission().currentText(), QStringLiteral("Alpha"));
  EXPECT_EQ(ToolTip(), "First line");
  EXPECT_EQ(ScoreOfRed0(), " 55");
}

TEST_F(ActiveMission, StaysWhenALoadedGameNamesNoneOfTheList) {
  venue.ActiveMission().setCurrentIndex(2);
  venue.LoadGame(GameWithFriendlyFire("Elsewhere"));
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 2);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(ActiveMission, SaysWhenItIsGoneAtTheMomentOfChoice) {
  venue.ActiveMission().setCurrentIndex(2);
  venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1 WHERE ID = 7");
  venue.ActiveMission().setCurrentIndex(3);
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(MissionGone));
  EXPECT_EQ(ToolTip(), "");
  EXPECT_FALSE(venue.Find<QAction>("mnuMissionResults").isEnabled());
}

TEST_F(ActiveMission, StaysWhenAnotherProgramHoldsTheFile) {
  venue.LoadGame(GameWithFriendlyFire("Zebra"));
  const auto expectZebra = [this] {
    EXPECT_EQ(venue.ActiveMission().currentIndex(), 2);
    EXPECT_EQ(ToolTip(), "One line");
    EXPECT_EQ(ScoreOfRed0(), " 64");
  };
  {
    OtherConnection other(venue.DataFile("scenarios.mdb"));
    other.Execute("BEGIN EXCLUSIVE");
    venue.Boxes.WhileOpen = [&expectZebra](const auto& /*box*/) { expectZebra(); };
    venue.ActiveMission().setFocus();
    QTest::keyClick(&venue.ActiveMission(), Qt::Key_Down);
    venue.Boxes.WhileOpen = nullptr;
    ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
    EXPECT_THAT(venue.Boxes.Boxes[0].Text, testing::StartsWith("Run-time error '3050'"));
  }
  expectZebra();
  QTest::keyClick(&venue.ActiveMission(), Qt::Key_Down);
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 3);
  EXPECT_EQ(ScoreOfRed0(), " 55");
}

TEST_F(ActiveMission, SaysForEachPlayerThatItIsGoneAndScoresWithoutIt) {
  venue.LoadGame(GameWithFriendlyFire("Alpha"));
  venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1 WHERE ID = 7");
  venue.Press("GetScores");
  venue.Boxes.Boxes.erase(venue.Boxes.Boxes.begin());  // no data came
  EXPECT_THAT(venue.Boxes.Boxes, AllOf(SizeIs(3), Each(MissionGone)));
  EXPECT_EQ(ScoreOfRed0(), " 70");
}

TEST_F(ActiveMission, FollowsAChangeOfItsRow) {
  venue.LoadGame(GameWithFriendlyFire("Alpha"));
  venue.ChangeDatabase("scenarios.mdb", "UPDATE Table1 SET RespawnPenalty = 20 WHERE ID = 7");
  venue.Press("GetScores");
  EXPECT_EQ(ScoreOfRed0(), " 10");
}

}  // namespace
