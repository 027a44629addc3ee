#include "archive/import/ImportGames.h"

#include <gmock/gmock.h>

#include <QApplication>
#include <QCheckBox>
#include <QClipboard>
#include <QLabel>
#include <QProgressBar>
#include <QTableView>
#include <filesystem>

#include "core/gamefile/GameFile.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/support/Captions.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/OpenSession.h"
#include "tests/support/RandomGame.h"
#include "tests/support/TestDatabase.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// A disk on which reading a file takes so long that the window is served after each.
class SlowDisk : public LinuxFiles {
 public:
  std::uint64_t Space = std::uint64_t{1} << 40U;
  std::uint64_t FreeSpace(const std::string& /*path*/) const override { return Space; }
  std::string Read(const std::string& path) const override {
    QTest::qSleep(Milliseconds);
    return LinuxFiles::Read(path);
  }
  int Milliseconds = 0;
};

class ImportGamesWindow : public testing::TestWithParam<Language> {
 protected:
  ImportGamesWindow() {
    std::filesystem::create_directories(venue.Folder / "program");
    std::filesystem::create_directories(Path(""));
    WriteFile(venue.Folder / "program/games_default.mdb", MadeDatabase("games"));
    EXPECT_TRUE(venue.Open());
  }

  std::string Path(const std::string& name) const { return venue.Folder / "files/" + name; }
  void PutGames(int count) {
    for (int game = 1; game <= count; ++game) {
      ::Game made(strings);
      FillRandomly(made, 3, static_cast<unsigned>(game));
      WriteFile(Path(std::to_string(game) + ".xml"), WriteGameFile(made, "Flag"));
    }
  }

  ImportGames& Open() {
    window = std::make_unique<ImportGames>(ImportGames::Parts{.Archives = access,
                                                              .Members = venue.session.DbMembers(),
                                                              .Disk = disk,
                                                              .CommonDialog1 = dialog,
                                                              .Boxes = venue.Boxes,
                                                              .Events = events,
                                                              .Elapsed = events,
                                                              .Time = venue.Time,
                                                              .Strings = strings,
                                                              .Factors = {},
                                                              .UserDataFolder = venue.Folder.Path()},
                                           nullptr);
    Show(*window);
    return *window;
  }
  void ChooseFolder() {
    dialog.Answers = {Path("").substr(0, Path("").size() - 1)};
    ::Press(*window, "ChooseFolder");
  }
  void Import() {
    ChooseFolder();
    ::Press(*window, "Import");
  }

  std::string Status() const { return Find<QLabel>(*window, "Status").text().toStdString(); }
  std::vector<std::string> Refused(int column) const {
    const QAbstractItemModel& model = *Find<QTableView>(*window, "Refused").model();
    std::vector<std::string> cells;
    for (int row = 0; row < model.rowCount(); ++row) {
      cells.push_back(model.index(row, column).data().toString().toStdString());
    }
    return cells;
  }
  std::string Games() const {
    return OtherConnection(venue.Folder / "games.mdb").Query("SELECT count(*) FROM Games");
  }
  std::string In(const char* english, const char* chinese) const {
    return GetParam() == Language::English ? english : chinese;
  }

  OpenSession venue;
  StringTable strings{GetParam()};
  SlowDisk disk;
  FakeFileDialog dialog;
  FakeEventPump events;
  ArchiveAccess access{{.Session = venue.session,
                        .Disk = venue.Disk,
                        .Engine = venue.Databases,
                        .Strings = strings,
                        .UserDataFolder = venue.Folder.Path(),
                        .ProgramFolder = venue.Folder / "program"}};
  std::unique_ptr<ImportGames> window;
};

TEST_P(ImportGamesWindow, IsCaredForAndHasItsCaptions) {
  Open();
  ExpectCaredFor(*window);
  EXPECT_EQ(window->windowTitle().toStdString(), In("Import Game Files", "导入比赛文件"));
  ExpectLabels(*window, {{"Folder", In("&Folder", "文件夹(&F)")},
                         {"Refused", In("&Refused files", "未导入的文件(&R)")}});
  const QAbstractItemModel& model = *Find<QTableView>(*window, "Refused").model();
  EXPECT_EQ(model.headerData(2, Qt::Horizontal).toString().toStdString(), In("Reason", "原因"));
  EXPECT_FALSE(Find<QPushButton>(*window, "Import").isEnabled());
  EXPECT_FALSE(Find<QPushButton>(*window, "Stop").isEnabled());
}

