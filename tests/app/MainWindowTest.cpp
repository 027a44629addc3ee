#include <gmock/gmock.h>
#include <sqlite3.h>

#include <QHeaderView>
#include <QLabel>
#include <QMenuBar>

#include "app/UploadProgress.h"
#include "tests/app/Venue.h"
#include "tests/core/Frames.h"
#include "tests/platform/linux/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr const char* SmallGame =
    "<GameData><GameHeader><MissionName>First "
    "Muster</MissionName><GameDate>today</GameDate></GameHeader><PlayerData>"
    "<Player><Index>1</Index><Active>1</Active><BonusPoints>5</BonusPoints></Player>"
    "<Player><Index>40</Index><Active>1</Active><BonusPoints>9</BonusPoints></Player></PlayerData></"
    "GameData>";

class MainWindow : public testing::Test {
 protected:
  /// Loads a game file with these contents through the menu.
  void Load(const std::string& contents) {
    WriteFile(venue.Folder / "game.xml", contents);
    venue.Dialog.Answers = {venue.Folder / "game.xml"};
    venue.Trigger("mnuLoadScores");
  }

  void ClickHeader(const char* list, int section) {
    QHeaderView& header = *venue.Find<QTableView>(list).horizontalHeader();
    const QPoint middle(header.sectionViewportPosition(section) + header.sectionSize(section) / 2,
                        header.height() / 2);
    QTest::mouseClick(header.viewport(), Qt::LeftButton, {}, middle);
  }

  Venue venue;
};

TEST_F(MainWindow, CopiesTheDefaultsAtTheFirstStartAndIsSilentAtTheSecond) {
  venue.Window = std::make_unique<frmRx>(::Services{venue.Strings, venue.Time, venue.Databases, venue.Events,
                                                    venue.Dialog, venue.Disk, venue.Places, venue.Boxes,
                                                    venue.Devices, venue.Port});
  venue.Window->FormLoad();
  std::vector<std::string> titles;
  for (const auto& box : venue.Boxes.Boxes) {
    titles.push_back(box.Title);
  }
  // The offscreen screen is smaller than recommended.
  EXPECT_THAT(titles, ElementsAre("Screen Resolution Warning", "Database status", "Database status",
                                  "Database status"));
  EXPECT_TRUE(venue.Disk.FileExists(venue.DataFile("tessarine.ini")));
  venue.Window.reset();
  venue.Boxes.Boxes.clear();
  frmRx again(::Services{venue.Strings, venue.Time, venue.Databases, venue.Events, venue.Dialog, venue.Disk,
                         venue.Places, venue.Boxes, venue.Devices, venue.Port});
  again.FormLoad();
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1u);
  EXPECT_EQ(venue.Boxes.Boxes[0],
            (FakeMessageBoxes::Box{"This program works best with a screen resolution of at least 1024 x 768.",
                                   "Screen Resolution Warning", BoxIcon::Exclamation, BoxButtons::Ok}));
}

TEST_F(MainWindow, StartsWithEmptyListsOnNone) {
  venue.Start();
  EXPECT_EQ(venue.Window->windowTitle(), QStringLiteral("Tessarine 3 by Orvalin"));
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  EXPECT_EQ(venue.RowCount("TeamScores"), 0);
  QComboBox& missions = venue.Find<QComboBox>("ActiveMission");
  EXPECT_EQ(missions.currentText(), QStringLiteral("None"));
  EXPECT_EQ(missions.itemText(1), QStringLiteral("Free For All"));
  EXPECT_GE(missions.count(), 10);
}

TEST_F(MainWindow, TakesItsCaptionsFromTheStringTable) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    Venue place(language);
    place.Start();
    const auto plain = [](QString text) { return text.remove(u'&').toStdString(); };
    const std::pair<const char*, int> items[] = {
        {"mnuLoadScores", 205},     {"mnuSaveScores", 206},    {"mnuClearScores", 207},
        {"mnuPrintScores", 208},    {"mnuAdminData", 209},     {"mnuExit", 210},
        {"mnuMissionResults", 212}, {"mnuSetupMissions", 213}, {"mnuCommPort", 215},
        {"mnuSoldieringCalc", 216}, {"mnuAbout", 218}};
    for (const auto& [name, number] : items) {
      EXPECT_EQ(plain(place.Find<QAction>(name).text()), place.Strings.Text(number)) << name;
    }
    const std::pair<const char*, int> menus[] = {
        {"mnuFile", 204}, {"mnuMissions", 211}, {"mnuSettings", 214}, {"mnuHelp", 217}};
    for (const auto& [name, number] : menus) {
      EXPECT_EQ(plain(place.Find<QMenu>(name).title()), place.Strings.Text(number)) << name;
    }
    EXPECT_EQ(place.Find<QLabel>("Label1").text().toStdString(), place.Strings.Text(203));
    EXPECT_EQ(place.Find<QLabel>("Label2").text().toStdString(), place.Strings.Text(201));
    EXPECT_EQ(place.Find<QLabel>("ActiveMissionLabel").text().toStdString(), place.Strings.Text(202));
    EXPECT_EQ(place.Find<QPushButton>("GetScores").text(), QStringLiteral("Get Score Data"));
    QAbstractItemModel& board = *place.Find<QTableView>("ScoreDisplay").model();
    for (int column = 0; column < 9; ++column) {
      EXPECT_EQ(board.headerData(column, Qt::Horizontal).toString().toStdString(),
                place.Strings.Text(103 + column));
    }
  }
}

