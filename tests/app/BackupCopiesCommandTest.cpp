// Backup copies restored while the program runs.

#include <gmock/gmock.h>

#include <QLabel>
#include <filesystem>

#include "archive/copies/BackupCopies.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::ElementsAre;

class RestoreInTheProgram : public testing::Test {
 protected:
  RestoreInTheProgram() : venue(Language::English, Waits::Real) {
    venue.PutDefaultFiles();
    venue.ChangeDatabase("members.mdb",
                         "INSERT INTO Members (ContactID, FirstName, LastName) VALUES (4, 'Ada', 'Byron')");
    venue.Start();
  }

  /// Restores the copy in this row of the list; what is in use takes the first two.
  void Restore(int row) {
    const WhileModal<BackupCopies> look([this, row](BackupCopies& window) {
      Find<QTableView>(window, "CopyTable").selectRow(row);
      venue.Boxes.Answers = {BoxAnswer::Ok};
      ::Press(window, "Restore");
      status = Find<QLabel>(window, "Status").text();
      window.close();
    });
    venue.Trigger("mnuBackupCopies");
    ASSERT_EQ(look.Runs(), 1);
  }

  void CopyNow() {
    const WhileModal<BackupCopies> look([](BackupCopies& window) {
      ::Press(window, "CopyNow");
      window.close();
    });
    venue.Trigger("mnuBackupCopies");
    ASSERT_EQ(look.Runs(), 1);
  }

  Venue venue;
  QString status;
};

TEST_F(RestoreInTheProgram, BringsBackMembersAndTheBoardIsRight) {
  CopyNow();
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  venue.Trigger("mnuCommitGame");
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT TotalGamesPlayed FROM Members"), "1");
  venue.ChangeDatabase("members.mdb", "UPDATE Members SET NickName = 'Other'");
  const auto copies = venue.Disk.FileNames(venue.DataFile("backups"));
  ASSERT_THAT(copies, ElementsAre("members-2013-05-21-143005-kept.mdb", "members-2013-05-21-143005.mdb",
                                  "scenarios-2013-05-21-143005-kept.mdb"));
  venue.ChangeDatabase("backups/members-2013-05-21-143005-kept.mdb",
                       "UPDATE Members SET NickName = 'Countess'");
  Restore(2);
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT TotalGamesPlayed || NickName FROM Members"),
            "0Countess");
  EXPECT_THAT(venue.Row("ScoreDisplay", 0)[1], testing::HasSubstr("Countess"));
  // And the next commit goes into the restored file.
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  venue.Trigger("mnuCommitGame");
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT TotalGamesPlayed FROM Members"), "1");
}

TEST_F(RestoreInTheProgram, KeepsTheChosenMissionByItsName) {
  venue.ActiveMission().setCurrentIndex(3);
  const QString chosen = venue.ActiveMission().currentText();
  CopyNow();
  venue.ChangeDatabase(
      "backups/scenarios-2013-05-21-143005-kept.mdb",
      "UPDATE Table1 SET ID = ID + 1000; INSERT INTO Table1 (ID, MissionName) VALUES (1, 'First')");
  const int before = venue.ActiveMission().count();
  Restore(3);
  EXPECT_EQ(venue.ActiveMission().count(), before + 1);
  EXPECT_EQ(venue.ActiveMission().currentText(), chosen);
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 4);
  EXPECT_TRUE(venue.Find<QAction>("mnuMissionResults").isEnabled());
}

TEST_F(RestoreInTheProgram, FallsBackToNoneWhereTheMissionIsGone) {
  venue.ActiveMission().setCurrentIndex(3);
  CopyNow();
  venue.ChangeDatabase("backups/scenarios-2013-05-21-143005-kept.mdb", "DELETE FROM Table1");
  Restore(3);
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 0);
  EXPECT_FALSE(venue.Find<QAction>("mnuMissionResults").isEnabled());
}

TEST(RestoreDuringADownload, IsRefused) {
  Venue venue;
  venue.PutDefaultFiles();
  venue.ChangeDatabase("members.mdb", "INSERT INTO Members (ContactID, FirstName) VALUES (4, 'Ada')");
  std::filesystem::create_directories(venue.DataFile("backups"));
  std::filesystem::copy_file(venue.DataFile("members.mdb"),
                             venue.DataFile("backups/members-2013-05-01-200000.mdb"));
  venue.Start();
  venue.ChangeDatabase("members.mdb", "DELETE FROM Members");
  QString status;
  venue.Events.At(std::chrono::milliseconds(10), [&] {
    const WhileModal<BackupCopies> look([&](BackupCopies& window) {
      Press(window, "Restore");
      status = Find<QLabel>(window, "Status").text();
      window.close();
    });
    venue.Trigger("mnuBackupCopies");
  });
  venue.Press("GetScores");  // no unit answers
  EXPECT_EQ(status, QStringLiteral("Not now: scores are being downloaded. Restore when it has ended."));
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT count(*) FROM Members"), "0");
}

}  // namespace