TEST_P(ImportGamesWindow, ImportsTheChosenFolderAndListsWhatItRefused) {
  PutGames(3);
  WriteFile(Path("bad.xml"), "<GameData>\n<oops");
  Open();
  Import();
  EXPECT_THAT(
      dialog.Calls,
      ElementsAre(FakeFileDialog::Call{
          .Filter = {}, .Name = {}, .Title = In("Import Game Files", "导入比赛文件"), .OfFolder = true}));
  EXPECT_EQ(Status(), In("3 games imported, 0 were there already, 1 files refused.",
                         "已导入 3 场比赛，0 场此前已有，1 个文件未导入。"));
  EXPECT_THAT(Refused(RefusedFilesModel::FileColumn), ElementsAre("bad.xml"));
  EXPECT_THAT(Refused(RefusedFilesModel::LineColumn), ElementsAre("2"));
  EXPECT_THAT(Refused(RefusedFilesModel::ReasonColumn),
              ElementsAre(In("It is damaged, or no XML at all.", "文件已损坏，或者根本不是 XML。")));
  EXPECT_EQ(Games(), "3");
  EXPECT_TRUE(window->HasImported());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  ::Press(*window, "Import");
  EXPECT_EQ(Status(), In("0 games imported, 3 were there already, 1 files refused.",
                         "已导入 0 场比赛，3 场此前已有，1 个文件未导入。"));
}

TEST_P(ImportGamesWindow, SaysHowManyDeletedGamesItBroughtBack) {
  PutGames(3);
  Open();
  Import();
  ExecuteSql(venue.Folder / "games.mdb", "UPDATE Games SET Deleted = '2026-11-21 20:15:00' WHERE GameID < 3");
  Open();
  Import();
  EXPECT_EQ(Status(), In("0 games imported, 1 were there already, 0 files refused.\n"
                         "2 of the games had been deleted, and were brought back as they were.",
                         "已导入 0 场比赛，1 场此前已有，0 个文件未导入。\n"
                         "2 场比赛曾被删除，现已按原样恢复。"));
  EXPECT_EQ(Games(), "3");
  EXPECT_TRUE(window->HasImported());
}

TEST_P(ImportGamesWindow, ListsTheFilesOfKnownGamesBehindTheRefusedOnesWhereThatIsWanted) {
  PutGames(2);
  Open();
  Import();
  WriteFile(Path("bad.xml"), "<GameData>\n<oops");
  ExecuteSql(venue.Folder / "games.mdb", "UPDATE Games SET Played = '2013-05-21 14:30:05'");
  ::Press(*window, "Import");
  EXPECT_THAT(Refused(RefusedFilesModel::FileColumn), ElementsAre("bad.xml"));
  auto& list = Find<QCheckBox>(*window, "ListKnown");
  EXPECT_EQ(list.text().toStdString(),
            In("&List files of games that were there already, too", "同时列出此前已有的比赛的文件(&L)"));
  list.click();
  EXPECT_THAT(Refused(RefusedFilesModel::FileColumn), ElementsAre("bad.xml", "1.xml", "2.xml"));
  EXPECT_THAT(Refused(RefusedFilesModel::LineColumn), ElementsAre("2", "", ""));
  EXPECT_EQ(Refused(RefusedFilesModel::ReasonColumn).at(1),
            In("It is the past game of 2013-05-21 14:30, Flag.", "即 2013-05-21 14:30 的历史比赛（Flag）。"));
  list.click();
  EXPECT_THAT(Refused(RefusedFilesModel::FileColumn), ElementsAre("bad.xml"));
}

TEST_P(ImportGamesWindow, CopiesTheListOfRefusedFiles) {
  WriteFile(Path("bad.xml"), "<html/>");
  Open();
  Import();
  QTest::keyClick(&Find<QTableView>(*window, "Refused"), Qt::Key_C, Qt::ControlModifier);
  EXPECT_THAT(QApplication::clipboard()->text().toStdString(), testing::HasSubstr("bad.xml\t1\t"));
}

TEST_P(ImportGamesWindow, SaysThatAFolderHasNoGames) {
  Open();
  Import();
  EXPECT_EQ(Status(), In("There are no game files in this folder.", "该文件夹中没有比赛文件。"));
  EXPECT_FALSE(window->HasImported());
}

TEST_P(ImportGamesWindow, DoesNothingWhenNoFolderIsChosen) {
  Open();
  ::Press(*window, "ChooseFolder");
  EXPECT_EQ(dialog.Calls.size(), 1U);
  EXPECT_FALSE(Find<QPushButton>(*window, "Import").isEnabled());
}

