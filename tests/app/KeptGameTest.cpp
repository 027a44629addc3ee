#include <gmock/gmock.h>

#include <filesystem>

#include "tests/support/Frames.h"
#include "tests/support/GameFiles.h"
#include "tests/support/TimeOfChange.h"
#include "tests/support/Venue.h"

namespace {

using testing::HasSubstr;
using testing::IsEmpty;

/// Games that are kept by themselves, while the operator works at the main window.
class KeptGame : public testing::Test {
 protected:
  KeptGame() {
    venue.PutDefaultFiles();
    venue.Start();
    venue.Port.OnOutput = [this](std::uint8_t byte) {
      if (byte == 1) {
        venue.Port.Receive({1});
        venue.Port.Receive(FrameOfRed1());
      }
    };
  }

  void Pull() { venue.Press("GetScores"); }
  void Clear() {
    venue.Boxes.Answers = {BoxAnswer::Ok};
    venue.Trigger("mnuClearScores");
  }

  std::string Says(const std::string& entry) const {
    const auto* control = venue.Window->findChild<QWidget*>(QString::fromStdString(entry));
    return control != nullptr && control->isVisible() ? control->property("text").toString().toStdString()
                                                      : std::string();
  }

  std::string Games() const { return venue.QueryDatabase("games.mdb", "SELECT count(*) FROM Games"); }

  Venue venue;
};

TEST_F(KeptGame, MakesNoFileAtTheStart) {
  QCoreApplication::processEvents();
  EXPECT_FALSE(std::filesystem::exists(venue.DataFile("games.mdb")));
}

TEST_F(KeptGame, IsToldInTheStatusLineAfterThePull) {
  Pull();
  EXPECT_EQ(Says("DeskKept"), "kept 14:30");
  EXPECT_EQ(Games(), "1");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(KeptGame, OutlivesClearGame) {
  Pull();
  Clear();
  EXPECT_EQ(Says("DeskKept"), "");
  EXPECT_EQ(Games(), "1");
  Pull();
  EXPECT_EQ(Games(), "2");
}

TEST_F(KeptGame, IsKeptAgainAfterAChoiceOfTheMission) {
  Pull();
  auto& missions = venue.Find<QComboBox>("ActiveMission");
  ASSERT_GT(missions.count(), 1);
  QTest::keyClick(&missions, Qt::Key_Down);
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT Mission FROM Games"),
            missions.currentText().toStdString());
}

TEST_F(KeptGame, IsKeptAsItWasBeforeASecondPullToo) {
  Pull();
  Pull();
  EXPECT_EQ(Games(), "1");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT count(*) FROM sqlar"), "2");
}

TEST_F(KeptGame, OfAFileWithoutADateIsFiledUnderTheTimeOfTheFile) {
  WriteFile(venue.Folder / "old.xml", SmallGame());
  SetTimeOfChange(venue.Folder / "old.xml", "2012-03-04 05:06:07");
  venue.Dialog.Answers = {venue.Folder / "old.xml", venue.Folder / "old.xml"};
  venue.Trigger("mnuLoadScores");
  venue.Trigger("mnuLoadScores");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT Played FROM Games"), "2012-03-04 05:06:07");
}

TEST_F(KeptGame, IsKeptBeforeItIsClearedInTheMiddleOfThePull) {
  venue.Port.OnOutput = [this, pulled = false](std::uint8_t byte) mutable {
    if (byte == 1) {
      venue.Port.Receive({2});
      venue.Port.Receive(FrameOfRed1());
    } else if (!pulled) {
      pulled = true;
      Clear();
      venue.Port.Receive(FrameOfBlue0());
    }
  };
  Pull();
  EXPECT_EQ(Games(), "2");
}

TEST_F(KeptGame, StopsNothingWhereItCannotBeKeptAndTellsWhy) {
  std::filesystem::create_directory(venue.DataFile("games.mdb"));
  Pull();
  EXPECT_THAT(Says("DeskNotKept"), HasSubstr("games.mdb"));
  EXPECT_EQ(Says("DeskKept"), "");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  std::filesystem::remove(venue.DataFile("games.mdb"));
  venue.Trigger("mnuSaveScores");
  EXPECT_EQ(Says("DeskNotKept"), "");
  EXPECT_EQ(Says("DeskKept"), "kept 14:30");
}

TEST_F(KeptGame, GoesIntoAnotherArchiveWhenThatInUseTurnsOutDamaged) {
  Pull();
  std::filesystem::resize_file(venue.DataFile("games.mdb"), 4096);
  const auto& missions = venue.Find<QComboBox>("ActiveMission");
  ASSERT_GT(missions.count(), 1);
  QTest::keyClick(&venue.Find<QComboBox>("ActiveMission"), Qt::Key_Down);
  EXPECT_THAT(Says("DeskArchiveUnusable"), HasSubstr(venue.DataFile("games.mdb")));
  EXPECT_EQ(Says("DeskNotKept"), "");
  EXPECT_EQ(Says("DeskKept"), "kept 14:30");
  EXPECT_EQ(std::filesystem::file_size(venue.DataFile("games.mdb")), 4096U);
  EXPECT_EQ(venue.QueryDatabase("games-new.mdb", "SELECT count(*) FROM Games"), "1");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(KeptGame, NamesAnArchiveThatIsDamaged) {
  std::filesystem::copy_file(venue.DataFile("tessarine.ini"), venue.DataFile("games.mdb"));
  Pull();
  EXPECT_THAT(Says("DeskArchiveUnusable"), HasSubstr(venue.DataFile("games.mdb")));
  EXPECT_EQ(venue.QueryDatabase("games-new.mdb", "SELECT count(*) FROM Games"), "1");
}

}  // namespace
