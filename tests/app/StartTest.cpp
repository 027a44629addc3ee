#include <gmock/gmock.h>

#include <QGuiApplication>
#include <QScreen>

#include "tests/support/OldFiles.h"
#include "tests/support/OnScreen.h"
#include "tests/support/Thrown.h"
#include "tests/support/Venue.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

const FakeMessageBoxes::Box SmallScreen{
    "This program works best with a screen resolution of at least 1024 x 768.", "Screen Resolution Warning",
    BoxIcon::Exclamation, BoxButtons::Ok};

class Start : public testing::Test {
 protected:
  /// The box that tells of a default copy.
  FakeMessageBoxes::Box CopyBox(const std::string& start) const {
    return {start + venue.DataFolder() + ".", "Database status", BoxIcon::Information, BoxButtons::Ok};
  }

  /// Starts with the window on the screen of this name in Screens.json; returns the window's geometry then.
  QRect StartOnScreen(const QString& name) {
    venue.PutDefaultFiles();
    venue.MakeWindow().setScreen(&ScreenNamed(name.toStdString()));
    venue.Window->move(100, 90);
    before = venue.Window->geometry();
    venue.Window->FormLoad();
    return venue.Window->geometry();
  }

  bool Maximised() const { return venue.Window->windowState().testFlag(Qt::WindowMaximized); }

  Venue venue;
  QRect before;
};

TEST_F(Start, CopiesTheDefaultsInOrderTheFirstTime) {
  venue.MakeWindow().FormLoad();
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(CopyBox("User Scenario database not found, creating new database in "),
                          CopyBox("User Member database not found, creating new database in "),
                          CopyBox("User Score Card template not found, creating new template in ")));
  EXPECT_EQ(ReadFile(venue.DataFile("tessarine.ini")), ReadFile(TESSARINE_PROGRAM_FOLDER "/tessarine.ini"));
  EXPECT_EQ(ReadFile(venue.DataFile("score_card.doc")),
            ReadFile(TESSARINE_PROGRAM_FOLDER "/score_card_default.doc"));
}

TEST_F(Start, IsSilentTheSecondTime) {
  venue.MakeWindow().FormLoad();
  venue.Window.reset();
  venue.Boxes.Boxes.clear();
  venue.MakeWindow().FormLoad();
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Start, ReplacesOnlyWhatIsMissing) {
  venue.PutDefaultFiles();
  WriteFile(venue.DataFile("tessarine.ini"), "[comm]\ncommport=3\n");
  std::filesystem::remove(venue.DataFile("members.mdb"));
  venue.MakeWindow().FormLoad();
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(CopyBox("User Member database not found, creating new database in ")));
  EXPECT_EQ(ReadFile(venue.DataFile("tessarine.ini")), "[comm]\ncommport=3\n");
}

TEST_F(Start, OnALargeScreenWarnsOfNothingAndKeepsItsSize) {
  const QRect after = StartOnScreen(QStringLiteral("recommended or better"));
  EXPECT_EQ(after, before);
  EXPECT_FALSE(Maximised());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Start, OnTheRecommendedScreenIsMaximisedWithoutAWarning) {
  StartOnScreen(QStringLiteral("as recommended"));
  EXPECT_TRUE(Maximised());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Start, OnATooSmallScreenWarnsAndLimitsWidthAndHeight) {
  const QRect after = StartOnScreen(QStringLiteral("too small"));
  EXPECT_EQ(after.topLeft(), QPoint(0, 0));
  EXPECT_EQ(after.width(), 800);
  EXPECT_LT(after.height(), 600);
  EXPECT_GT(after.height(), 500);
  EXPECT_TRUE(Maximised());
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(SmallScreen));
}

TEST_F(Start, OnATooLowScreenLimitsTheHeightOnly) {
  const QRect after = StartOnScreen(QStringLiteral("too low"));
  EXPECT_EQ(after.left(), before.left());
  EXPECT_EQ(after.width(), before.width());
  EXPECT_EQ(after.top(), 0);
  EXPECT_LT(after.height(), 720);
  EXPECT_TRUE(Maximised());
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(SmallScreen));
}

TEST_F(Start, OnATooNarrowScreenLimitsTheWidthOnly) {
  const QRect after = StartOnScreen(QStringLiteral("too narrow"));
  EXPECT_EQ(after.left(), 0);
  EXPECT_EQ(after.width(), 900);
  EXPECT_EQ(after.top(), before.top());
  EXPECT_EQ(after.height(), before.height());
  EXPECT_FALSE(Maximised());
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(SmallScreen));
}

TEST_F(Start, OnAScreenSmallerThanTheWindowIsMaximised) {
  const QRect after = StartOnScreen(QStringLiteral("laptop"));
  EXPECT_LT(before.height(), 768);
  EXPECT_TRUE(Maximised());
  EXPECT_EQ(after.width(), before.width());
  EXPECT_LE(after.height(), 768 - 33);  // also when it is no longer maximised
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Start, OnAScaledScreenGoesByItsPixels) {
  const QRect after = StartOnScreen(QStringLiteral("scaled by 2"));  // 1920 x 1080
  EXPECT_TRUE(Maximised());
  EXPECT_LE(after.width(), 960);
  EXPECT_LE(after.height(), 540 - 33);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Start, OnAScaledScreenOfTheRecommendedSizeIsMaximisedWithoutAWarning) {
  StartOnScreen(QStringLiteral("scaled by 1.5"));
  EXPECT_TRUE(Maximised());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Start, WarnsOfTheScreenBeforeItLooksForData) {
  venue.MakeWindow().setScreen(&ScreenNamed("too small"));
  venue.Window->FormLoad();
  ASSERT_EQ(venue.Boxes.Boxes.size(), 4u);
  EXPECT_EQ(venue.Boxes.Boxes[0], SmallScreen);
}

