#include <gmock/gmock.h>

#include "tests/support/Venue.h"

// Backup copies of both databases, as the program makes them.

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class BackupCopiesOfARun : public testing::Test {
 protected:
  BackupCopiesOfARun() {
    venue.PutDefaultFiles();
    venue.ChangeDatabase("members.mdb",
                         "INSERT INTO Members (ContactID, FirstName, LastName) VALUES (4, 'Ada', 'Byron')");
    venue.Start();
  }

  void Commit() {
    venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
    venue.Trigger("mnuCommitGame");
  }

  std::vector<std::string> Copies() const { return venue.Disk.FileNames(venue.DataFile("backups")); }

  Venue venue;
};

TEST_F(BackupCopiesOfARun, AreNotMadeByLooking) {
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  venue.ActiveMission().setCurrentIndex(3);
  EXPECT_THAT(Copies(), IsEmpty());
}

TEST_F(BackupCopiesOfARun, AreMadeOfTheDatabaseThatChanges) {
  Commit();
  Commit();
  EXPECT_THAT(Copies(), ElementsAre("members-2013-05-21-143005.mdb"));
  EXPECT_EQ(venue.QueryDatabase("backups/members-2013-05-21-143005.mdb",
                                "SELECT TotalGamesPlayed FROM Members WHERE ContactID = 4"),
            "0");
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT TotalGamesPlayed FROM Members WHERE ContactID = 4"),
            "2");
}

TEST_F(BackupCopiesOfARun, AreMadeOnceARun) {
  Commit();
  venue.Window.reset();
  venue.Time.DateAndTime = "2013-05-22 14:30:05";
  venue.Start();
  Commit();
  EXPECT_THAT(Copies(), ElementsAre("members-2013-05-21-143005.mdb", "members-2013-05-22-143005.mdb"));
}

TEST_F(BackupCopiesOfARun, AreMissedOnlyInAWordAfterTheCommand) {
  WriteFile(venue.DataFile("backups"), "a file in place of the folder");
  Commit();
  ASSERT_EQ(venue.Boxes.Boxes.size(), 2U);
  EXPECT_EQ(venue.Boxes.Boxes[0].Title, "Update Success");
  EXPECT_EQ(venue.Boxes.Boxes[1].Title, "Database status");
  EXPECT_EQ(venue.Boxes.Boxes[1].Icon, BoxIcon::Exclamation);
  EXPECT_THAT(venue.Boxes.Boxes[1].Text,
              testing::StartsWith("The backup copies of " + venue.DataFile("members.mdb") + " could not be"));
  Commit();
  EXPECT_EQ(venue.Boxes.Boxes.size(), 3U);
}

}  // namespace
