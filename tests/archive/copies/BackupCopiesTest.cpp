#include "archive/copies/BackupCopies.h"

#include <gmock/gmock.h>

#include <QLabel>
#include <QTableView>
#include <fstream>

#include "tests/archive/copies/CopiesWindow.h"
#include "tests/support/OrdinaryUser.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST_F(BackupCopiesWindow, ListsWhatIsInUseThenTheCopiesFromTheNewest) {
  Open();
  ASSERT_EQ(Table().model()->rowCount(), 3);
  EXPECT_THAT(Cells(0), ElementsAre("Members", "Now", "in use", "3", ""));
  const std::string late = Cells(1)[CopyListModel::Time];
  EXPECT_THAT(late, testing::HasSubstr("2013"));
  EXPECT_THAT(Cells(1), ElementsAre("Members", late, "by Copy Now", "4", "1 row more"));
  EXPECT_THAT(Cells(2), ElementsAre("Members", Cells(2)[CopyListModel::Time],
                                    "before the first change of a run", "1", "2 rows fewer"));
  EXPECT_NE(Cells(2)[CopyListModel::Time], late);
  EXPECT_EQ(Table().model()->index(2, 0).data(Qt::ToolTipRole).toString(), QLatin1String(EarlyFile));
}

TEST_F(BackupCopiesWindow, SpeaksChinese) {
  Open(Language::SimplifiedChinese);
  EXPECT_EQ(window->windowTitle(), QStringLiteral("备份副本"));
  EXPECT_THAT(Cells(2), ElementsAre("会员", Cells(2)[1], "某次运行首次修改之前", "1", "少 2 行"));
  EXPECT_EQ(Find<QPushButton>(*window, "Restore").text(), QStringLiteral("还原(&R)"));
}

TEST_F(BackupCopiesWindow, CountsOneCopyAtATimeOnceItIsShown) {
  for (int day = 10; day < 30; ++day) {
    site.PutCopy("members-2013-04-" + std::to_string(day) + "-200000.mdb", CopySite::WithMembers("'Old'"));
  }
  Make(Language::English);
  EXPECT_EQ(Uncounted(), 23);
  int changes = 0;
  QObject::connect(Table().model(), &QAbstractItemModel::dataChanged, Table().model(), [&] {
    ++changes;
    EXPECT_EQ(Uncounted(), 23 - changes);
  });
  Show(*window);
  WaitForCounts();
  EXPECT_EQ(changes, 23);
  EXPECT_EQ(Cells(22)[CopyListModel::Difference], "2 rows fewer");
}