TEST_F(MainWindow, KeepsTheLettersOfTheAltKeysInEnglish) {
  venue.Start();
  EXPECT_EQ(venue.Find<QMenu>("mnuFile").title(), QStringLiteral("&Games"));
  EXPECT_EQ(venue.Find<QAction>("mnuLoadScores").text(), QStringLiteral("&Load Game"));
  EXPECT_EQ(venue.Find<QAction>("mnuExit").text(), QStringLiteral("E&xit"));
}

TEST_F(MainWindow, DisablesWhatHasNoWindowYet) {
  venue.Start();
  for (const char* name : {"mnuCommitGame", "mnuPrintScores", "mnuAdminData", "mnuMissionResults",
                           "mnuSetupMissions", "mnuManageMembers", "mnuCheckButton", "mnuBoxConfig",
                           "mnuFirmwareUpdate", "mnuSoundRecorder", "mnuChargeiButton", "mnuRemoteManage"}) {
    EXPECT_FALSE(venue.Find<QAction>(name).isEnabled()) << name;
  }
  EXPECT_FALSE(venue.Find<QPushButton>("RemoteManageButton").isEnabled());
}

TEST_F(MainWindow, EndsItsStartWhenADatabaseIsDamaged) {
  venue.Start();
  venue.Window.reset();
  WriteFile(venue.DataFile("members.mdb"), std::string(5000, 'x'));
  EXPECT_EQ(NumberThrownBy([this] { venue.Start(); }), 3343);
  EXPECT_EQ(ReadFile(venue.DataFile("members.mdb")), std::string(5000, 'x'));
}

TEST_F(MainWindow, EndsItsStartAtAFactorThatIsNoNumber) {
  venue.Start();
  venue.Window.reset();
  WriteFile(venue.DataFile("tessarine.ini"), "[soldiering_calc]\nheals=many\n");
  EXPECT_EQ(NumberThrownBy([this] { venue.Start(); }), 13);
}

TEST_F(MainWindow, ShowsTheFirstLineOfTheMissionAsToolTip) {
  venue.Start();
  QLabel& label = venue.Find<QLabel>("ActiveMissionLabel");
  venue.Find<QComboBox>("ActiveMission").setCurrentIndex(2);
  EXPECT_EQ(label.toolTip(), QStringLiteral("The game for newcomers: two teams, no penalties."));
  venue.Find<QComboBox>("ActiveMission").setCurrentIndex(1);
  EXPECT_EQ(label.toolTip(), QString());
}

TEST_F(MainWindow, SaysWhenTheChosenMissionIsGone) {
  venue.Start();
  sqlite3* other = nullptr;
  sqlite3_open(venue.DataFile("scenarios.mdb").c_str(), &other);
  sqlite3_exec(other, "DELETE FROM Table1", nullptr, nullptr, nullptr);
  sqlite3_close(other);
  venue.Find<QComboBox>("ActiveMission").setCurrentIndex(3);
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1u);
  EXPECT_EQ(venue.Boxes.Boxes[0].Text, "Could not locate selected Mission in Mission Database");
}

TEST_F(MainWindow, LoadsAGameWithItsMission) {
  venue.Start();
  Load(SmallGame);
  EXPECT_EQ(venue.Find<QComboBox>("ActiveMission").currentText(), QStringLiteral("First Muster"));
  EXPECT_THAT(venue.Row("ScoreDisplay", 0),
              ElementsAre("1", "Blue  7", " 9", "Error", " 0", " 0", " 0", " 0", " 0"));
  EXPECT_THAT(venue.Row("TeamScores", 0), ElementsAre("1", "Blue", " 9"));
  EXPECT_EQ(venue.RowCount("TeamScores"), 3);
}

TEST_F(MainWindow, ClearsTheBoardBeforeABadFile) {
  venue.Start();
  Load(SmallGame);
  Load("<Other/>");
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  EXPECT_EQ(venue.RowCount("TeamScores"), 0);
  EXPECT_EQ(venue.Boxes.Boxes.back().Text, "Unable to open Game file.");
}

TEST_F(MainWindow, ReportsATextWhereANumberIsDueAndGoesOn) {
  venue.Start();
  Load("<GameData><PlayerData><Player><Index>x</Index></Player></PlayerData></GameData>");
  EXPECT_EQ(venue.Boxes.Boxes.back(),
            (FakeMessageBoxes::Box{"Run-time error '13': Type mismatch", "Tessarine", BoxIcon::Critical,
                                   BoxButtons::Ok}));
  Load(SmallGame);
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 2);
}