TEST_P(ImportGamesWindow, TakesNumbersAsTheyStandOnlyByATick) {
  ::Game made(strings);
  FillRandomly(made, 3, 1);
  for (Player& player : made.Players) {
    player.MemberIndex = player.Active ? 4711 : 0;
  }
  WriteFile(Path("a.xml"), WriteGameFile(made, "Flag"));
  made.GameDate = "other";
  Open();
  EXPECT_FALSE(Find<QCheckBox>(*window, "OwnTable").isChecked());
  Find<QCheckBox>(*window, "OwnTable").click();
  Import();
  const auto members = [this] {
    return OtherConnection(venue.Folder / "games.mdb")
        .Query(
            "SELECT group_concat(DISTINCT MemberID) FROM (SELECT MemberID FROM GamePlayers ORDER BY GameID)");
  };
  EXPECT_EQ(members(), "4711");
  Find<QCheckBox>(*window, "OwnTable").click();
  WriteFile(Path("a.xml"), WriteGameFile(made, "Flag"));
  ::Press(*window, "Import");
  EXPECT_EQ(members(), "4711,0");
}

TEST_P(ImportGamesWindow, StopsAndKeepsWhatIsThere) {
  PutGames(20);
  disk.Milliseconds = 40;
  Open();
  int served = 0;
  std::function<void()> serve = [&] {
    EXPECT_TRUE(Find<QProgressBar>(*window, "Progress").isVisible());
    EXPECT_FALSE(Find<QPushButton>(*window, "Import").isEnabled());
    if (++served == 3) {
      ::Press(*window, "Stop");
    }
    events.At(std::chrono::milliseconds(0), serve);
  };
  events.At(std::chrono::milliseconds(0), serve);
  Import();
  EXPECT_GE(served, 3);
  EXPECT_THAT(Status(), testing::StartsWith(In("Stopped. ", "已停止。")));
  const int games = std::stoi(Games());
  EXPECT_GE(games, 1);
  EXPECT_LT(games, 20);
  EXPECT_TRUE(Find<QPushButton>(*window, "Import").isEnabled());
  EXPECT_FALSE(Find<QPushButton>(*window, "Stop").isEnabled());
}

TEST_P(ImportGamesWindow, TellsTheTimeLeft) {
  PutGames(8);
  disk.Milliseconds = 40;
  Open();
  std::vector<std::string> told;
  std::function<void()> serve = [&] {
    events.Pass(std::chrono::minutes(1));
    told.push_back(Find<QLabel>(*window, "TimeLeft").text().toStdString());
    events.At(std::chrono::milliseconds(0), serve);
  };
  events.At(std::chrono::milliseconds(0), serve);
  Import();
  EXPECT_THAT(told, testing::Contains(testing::HasSubstr(In(" min left", " 分钟"))));
  EXPECT_EQ(Find<QLabel>(*window, "TimeLeft").text(), QString());
}

TEST_P(ImportGamesWindow, ClosesInTheMiddleOfAnImport) {
  PutGames(20);
  disk.Milliseconds = 40;
  Open();
  events.At(std::chrono::milliseconds(0), [&] { window->close(); });
  Import();
  EXPECT_FALSE(window->isVisible());
  EXPECT_LT(std::stoi(Games()), 20);
}

TEST_P(ImportGamesWindow, TellsWhyItEndedEarlyWithoutABox) {
  PutGames(2);
  disk.Space = 1000;
  Open();
  Import();
  EXPECT_EQ(
      Status(),
      In("The import ended early: Less than 32 MB are free on the disk. Delete what you no longer need.\n"
         "0 games imported, 0 were there already, 0 files refused.",
         "导入提前结束：磁盘剩余空间不足 32 MB。请删除不再需要的文件。\n"
         "已导入 0 场比赛，0 场此前已有，0 个文件未导入。"));
  EXPECT_FALSE(std::filesystem::exists(venue.Folder / "games.mdb"));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_P(ImportGamesWindow, IsUsedByKeys) {
  PutGames(1);
  Open();
  ChooseFolder();
  Type(*window, Qt::Key_Return);
  EXPECT_EQ(Games(), "1");
  Type(*window, Qt::Key_Escape);
  EXPECT_FALSE(window->isVisible());
}

INSTANTIATE_TEST_SUITE_P(InBoth, ImportGamesWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese));

}  // namespace
