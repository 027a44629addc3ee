#include <gmock/gmock.h>

#include <QLabel>

#include "app/UploadProgress.h"
#include "members/ExportMembers.h"
#include "members/ImportMembers.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

// Export and import of members, from the menu to the board.

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class MemberFileCommands : public testing::Test {
 protected:
  MemberFileCommands() {
    venue.Start();
    venue.ChangeDatabase("members.mdb", "DELETE FROM Members");
  }

  /// Imports a file with these contents.
  void Import(const std::string& csv) {
    WriteFile(venue.Folder / "list.csv", csv);
    venue.Dialog.Answers = {venue.Folder / "list.csv"};
    const WhileModal<ImportMembers> open([](ImportMembers& window) {
      EXPECT_TRUE(QTest::qWaitFor([&] { return ::Find<QPushButton>(window, "Import").isEnabled(); }));
      ::Press(window, "Import");
      window.close();
    });
    venue.Trigger("mnuImportMembers");
    EXPECT_EQ(open.Runs(), 1);
  }

  Venue venue{Language::English, Waits::Real};
};

TEST_F(MemberFileCommands, PutAnImportedMemberOnTheBoardAtOnce) {
  venue.LoadGame(SmallGame());
  const std::string before = venue.Row("ScoreDisplay", 0)[1];
  Import("FirstName,LastName,NickName,DallasID\nAda,Byron,Count,AB00000000000001\n");
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT NickName FROM Members"), "Count");
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[1], before);
  EXPECT_THAT(venue.Disk.FileNames(venue.DataFile("backups")), ElementsAre("members-2013-05-21-143005.mdb"));
  // The cursors see the new row: it can be assigned and committed.
  const int number = std::stoi(venue.QueryDatabase("members.mdb", "SELECT ContactID FROM Members"));
  EXPECT_GT(number, 0);
  const WhileModal<QDialog> members([](QDialog& window) { ::Press(window, "OK"); });
  venue.ChooseInPopup(0, "mnuAssignMember");
  EXPECT_THAT(venue.Row("ScoreDisplay", 0)[1], HasSubstr("Count"));
  venue.Boxes.Boxes.clear();
  venue.Trigger("mnuCommitGame");
  EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT TotalGamesPlayed FROM Members"), "1");
}

TEST_F(MemberFileCommands, OpenNoWindowWithoutAFile) {
  venue.Trigger("mnuImportMembers");
  EXPECT_EQ(venue.Dialog.Calls.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(QApplication::activeModalWidget(), nullptr);
}

TEST_F(MemberFileCommands, ReportAFileThatIsNotThere) {
  venue.Dialog.Answers = {venue.Folder / "missing.csv"};
  venue.Trigger("mnuImportMembers");
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, HasSubstr("Run-time error '53'"));
}

TEST_F(MemberFileCommands, RefuseAnImportWhileAnotherCommandRuns) {
  venue.Dialog.WhileOpen = [this] {
    venue.Dialog.WhileOpen = nullptr;
    venue.Trigger("mnuImportMembers");
  };
  venue.Trigger("mnuLoadScores");
  EXPECT_EQ(venue.Dialog.Calls.size(), 1U);
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_EQ(venue.Boxes.Boxes[0].Text, "Another command has not ended yet. Import the members when it has.");
}

TEST_F(MemberFileCommands, ExportWhatAnImportTakes) {
  Import("FirstName,LastName\nAda,Byron\n");
  venue.Dialog.Answers = {venue.Folder / "out.csv"};
  const WhileModal<ExportMembers> open([](ExportMembers& window) { ::Press(window, "Export"); });
  venue.Trigger("mnuExportMembers");
  EXPECT_EQ(open.Runs(), 1);
  EXPECT_THAT(ReadFile(venue.Folder / "out.csv"), HasSubstr(",Ada,Byron,"));
}

}  // namespace
