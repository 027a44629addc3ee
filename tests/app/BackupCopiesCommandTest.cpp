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

  /// Restores the copy in this file.
  void Restore(const QString& file) {
    const WhileModal<BackupCopies> look([this, file](BackupCopies& window) {
      auto& table = Find<QTableView>(window, "CopyTable");
      const QAbstractItemModel& rows = *table.model();
      const QModelIndexList found = rows.match(rows.index(0, 0), Qt::ToolTipRole, file);
      ASSERT_EQ(found.size(), 1);
      table.selectRow(found.first().row());
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
  Restore(QStringLiteral("members-2013-05-21-143005-kept.mdb"));
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT TotalGamesPlayed || NickName FROM Members"),
            "0Countess");
  EXPECT_THAT(venue.Row("ScoreDisplay", 0)[1], testing::HasSubstr("Countess"));
  // And the next commit goes into the restored file.
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  venue.Trigger("mnuCommitGame");
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT TotalGamesPlayed FROM Members"), "1");
}

TEST_F(RestoreInTheProgram, TakesANumberThatIsSomebodyElsesFromTheBoardAndFromPastGames) {
  CopyNow();
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  ASSERT_EQ(venue.QueryDatabase("games.mdb", "SELECT MemberID FROM GamePlayers"), "4");
  venue.ChangeDatabase("backups/members-2013-05-21-143005-kept.mdb",
                       "UPDATE Members SET FirstName = 'Eve', LastName = 'Moss'");
  Restore(QStringLiteral("members-2013-05-21-143005-kept.mdb"));
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT MemberID FROM GamePlayers"), "0");
  EXPECT_THAT(venue.Row("ScoreDisplay", 0)[1], testing::Not(testing::HasSubstr("Eve")));
  // And what changes on the board later does not bring it back.
  venue.ActiveMission().setCurrentIndex(1);
  emit venue.ActiveMission().activated(1);
  venue.Trigger("mnuClearScores");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT max(MemberID) FROM GamePlayers"), "0");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT count(*) FROM Games"), "1");
}

TEST_F(RestoreInTheProgram, KeepsTheChosenMissionByItsName) {
  venue.ActiveMission().setCurrentIndex(3);
  const QString chosen = venue.ActiveMission().currentText();
  CopyNow();
  venue.ChangeDatabase(
      "backups/scenarios-2013-05-21-143005-kept.mdb",
      "UPDATE Table1 SET ID = ID + 1000; INSERT INTO Table1 (ID, MissionName) VALUES (1, 'First')");
  const int before = venue.ActiveMission().count();
  Restore(QStringLiteral("scenarios-2013-05-21-143005-kept.mdb"));
  EXPECT_EQ(venue.ActiveMission().count(), before + 1);
  EXPECT_EQ(venue.ActiveMission().currentText(), chosen);
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 4);
  EXPECT_TRUE(venue.Find<QAction>("mnuMissionResults").isEnabled());
}

TEST_F(RestoreInTheProgram, FallsBackToNoneWhereTheMissionIsGone) {
  venue.ActiveMission().setCurrentIndex(3);
  CopyNow();
  venue.ChangeDatabase("backups/scenarios-2013-05-21-143005-kept.mdb", "DELETE FROM Table1");
  Restore(QStringLiteral("scenarios-2013-05-21-143005-kept.mdb"));
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 0);
  EXPECT_FALSE(venue.Find<QAction>("mnuMissionResults").isEnabled());
}

TEST_F(RestoreInTheProgram, OfThePastGamesBringsThemBackAndKeepsTheGameOnTheBoard) {
  venue.LoadGame(GameFile(PlayerOf(1, "")));
  CopyNow();
  venue.ChangeDatabase("games.mdb", "DELETE FROM GamePlayers; DELETE FROM Games");
  venue.LoadGame(GameFile(PlayerOf(2, "")));
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT count(*) FROM Games"), "1");
  Restore(QStringLiteral("games-2013-05-21-143005-kept.mdb"));
  EXPECT_THAT(status.toStdString(), testing::HasSubstr("games-2013-05-21-143005-replaced.mdb"));
  EXPECT_EQ(
      venue.QueryDatabase(
          "games.mdb", "SELECT group_concat(PlayerIndex) FROM (SELECT * FROM GamePlayers ORDER BY GameID)"),
      "1,2");
  EXPECT_EQ(venue.QueryDatabase("backups/games-2013-05-21-143005-replaced.mdb",
                                "SELECT group_concat(PlayerIndex) FROM GamePlayers"),
            "2");
}

TEST_F(RestoreInTheProgram, OfThePastGamesIsOfferedWhenTheirFileIsGone) {
  venue.LoadGame(GameFile(PlayerOf(1, "")));
  CopyNow();
  venue.Boxes.Answers = {BoxAnswer::Ok};
  venue.Trigger("mnuClearScores");
  std::filesystem::remove(venue.DataFile("games.mdb"));
  Restore(QStringLiteral("games-2013-05-21-143005-kept.mdb"));
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT count(*) FROM Games"), "1");
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