TEST_F(BackupCopiesWindow, SaysWhichCopyCannotBeRead) {
  site.PutCopy("members-2013-05-03-200000.mdb", "no database");
  Open();
  EXPECT_EQ(Cells(1)[CopyListModel::Rows], "cannot be read");
  EXPECT_EQ(Cells(1)[CopyListModel::Difference], "");
  EXPECT_THAT(Table().model()->index(1, 3).data(Qt::ToolTipRole).toString().toStdString(),
              testing::HasSubstr("members-2013-05-03-200000.mdb"));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(BackupCopiesWindow, SelectsTheNewestCopyAndRestoresNothingThatIsInUse) {
  Open();
  EXPECT_EQ(Table().selectionModel()->selectedRows().first().row(), 1);
  EXPECT_TRUE(Enabled("Restore"));
  Table().selectRow(0);
  EXPECT_FALSE(Enabled("Restore"));
  EXPECT_TRUE(Enabled("CopyToFolder"));
}

TEST_F(BackupCopiesWindow, ListsOnlyWhatIsInUseWithoutAnyCopy) {
  std::filesystem::remove_all(site.CopyFolder());
  Open();
  EXPECT_EQ(Table().model()->rowCount(), 1);
  EXPECT_FALSE(Enabled("Restore"));
}

TEST_F(BackupCopiesWindow, RestoresAfterAQuestion) {
  Open();
  boxes.Answers = {BoxAnswer::Ok};
  Table().selectRow(2);
  const std::string time = Cells(2)[CopyListModel::Time];
  ::Press(*window, "Restore");
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_EQ(boxes.Boxes[0],
            (FakeMessageBoxes::Box{
                "Put the copy of Members from " + time +
                    " in the place of the data in use? What is there now is kept as a copy first.",
                "Restore", BoxIcon::Question, BoxButtons::OkCancel}));
  EXPECT_EQ(site.Names(), "Old");
  EXPECT_EQ(reopened, 1);
  EXPECT_EQ(Status(), QStringLiteral("Restored. What was there before is kept as "
                                     "members-2013-05-21-143005-replaced.mdb."));
  WaitForCounts();
  EXPECT_EQ(Cells(0)[CopyListModel::Rows], "1");
  EXPECT_THAT(Cells(1), ElementsAre("Members", Cells(1)[1], "before a restore", "3", "2 rows more"));
}

TEST_F(BackupCopiesWindow, RestoresByTheKeyboard) {
  Open();
  boxes.Answers = {BoxAnswer::Ok};
  Table().setFocus();
  Type(*window, Qt::Key_Down);
  QTest::keyClick(window.get(), Qt::Key_R, Qt::AltModifier);
  EXPECT_TRUE(QTest::qWaitFor([this] { return reopened == 1; }));  // the button shows that it is pressed
  EXPECT_EQ(site.Names(), "Old");
}

TEST_F(BackupCopiesWindow, ChangesNothingWhenTheQuestionIsCancelled) {
  Open();
  boxes.Answers = {BoxAnswer::Cancel};
  ::Press(*window, "Restore");
  EXPECT_EQ(site.Names(), "Ann Bob Cid");
  EXPECT_EQ(reopened, 0);
  EXPECT_EQ(site.Disk.FileNames(site.CopyFolder()).size(), 2U);
}

TEST_F(BackupCopiesWindow, RefusesToRestoreWhileAJobRunsAndSaysWhich) {
  Open();
  busy = OwnText::ScoresComeIn;
  ::Press(*window, "Restore");
  EXPECT_EQ(Status(), QStringLiteral("Not now: scores are being downloaded. Restore when it has ended."));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_EQ(site.Names(), "Ann Bob Cid");
  busy.reset();
  boxes.Answers = {BoxAnswer::Ok};
  ::Press(*window, "Restore");
  EXPECT_EQ(reopened, 1);
}

TEST_F(BackupCopiesWindow, TellsWhyACopyWasNotRestored) {
  site.PutCopy("members-2013-05-03-200000.mdb", MadeDatabase("scenarios"));
  Open();
  boxes.Answers = {BoxAnswer::Ok};
  ::Press(*window, "Restore");
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_THAT(boxes.Boxes[1].Text,
              testing::StartsWith("The copy was not restored. The data in use is as it was.\n"));
  EXPECT_EQ(boxes.Boxes[1].Icon, BoxIcon::Exclamation);
  EXPECT_EQ(reopened, 0);
  EXPECT_EQ(site.Names(), "Ann Bob Cid");
}

TEST_F(BackupCopiesWindow, CopiesAllDatabasesNow) {
  Open();
  ::Press(*window, "CopyNow");
  EXPECT_EQ(Status(), QStringLiteral("Copied: members-2013-05-21-143005-kept.mdb"));
  WaitForCounts();
  EXPECT_THAT(Cells(1), ElementsAre("Members", Cells(1)[1], "by Copy Now", "3", "as many rows"));
}

TEST_F(BackupCopiesWindow, ReportsACopyThatFailsAndGoesOn) {
  std::filesystem::remove_all(site.CopyFolder());
  WriteFile(site.CopyFolder(), "a file in place of the folder");
  Open();
  ::Press(*window, "CopyNow");
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_EQ(boxes.Boxes[0].Icon, BoxIcon::Critical);
  EXPECT_EQ(Status(), QString());
  EXPECT_TRUE(Enabled("CopyNow"));
  EXPECT_FALSE(Find<QProgressBar>(*window, "Progress").isVisible());
}

TEST_F(BackupCopiesWindow, CopiesTheSelectedOneToAFolder) {
  Open();
  dialog.Answers = {site.Folder / "stick.mdb"};
  ::Press(*window, "CopyToFolder");
  ASSERT_EQ(dialog.Calls.size(), 1U);
  EXPECT_TRUE(dialog.Calls[0].Save);
  EXPECT_EQ(dialog.Calls[0].Name, LateFile);
  EXPECT_EQ(CopySite::NamesIn(site.Folder / "stick.mdb"), "Ann Bob Cid Dee");
  EXPECT_EQ(Status().toStdString(), "Copied: " + site.Folder / "stick.mdb");
}

TEST_F(BackupCopiesWindow, CopiesWhatIsInUseToAFolder) {
  Open();
  Table().selectRow(0);
  dialog.Answers = {site.Folder / "stick.mdb"};
  ::Press(*window, "CopyToFolder");
  EXPECT_EQ(dialog.Calls[0].Name, "members-2013-05-21-143005-kept.mdb");
  EXPECT_EQ(CopySite::NamesIn(site.Folder / "stick.mdb"), "Ann Bob Cid");
}

TEST_F(BackupCopiesWindow, OverwritesNoFileWithoutAQuestion) {
  Open();
  WriteFile(site.Folder / "stick.mdb", "dear");
  for (const BoxAnswer answer : {BoxAnswer::No, BoxAnswer::Yes}) {
    boxes.Answers = {answer};
    dialog.Answers = {site.Folder / "stick.mdb"};
    ::Press(*window, "CopyToFolder");
    EXPECT_EQ(boxes.Boxes.back(),
              (FakeMessageBoxes::Box{site.Folder / "stick.mdb" + " exists already. Replace it?",
                                     "Backup Copies", BoxIcon::Question, BoxButtons::YesNo}));
    EXPECT_EQ(ReadFile(site.Folder / "stick.mdb") == "dear", answer == BoxAnswer::No);
  }
}

TEST_F(BackupCopiesWindow, NeverCopiesOverADatabaseInUse) {
  Open();
  dialog.Answers = {site.MembersFile()};
  ::Press(*window, "CopyToFolder");
  EXPECT_THAT(boxes.Boxes, ElementsAre(InDataFolder(site.MembersFile())));
  EXPECT_EQ(site.Names(), "Ann Bob Cid");
  EXPECT_EQ(Status(), QString());
}

TEST_F(BackupCopiesWindow, NeverCopiesIntoTheDataFolderNotEvenThroughALink) {
  Open();
  std::filesystem::create_directory_symlink(site.Folder / "data", site.Folder / "link");
  for (const std::string& file : {site.Folder / "data/games.mdb", site.Folder / "link/games.mdb"}) {
    boxes.Boxes.clear();
    dialog.Answers = {file};
    ::Press(*window, "CopyToFolder");
    EXPECT_THAT(boxes.Boxes, ElementsAre(InDataFolder(file)));
    EXPECT_FALSE(std::filesystem::exists(file));
  }
}

/// With an archive beside the members that cannot be opened, as the second database.
class CopiesBesideABrokenArchive : public BackupCopiesWindow {
 protected:
  CopiesBesideABrokenArchive() {
    WriteFile(site.Folder / "program/games_default.mdb", MadeDatabase("games"));
    site.PutCopy("games-2013-05-03-200000-kept.mdb", MadeDatabase("games"));
    more = {{.Name = "games",
             .Table = "Games",
             .DefaultPath = site.Folder / "program/games_default.mdb",
             .Title = OwnText::CopiedGames,
             .InUse = [this]() -> Database& {
               askedAt.push_back(reopened);
               throw RuntimeError(Fault::DatabaseLocked, "Could not lock file 'games.mdb'.");
             }}};
    Open();
  }

  std::vector<int> askedAt;  ///< how often the databases had been opened anew whenever it was asked for
};

TEST_F(CopiesBesideABrokenArchive, ListTheOthersAndTellItInItsRow) {
  ASSERT_EQ(Table().model()->rowCount(), 5);
  EXPECT_THAT(Cells(0), ElementsAre("Members", "Now", "in use", "3", ""));
  EXPECT_THAT(Cells(1), ElementsAre("Past games", "Now", "in use", "cannot be read", ""));
  EXPECT_EQ(Table().model()->index(1, CopyListModel::Size).data().toString(), QString());
  EXPECT_EQ(Table().model()->index(1, 0).data(Qt::ToolTipRole).toString(),
            QStringLiteral("Could not lock file 'games.mdb'."));
  EXPECT_EQ(Cells(2)[CopyListModel::Data], "Past games");
  EXPECT_EQ(Cells(2)[CopyListModel::Rows], "0");
  EXPECT_EQ(Cells(3)[CopyListModel::Rows], "4");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(CopiesBesideABrokenArchive, AreRestoredAndThenAskForItOnlyOnceTheCursorsAreOpenedAnew) {
  askedAt.clear();
  boxes.Answers = {BoxAnswer::Ok};
  Table().selectRow(4);
  ::Press(*window, "Restore");
  EXPECT_EQ(site.Names(), "Old");
  EXPECT_EQ(reopened, 1);
  EXPECT_THAT(askedAt, testing::Each(1));
  EXPECT_THAT(askedAt, testing::Not(IsEmpty()));
  EXPECT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_THAT(Status().toStdString(), testing::StartsWith("Restored."));
  EXPECT_EQ(Table().model()->rowCount(), 6);
}

TEST_F(CopiesBesideABrokenArchive, AreMadeOfTheOthersAndTheFailureIsTold) {
  ::Press(*window, "CopyNow");
  EXPECT_EQ(Status(), QStringLiteral("Copied: members-2013-05-21-143005-kept.mdb"));
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_THAT(boxes.Boxes[0].Text, testing::HasSubstr("Could not lock file 'games.mdb'."));
  EXPECT_TRUE(Enabled("CopyNow"));
}

TEST_F(CopiesBesideABrokenArchive, OfItAreNotRestoredAndThatIsTold) {
  boxes.Answers = {BoxAnswer::Ok};
  Table().selectRow(2);
  ::Press(*window, "Restore");
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_THAT(boxes.Boxes[1].Text, testing::HasSubstr("Could not lock file 'games.mdb'."));
  EXPECT_EQ(reopened, 0);
}

TEST_F(BackupCopiesWindow, SaysWhenTheCopiesCannotBeListed) {
  std::filesystem::permissions(site.CopyFolder(), std::filesystem::perms(0111));
  {
    const OrdinaryUser user;
    Open();
  }
  std::filesystem::permissions(site.CopyFolder(), std::filesystem::perms(0755));
  EXPECT_EQ(Table().model()->rowCount(), 1);
  EXPECT_THAT(Status().toStdString(), testing::StartsWith("The copies cannot be listed: "));
  EXPECT_THAT(Status().toStdString(), testing::HasSubstr(site.CopyFolder()));
}

TEST_F(BackupCopiesWindow, DoesNothingWhenTheFileDialogIsCancelled) {
  Open();
  ::Press(*window, "CopyToFolder");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_EQ(Status(), QString());
}

}  // namespace
