#include "takeover/TakeOver.h"

#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QTableView>
#include <QTimer>

#include "platform/qt/QtEventPump.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Controls.h"
#include "tests/takeover/TakeOverSite.h"

namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

/// Does not begin to replace a file piece by piece when told so.
class RefusingFiles : public LinuxFiles {
 public:
  bool Refuses = false;

  std::unique_ptr<NewFile> BeginReplace(const std::string& path, FileReaders readers) override {
    if (Refuses && HasTakeOverMark(*this, path.substr(0, path.rfind('/')))) {
      throw RuntimeError(Fault::DiskFull, "Disk full: " + path);
    }
    return LinuxFiles::BeginReplace(path, readers);
  }
};

class TakeOverWindow : public testing::Test {
 protected:
  TakeOverWindow() { site.PutInstallation("old", "Zachary"); }

  void Open(Language language = Language::English) {
    strings.emplace(language);
    TakeOverWork::Parts work = site.Parts();
    window = std::make_unique<TakeOver>(TakeOver::Parts{.Work = {.Engine = work.Engine,
                                                                 .Old = work.Old,
                                                                 .Disk = disk,
                                                                 .Time = work.Time,
                                                                 .Strings = *strings,
                                                                 .DataFolder = work.DataFolder,
                                                                 .Databases = work.Databases,
                                                                 .Ask = {},
                                                                 .HasPort = work.HasPort},
                                                        .Events = events,
                                                        .Boxes = boxes,
                                                        .FileDialog = dialog,
                                                        .Busy = [this] { return busy; },
                                                        .Reopen =
                                                            [this](const std::set<OldItem>& taken) {
                                                              if (reopenFault) {
                                                                throw RuntimeError(*reopenFault);
                                                              }
                                                              site.Open();
                                                              reopened = taken;
                                                            },
                                                        .EndProgram = [this] { ++ended; },
                                                        .ImportGames = importer},
                                        nullptr);
    Show(*window);
  }

  void Choose(const std::string& folder) {
    dialog.Answers = {site.Folder / folder};
    ::Press(*window, "ChooseFolder");
  }
  void Take() {
    boxes.Answers = {BoxAnswer::Ok};
    ::Press(*window, "TakeOverButton");
  }
  void Tick(int row, bool ticked) const {
    QAbstractItemModel& model = *Find<QTableView>(*window, "FoundTable").model();
    model.setData(model.index(row, 0), ticked ? Qt::Checked : Qt::Unchecked, Qt::CheckStateRole);
  }
  std::string Cell(int row, int column) const {
    const QAbstractItemModel& model = *Find<QTableView>(*window, "FoundTable").model();
    return model.index(row, column).data().toString().toStdString();
  }
  int Rows() const { return Find<QTableView>(*window, "FoundTable").model()->rowCount(); }
  std::string Status() const { return Find<QLabel>(*window, "Status").text().toStdString(); }
  bool Enabled(const char* button) const { return Find<QPushButton>(*window, button).isEnabled(); }

  TakeOverSite site;
  RefusingFiles disk;
  std::optional<StringTable> strings;
  FakeMessageBoxes boxes;
  FakeFileDialog dialog;
  QtEventPump events;
  std::optional<OwnText> busy;
  std::set<OldItem> reopened;
  std::optional<int> reopenFault;
  int ended = 0;
  TakeOver::GameImporter importer;
  std::unique_ptr<TakeOver> window;
};

TEST_F(TakeOverWindow, ShowsWhatWasFoundBesideWhatIsInUse) {
  Open();
  EXPECT_FALSE(Enabled("TakeOverButton"));
  Choose("old");
  ASSERT_EQ(Rows(), 5);
  EXPECT_EQ(Cell(0, 0), "Members");
  EXPECT_THAT(Cell(0, 1), StartsWith("rows: 2, changed "));
  EXPECT_THAT(Cell(0, 2), StartsWith("rows: 2, changed "));
  EXPECT_EQ(Cell(1, 0), "Missions");
  EXPECT_THAT(Cell(2, 1), StartsWith("changed "));
  EXPECT_EQ(Cell(3, 1), "settings: 2, different: 1");
  EXPECT_EQ(Cell(4, 1), "not there");
  EXPECT_EQ(Find<QLineEdit>(*window, "Folder").text().toStdString(), site.Folder / "old");
  EXPECT_TRUE(Enabled("TakeOverButton"));
  EXPECT_EQ(Status(), "");
}

TEST_F(TakeOverWindow, SpeaksChinese) {
  Open(Language::SimplifiedChinese);
  Choose("old");
  EXPECT_EQ(window->windowTitle(), QStringLiteral("接管旧安装"));
  EXPECT_EQ(Cell(3, 1), "2 项设置，其中 1 项不同");
}

TEST_F(TakeOverWindow, TakesOverWhatIsTicked) {
  Open();
  Choose("old");
  Tick(0, false);
  Take();
  EXPECT_EQ(site.Labels(), "Now Zachary Zachary 7");
  EXPECT_EQ(reopened, (std::set{OldItem::Missions, OldItem::Template, OldItem::Settings}));
  EXPECT_THAT(Status(),
              StartsWith("Taken over: Missions, Score card, Settings. What was there before is kept "
                         "as: scenarios-2013-05-21-143005-replaced.mdb, "));
  EXPECT_FALSE(Enabled("TakeOverButton"));
  EXPECT_EQ(boxes.Boxes.size(), 1U);
}