TEST_F(Start, ShowsEmptyListsAndOpensNoPort) {
  venue.Start();
  EXPECT_EQ(venue.Window->windowTitle(), QStringLiteral("Tessarine 3 by Orvalin"));
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  EXPECT_EQ(venue.RowCount("TeamScores"), 0);
  EXPECT_THAT(venue.Port.Log, IsEmpty());
}

TEST_F(Start, GoesOnWithFreshMissionsWhereTheFileIsDamaged) {
  venue.PutDefaultFiles();
  const std::string garbage(5000, 'x');
  WriteFile(venue.DataFile("scenarios.mdb"), garbage);
  EXPECT_TRUE(venue.MakeWindow().FormLoad());
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_EQ(venue.Boxes.Boxes[0].Buttons, BoxButtons::OkCancel);
  EXPECT_EQ(ReadFile(venue.DataFile("scenarios.mdb")), garbage);
  EXPECT_GT(venue.ActiveMission().count(), 2);
}

TEST_F(Start, EndsWithoutAnotherWordWhenTheOperatorWantsNoFreshFile) {
  for (const char* name : {"scenarios.mdb", "members.mdb"}) {
    venue.Boxes.Boxes.clear();
    venue.PutDefaultFiles();
    WriteFile(venue.DataFile(name), std::string(5000, '\0'));
    venue.Boxes.Answers = {BoxAnswer::Cancel};
    EXPECT_FALSE(venue.MakeWindow().FormLoad());
    EXPECT_EQ(venue.Boxes.Boxes.size(), 1U);
    EXPECT_EQ(ReadFile(venue.DataFile(name)), std::string(5000, '\0'));
    std::filesystem::remove(venue.DataFile(name));
  }
}

TEST_F(Start, TakesTheFilesOfAnOldInstallationOver) {
  SKIP_WITHOUT_OLD_FILES();
  venue.PutDefaultFiles();
  for (const char* name : {"scenarios.mdb", "members.mdb"}) {
    WriteFile(venue.DataFile(name), ReadFile(std::string(TESSARINE_OLD_FILES "/") + name));
  }
  EXPECT_TRUE(venue.MakeWindow().FormLoad());
  EXPECT_EQ(venue.Boxes.Boxes.size(), 2U);
  EXPECT_EQ(venue.ActiveMission().count(), 8);
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT count(*) FROM Members"), "40");
  EXPECT_TRUE(std::filesystem::exists(venue.DataFile("members.mdb.jet")));
}

TEST_F(Start, EndsWhenATableIsMissing) {
  venue.PutDefaultFiles();
  venue.ChangeDatabase("members.mdb", "DROP TABLE Members");
  EXPECT_EQ(NumberThrownBy([this] { venue.MakeWindow().FormLoad(); }), 3078);
}

TEST_F(Start, EndsWhenADefaultCopyIsMissing) {
  venue.Places.ProgramPath = venue.Folder.Path();
  EXPECT_EQ(NumberThrownBy([this] { venue.MakeWindow().FormLoad(); }), 53);
}

TEST_F(Start, EndsAtAFactorThatIsNoNumber) {
  venue.PutDefaultFiles();
  WriteFile(venue.DataFile("tessarine.ini"), "[soldiering_calc]\nheals=many\n");
  EXPECT_EQ(NumberThrownBy([this] { venue.MakeWindow().FormLoad(); }), 13);
}

TEST_F(Start, NeedsNoIniFileAndNoMission) {
  venue.PutDefaultFiles();
  WriteFile(venue.DataFile("tessarine.ini"), "");
  venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1");
  venue.Start();
  EXPECT_EQ(venue.ActiveMission().count(), 2);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

class Close : public testing::Test {
 protected:
  /// Number of files in the data folder that this process has open.
  int OpenFiles() const {
    int count = 0;
    for (const auto& entry : std::filesystem::directory_iterator("/proc/self/fd")) {
      std::error_code ignored;
      const std::string file = std::filesystem::read_symlink(entry.path(), ignored).string();
      count += file.starts_with(venue.DataFolder() + "/") ? 1 : 0;
    }
    return count;
  }

  Venue venue;
};

TEST_F(Close, ClosesThePortAndBothDatabases) {
  venue.Start();
  venue.Port.Open("/dev/ttyS0", "19200,N,8,1");
  ASSERT_GE(OpenFiles(), 2);
  EXPECT_TRUE(venue.Window->close());
  EXPECT_FALSE(venue.Window->isVisible());
  EXPECT_FALSE(venue.Port.PortOpen());
  EXPECT_EQ(OpenFiles(), 0);
}

TEST_F(Close, LeavesThePortAloneOnceCommunicationsAreDisabled) {
  venue.Start();
  venue.Port.FailNextOpen(8002);
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  venue.Press("GetScores");
  venue.Port.Open("/dev/ttyS0", "19200,N,8,1");
  venue.Window->close();
  EXPECT_TRUE(venue.Port.PortOpen());
}

TEST_F(Close, FollowsTheMenuItem) {
  venue.Start();
  venue.Trigger("mnuExit");
  EXPECT_FALSE(venue.Window->isVisible());
  EXPECT_EQ(OpenFiles(), 0);
}

}  // namespace