TEST_F(MainWindow, SavesWhatItLoads) {
  venue.Start();
  Load(SmallGame);
  venue.Dialog.Answers = {venue.Folder / "saved.xml"};
  venue.Trigger("mnuSaveScores");
  const std::string saved = ReadFile(venue.Folder / "saved.xml");
  EXPECT_NE(saved.find("<MissionName>First Muster</MissionName>"), std::string::npos);
  Load(saved);
  EXPECT_EQ(venue.Row("ScoreDisplay", 1)[1], "Red  0");
}

TEST_F(MainWindow, ClearsTheGameOnlyAfterOk) {
  venue.Start();
  Load(SmallGame);
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  venue.Trigger("mnuClearScores");
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 2);
  EXPECT_EQ(venue.Boxes.Boxes.back(),
            (FakeMessageBoxes::Box{"This will delete all Player Score. Are you sure?", "Confirm Clear",
                                   BoxIcon::Question, BoxButtons::OkCancel}));
  venue.Trigger("mnuClearScores");
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  EXPECT_EQ(venue.RowCount("TeamScores"), 0);
}

TEST_F(MainWindow, SortsByAClickOnAHeaderOfTheBoardOnly) {
  venue.Start();
  Load(SmallGame);
  ClickHeader("ScoreDisplay", 0);
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[0], "1");
  venue.Find<QComboBox>("ActiveMission").setCurrentIndex(0);  // ranks upward now
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[1], "Red  0");
  ClickHeader("ScoreDisplay", 2);
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[1], "Blue  7");
  ClickHeader("TeamScores", 2);
  EXPECT_EQ(venue.Row("TeamScores", 0)[1], "Blue");
}

TEST_F(MainWindow, PullsAGameByTheButton) {
  venue.Start();
  bool shown = false;
  venue.Port.OnOutput = [&](std::uint8_t byte) {
    if (byte == 0) {
      const auto* progress = venue.Window->findChild<UploadProgress*>();
      shown = progress != nullptr && progress->isVisible();
      venue.Port.Receive({1});
      venue.Port.Receive(FrameOfRed1());
    }
  };
  venue.Press("GetScores");
  EXPECT_TRUE(shown);
  EXPECT_EQ(venue.Window->findChild<UploadProgress*>(), nullptr);
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 1);
  EXPECT_EQ(venue.RowCount("TeamScores"), 3);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_FALSE(venue.Port.PortOpen());
}

TEST_F(MainWindow, ShowsThreeTeamsAfterADownloadWithoutScores) {
  venue.Start();
  venue.Port.OnOutput = [&](std::uint8_t byte) {
    if (byte == 0) {
      venue.Port.Receive({0});
    }
  };
  venue.Trigger("mnuGetKeshData");
  EXPECT_EQ(venue.Boxes.Boxes.back().Text, "Kesh has no score data.");
  EXPECT_EQ(venue.RowCount("TeamScores"), 3);
}

TEST_F(MainWindow, ClosesOnceTheJobThatWaitsHasUnwound) {
  venue.Start();
  bool ignored = false;
  venue.Events.At(std::chrono::milliseconds(700), [&] { ignored = !venue.Window->close(); });
  venue.Press("GetScores");
  EXPECT_TRUE(ignored);
  EXPECT_FALSE(venue.Window->isVisible());
  EXPECT_FALSE(venue.Port.PortOpen());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(MainWindow, EndsTheDownloadWhenItsProgressIsClosed) {
  venue.Start();
  venue.Events.At(std::chrono::milliseconds(700),
                  [&] { venue.Window->findChild<UploadProgress*>()->reject(); });
  venue.Press("GetScores");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_TRUE(venue.Window->isVisible());
}

TEST_F(MainWindow, TakesOtherCommandsInMidDownload) {
  venue.Start();
  venue.Events.At(std::chrono::milliseconds(300), [&] { Load(SmallGame); });
  venue.Events.At(std::chrono::milliseconds(600), [&] { venue.Press("GetScores"); });
  venue.Events.At(std::chrono::milliseconds(900), [&] { venue.Trigger("mnuClearScores"); });
  venue.Press("GetScores");
  EXPECT_FALSE(venue.Port.PortOpen());
  EXPECT_EQ(venue.Window->findChild<UploadProgress*>(), nullptr);
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
}

TEST_F(MainWindow, NamesItsListsForScreenReaders) {
  venue.Start();
  EXPECT_EQ(venue.Find<QTableView>("ScoreDisplay").accessibleName(), QStringLiteral("Player Rank"));
  EXPECT_EQ(venue.Find<QTableView>("TeamScores").accessibleName(), QStringLiteral("Team Rank"));
  EXPECT_EQ(venue.Find<QLabel>("ActiveMissionLabel").buddy(), &venue.Find<QComboBox>("ActiveMission"));
}

}  // namespace