TEST_F(TakeOverWindow, CanTakeNothingWithoutATick) {
  Open();
  Choose("old");
  for (int row = 0; row < 4; ++row) {
    EXPECT_TRUE(Enabled("TakeOverButton"));
    Tick(row, false);
  }
  EXPECT_FALSE(Enabled("TakeOverButton"));
  Tick(2, true);
  EXPECT_TRUE(Enabled("TakeOverButton"));
}

TEST_F(TakeOverWindow, AsksBeforeItReplacesAnything) {
  Open();
  Choose("old");
  boxes.Answers = {BoxAnswer::Cancel};
  ::Press(*window, "TakeOverButton");
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_EQ(boxes.Boxes[0].Text, strings->Text(OwnText::TakeOverQuestion));
  EXPECT_EQ(site.Labels(), site.LabelsOf("Now"));
  EXPECT_TRUE(Enabled("TakeOverButton"));
}

TEST_F(TakeOverWindow, OffersNoTickForWhatIsDamaged) {
  WriteFile(site.Folder / "old/members.mdb", "no database");
  Open();
  Choose("old");
  EXPECT_EQ(Cell(0, 1), "cannot be read");
  EXPECT_THAT(Cell(0, 3), HasSubstr("Unrecognized database format"));
  Tick(0, true);
  Take();
  EXPECT_EQ(site.Labels(), "Now Zachary Zachary 7");
}

