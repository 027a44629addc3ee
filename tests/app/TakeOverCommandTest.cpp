// An old installation taken over while the program runs, and at its next start.

#include <gmock/gmock.h>

#include <QLabel>
#include <QPlainTextEdit>
#include <filesystem>

#include "takeover/TakeOver.h"
#include "takeover/TakeOverMark.h"
#include "tests/support/OldFiles.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

class OldInstallationInTheProgram : public testing::Test {
 protected:
  OldInstallationInTheProgram() : venue(Language::English, Waits::Real) {
    venue.PutDefaultFiles();
    std::filesystem::copy(venue.DataFolder(), venue.Folder / "old", std::filesystem::copy_options::recursive);
    OtherConnection(venue.Folder / "old/members.mdb")
        .Execute("INSERT INTO Members (ContactID, FirstName, NickName) VALUES (4, 'Eve', 'Eagle')");
    OtherConnection(venue.Folder / "old/scenarios.mdb").Execute("DELETE FROM Table1 WHERE ID > 2");
    WriteFile(venue.Folder / "old/tessarine.ini", "[soldiering_calc]\nheals=5\n[ports]\ncom1=/dev/old\n");
    venue.ChangeDatabase(
        "members.mdb", "INSERT INTO Members (ContactID, FirstName, NickName) VALUES (4, 'Ada', 'Countess')");
    venue.Start();
  }

  void TakeOverAll() {
    const WhileModal<TakeOver> look([this](TakeOver& window) {
      venue.Dialog.Answers = {venue.Folder / "old"};
      ::Press(window, "ChooseFolder");
      venue.Boxes.Answers = {BoxAnswer::Ok};
      ::Press(window, "TakeOverButton");
      status = Find<QLabel>(window, "Status").text().toStdString();
      refused = Find<QPlainTextEdit>(window, "RefusedFiles").toPlainText().toStdString();
      window.close();
    });
    venue.Trigger("mnuTakeOver");
    ASSERT_EQ(look.Runs(), 1);
  }

  Venue venue;
  std::string status;
  std::string refused;
};

TEST_F(OldInstallationInTheProgram, IsInUseAtOnce) {
  TakeOverAll();
  EXPECT_THAT(status, StartsWith("Taken over: Members, Missions, Score card, Settings."));
  EXPECT_GE(venue.ActiveMission().findText(QStringLiteral("Signal Fires")), 0);
  EXPECT_EQ(venue.ActiveMission().findText(QStringLiteral("Long Shot")), -1);
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  EXPECT_THAT(venue.Row("ScoreDisplay", 0)[1], HasSubstr("Eagle"));
  venue.Trigger("mnuCommitGame");
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT FirstName || TotalGamesPlayed FROM Members"), "Eve1");
  const IniReader ini(venue.Disk, venue.DataFile("tessarine.ini"));
  EXPECT_EQ(ini.ReadIni("soldiering_calc", "heals", ""), "5");
  EXPECT_EQ(ini.ReadIni("ports", "com1", "none"), "none");
}

TEST_F(OldInstallationInTheProgram, GivesItsGamesToTheArchiveWithTheMembersThatCameAlong) {
  WriteFile(venue.Folder / "old/game.xml", GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  WriteFile(venue.Folder / "old/half.xml", "<GameData>\n<PlayerData>");
  WriteFile(venue.Folder / "old/notes.xml", "<notes/>");
  TakeOverAll();
  EXPECT_THAT(status, testing::EndsWith("\nGames: 1 imported, 0 known before, 1 refused."));
  EXPECT_THAT(refused, StartsWith((venue.Folder / "old/half.xml") + ":2: "));
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT count(*) FROM Games"), "1");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT MemberID FROM GamePlayers"), "4");
}

TEST_F(OldInstallationInTheProgram, ClearsTheBoard) {
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  EXPECT_GT(venue.RowCount("ScoreDisplay"), 0);
  TakeOverAll();
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
}

TEST_F(OldInstallationInTheProgram, IsFinishedAtTheNextStartBeforeAnythingIsOpened) {
  venue.Window->close();
  std::filesystem::create_directories(TakeOverFolder(venue.DataFolder()));
  for (const char* file : {"members.mdb", "scenarios.mdb"}) {
    std::filesystem::copy_file(venue.Folder / "old/" + file, TakeOverFolder(venue.DataFolder()) + "/" + file);
  }
  MarkTakeOver(venue.Disk, venue.DataFolder(), {"members.mdb", "scenarios.mdb"});
  venue.Boxes.Boxes.clear();
  venue.Start();
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(venue.ActiveMission().findText(QStringLiteral("Long Shot")), -1);
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT FirstName FROM Members"), "Eve");
  EXPECT_FALSE(HasTakeOverMark(venue.Disk, venue.DataFolder()));
}

TEST_F(OldInstallationInTheProgram, WaitsForAGameThatIsNotKept) {
  std::filesystem::create_directories(venue.DataFile("games.mdb"));  // so there can be no archive
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  venue.ActiveMission().setCurrentIndex(2);
  venue.Boxes.Boxes.clear();
  venue.Trigger("mnuTakeOver");
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_EQ(venue.Boxes.Boxes[0].Text, "The game on the board is not kept yet. Save or clear it first.");
}

TEST_F(OldInstallationInTheProgram, OfJetFilesIsConvertedWithTheirPhotographs) {
  SKIP_WITHOUT_OLD_FILES();
  for (const char* file : {"members.mdb", "scenarios.mdb"}) {
    std::filesystem::copy_file(TESSARINE_OLD_FILES + std::string("/") + file, venue.Folder / "old/" + file,
                               std::filesystem::copy_options::overwrite_existing);
  }
  TakeOverAll();
  EXPECT_THAT(status, StartsWith("Taken over: Members, Missions, "));
  EXPECT_NE(venue.QueryDatabase("members.mdb",
                                "SELECT count(*) FROM Members WHERE length(Photograph) = PhotographLength"),
            "0");
}

TEST(TakeOverDuringADownload, IsRefused) {
  Venue venue;
  venue.Start();
  venue.Events.At(std::chrono::milliseconds(10), [&] {
    venue.Boxes.Boxes.clear();
    venue.Trigger("mnuTakeOver");
    ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
    EXPECT_EQ(venue.Boxes.Boxes[0].Text,
              "Not now: scores are being downloaded. Take over when it has ended.");
  });
  venue.Press("GetScores");  // no unit answers
}

}  // namespace