TEST_F(TakeOverWindow, TellsOfAFolderThatIsNone) {
  std::filesystem::create_directories(site.Folder / "photos");
  Open();
  Choose("old");
  Choose("photos");
  EXPECT_EQ(Status(), "There is no old installation in " + (site.Folder / "photos") + ".");
  EXPECT_EQ(Rows(), 0);
  EXPECT_FALSE(Enabled("TakeOverButton"));
  Choose("data");
  EXPECT_EQ(Status(), site.Data() + " is the folder in use.");
  EXPECT_FALSE(Enabled("TakeOverButton"));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(TakeOverWindow, StaysAsItIsWhenNoFolderIsChosen) {
  Open();
  Choose("old");
  dialog.Answers = {std::nullopt};
  ::Press(*window, "ChooseFolder");
  EXPECT_EQ(Rows(), 5);
}

TEST_F(TakeOverWindow, WaitsForOtherJobs) {
  Open();
  Choose("old");
  busy = OwnText::ScoresComeIn;
  ::Press(*window, "TakeOverButton");
  EXPECT_EQ(Status(), "Not now: scores are being downloaded. Take over when it has ended.");
  EXPECT_EQ(site.Labels(), site.LabelsOf("Now"));
}

TEST_F(TakeOverWindow, TellsARefusalInABox) {
  Open();
  Choose("old");
  OtherConnection other(site.Data() + "/members.mdb");
  other.Execute("BEGIN IMMEDIATE");
  Take();
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_THAT(boxes.Boxes[1].Text,
              StartsWith("Nothing was taken over. Everything is as it was.\nCould not lock file"));
  EXPECT_EQ(boxes.Boxes[1].Icon, BoxIcon::Exclamation);
  EXPECT_TRUE(reopened.empty());
  EXPECT_TRUE(Enabled("TakeOverButton"));  // another try may succeed
}

TEST_F(TakeOverWindow, EndsTheProgramWhenOnlyTheNextStartCanFinish) {
  Open();
  Choose("old");
  disk.Refuses = true;
  Take();
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_THAT(boxes.Boxes[1].Text, StartsWith("Not everything has been taken over yet."));
  EXPECT_THAT(boxes.Boxes[1].Text, HasSubstr("Disk full: "));
  EXPECT_EQ(ended, 1);
  EXPECT_EQ(site.Labels(), site.LabelsOf("Now"));
  window.reset();
  EXPECT_TRUE(FinishTakeOver(site.Disk, site.Data()));
  EXPECT_EQ(site.Labels(), site.LabelsOf("Zachary"));
}

TEST_F(TakeOverWindow, EndsTheProgramWhenWhatWasTakenCannotBeOpened) {
  WriteFile(site.Folder / "old/a.xml", "<GameData/>");
  int imports = 0;
  importer = [&](const std::string&, FilesOfMembers, const TakeOver::OnImport&) {
    ++imports;
    return ImportedGames();
  };
  reopenFault = Fault::TypeMismatch;
  Open();
  Choose("old");
  Take();
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_THAT(boxes.Boxes[1].Text, StartsWith("Taken over: Members, Missions, Score card, Settings, Game "
                                              "files. What was there before is kept as: members-2013-"));
  EXPECT_THAT(boxes.Boxes[1].Text, HasSubstr("\nIt could not be opened: Type mismatch\nTessarine ends now."));
  EXPECT_EQ(ended, 1);
  EXPECT_EQ(imports, 0) << "the members that are open are not those of the games";
  EXPECT_FALSE(window->isVisible());
}

TEST_F(TakeOverWindow, SaysWhichSettingsAreNoNumbers) {
  WriteFile(site.Folder / "old/tessarine.ini",
            "[comm]\ncommport=7\n[soldiering_calc]\nheals=5\naccuracy=abc\nrespawns=\n");
  Open();
  Choose("old");
  EXPECT_EQ(Cell(3, 1), "settings: 1, different: 1");
  EXPECT_EQ(Cell(3, 3),
            "Port 7 does not exist here and is left out. These settings are no numbers and are left out: "
            "respawns, accuracy");
}

TEST_F(TakeOverWindow, ImportsGameFilesWhereAnArchiveTakesThem) {
  WriteFile(site.Folder / "old/a.xml", "<GameData/>");
  std::string from;
  FilesOfMembers whose = FilesOfMembers::Others;
  std::string during;
  importer = [&](const std::string& folder, FilesOfMembers members, const TakeOver::OnImport& keepOn) {
    whose = members;
    during = Status();
    from = keepOn(0.5) ? folder : "stopped";
    return ImportedGames{.Imported = 3, .Known = 2, .Refused = 1};
  };
  Open();
  Choose("old");
  EXPECT_THAT(Cell(4, 1), StartsWith("files: 1, from "));
  Take();
  EXPECT_EQ(from, site.Folder / "old");
  EXPECT_EQ(whose, FilesOfMembers::Taken);
  EXPECT_EQ(during, "Importing game files...");
  EXPECT_THAT(Status(), testing::EndsWith("\nGames: 3 imported, 2 known before, 1 refused."));
}

TEST_F(TakeOverWindow, ListsWhichGameFilesWereRefusedUntilAnotherFolderIsChosen) {
  WriteFile(site.Folder / "old/a.xml", "<GameData/>");
  importer = [](const std::string&, FilesOfMembers, const TakeOver::OnImport&) {
    return ImportedGames{
        .Imported = 1, .Refused = 2, .RefusedFiles = {"/old/a.xml:3: no", "/old/b.xml: gone"}};
  };
  Open();
  auto& list = Find<QPlainTextEdit>(*window, "RefusedFiles");
  Choose("old");
  EXPECT_FALSE(list.isVisible());
  Take();
  EXPECT_TRUE(list.isVisible());
  EXPECT_TRUE(Find<QLabel>(*window, "RefusedLabel").isVisible());
  EXPECT_FALSE(Find<QTableView>(*window, "FoundTable").isVisible());
  EXPECT_EQ(list.toPlainText(), QStringLiteral("/old/a.xml:3: no\n/old/b.xml: gone"));
  Choose("old");
  EXPECT_FALSE(list.isVisible());
  EXPECT_TRUE(Find<QTableView>(*window, "FoundTable").isVisible());
}

TEST_F(TakeOverWindow, SaysThatAnImportWasStopped) {
  WriteFile(site.Folder / "old/a.xml", "<GameData/>");
  importer = [](const std::string&, FilesOfMembers, const TakeOver::OnImport&) {
    return ImportedGames{.Imported = 3, .Whole = false};
  };
  Open();
  Choose("old");
  Take();
  EXPECT_THAT(Status(),
              testing::EndsWith("\nGames: 3 imported, 0 known before, 0 refused.\nThe import of game "
                                "files was stopped: import the rest with Games, Import Game Files."));
}

TEST_F(TakeOverWindow, TakesEventsWhileFilesAreExchanged) {
  OtherConnection(site.Folder / "old/members.mdb")
      .Execute("UPDATE Members SET Photograph = randomblob(6000000)");
  Open();
  Choose("old");
  bool hasMark = false;
  QTimer timer;
  QObject::connect(&timer, &QTimer::timeout, window.get(),
                   [&] { hasMark = hasMark || HasTakeOverMark(disk, site.Data()); });
  timer.start(0);
  Take();
  EXPECT_TRUE(hasMark);
  EXPECT_EQ(site.Labels(), site.LabelsOf("Zachary"));
}

TEST_F(TakeOverWindow, SaysThatNoArchiveTakesGameFiles) {
  WriteFile(site.Folder / "old/a.xml", "<GameData/>");
  Open();
  Choose("old");
  EXPECT_EQ(Cell(4, 3), "No archive of games here takes them in.");
}

TEST_F(TakeOverWindow, StopsALookAtItsButton) {
  for (int file = 0; file < 3000; ++file) {
    WriteFile(site.Folder / "old/" + std::to_string(file) + ".xml", "<GameData/>");
  }
  Open();
  QTimer stop;
  QObject::connect(&stop, &QTimer::timeout, window.get(), [this] {
    if (Find<QPushButton>(*window, "Stop").isVisible()) {
      Find<QPushButton>(*window, "Stop").click();
    }
  });
  stop.start(0);
  Choose("old");
  EXPECT_EQ(Status(), "Stopped. Nothing was changed.");
  EXPECT_EQ(Rows(), 0);
  EXPECT_FALSE(Find<QPushButton>(*window, "Stop").isVisible());
}

}  // namespace
