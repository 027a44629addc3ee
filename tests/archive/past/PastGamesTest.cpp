#include "archive/past/PastGames.h"

#include <gmock/gmock.h>

#include <QApplication>
#include <QClipboard>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QSpinBox>
#include <QTableView>
#include <filesystem>

#include "core/gamefile/GameFile.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/support/Controls.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/OpenSession.h"
#include "tests/support/TestDatabase.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

constexpr int Red0 = 1;
constexpr int Blue7 = 40;

class WindowOfPastGames : public testing::Test {
 protected:
  WindowOfPastGames() {
    std::filesystem::create_directories(venue.Folder / "program");
    WriteFile(venue.Folder / "program/games_default.mdb", MadeDatabase("games"));
    ExecuteSql(venue.MembersFile(),
               "INSERT INTO Members (ContactID, NickName) VALUES (5, 'Mole'), (6, 'Fox')");
    EXPECT_TRUE(venue.Open());
    venue.Time.Stamps["20/11/2026"] = "2026-11-20 00:00:00";
    venue.Time.Stamps["21/11/2026"] = "2026-11-21 00:00:00";
  }

  /// A game of Red 0, a guest, and of Blue 7.
  std::int64_t Keep(const std::string& played, const std::string& mission, int points, int member = 5) {
    Game game(venue.Strings);
    for (const int index : {Red0, Blue7}) {
      game.Players(index).Active = true;
      game.Players(index).PrimaryDamage = 10;
      game.Players(index).ShotCount = 4;
    }
    game.Players(Blue7).Soldiering = points;
    game.Players(Blue7).MemberIndex = member;
    game.TeamTotals(2) = points;
    game.GameDate = played;
    return access.Archive().Keep({.Game = game, .Mission = mission, .Played = played});
  }
  /// Three of November, one of October.
  void KeepFour() {
    Keep("2026-10-31 20:00:00", "None", 100);
    Keep("2026-11-20 20:00:00", "Flag", 200);
    Keep("2026-11-21 20:00:00", "Flag", 300, 6);
    Keep("2026-11-22 20:00:00", "None", 400);
    access.Close();
  }

  void Open(Language language = Language::English) {
    strings.emplace(language);
    window = std::make_unique<PastGames>(
        PastGames::Parts{.Archive = access,
                         .Time = venue.Time,
                         .Boxes = venue.Boxes,
                         .CommonDialog1 = dialog,
                         .Disk = venue.Disk,
                         .Strings = *strings,
                         .NameOf = access.Names(),
                         .MembersCalled =
                             [](const std::string& text) {
                               return text == "Mo" ? std::vector<std::int32_t>{5}
                                                   : std::vector<std::int32_t>{};
                             },
                         .BoardIsUnsaved = [this] { return unsaved; },
                         .Busy = [this] { return busy; },
                         .ShowCharts = [this](const PastGame& game) { charted.push_back(game.GameId); },
                         .Export = [this](const std::vector<std::int64_t>& games) { exported = games; },
                         .Import = imports ? std::function<void()>([this] { ++imported; }) : nullptr},
        nullptr);
    Show(*window);
  }

  template <typename Control>
  Control& Get(const char* name) const {
    return Find<Control>(*window, name);
  }
  QTableView& Games() const { return Get<QTableView>("GameTable"); }
  QTableView& Months() const { return Get<QTableView>("MonthTable"); }
  std::vector<std::string> Column(const char* table, int column) const {
    std::vector<std::string> cells;
    const QAbstractItemModel& model = *Get<QTableView>(table).model();
    for (int row = 0; row < model.rowCount(); ++row) {
      cells.push_back(model.index(row, column).data().toString().toStdString());
    }
    return cells;
  }
  /// The best players' points tell the games apart.
  std::vector<std::string> Listed() const { return Column("GameTable", PastGameModel::FirstTeam + 1); }
  std::vector<std::string> Board() const { return Column("BoardTable", 1); }
  std::string Status() const { return Get<QLabel>("Status").text().toStdString(); }
  bool Enabled(const char* button) const { return Get<QPushButton>(button).isEnabled(); }
  void Press(const char* button) const { ::Press(*window, button); }

  void Lock(const std::function<void()>& action) {
    access.Close();
    OtherConnection other(ArchivePath());
    other.Execute("BEGIN EXCLUSIVE");
    action();
    other.Execute("ROLLBACK");
  }
  std::string ArchivePath() const { return venue.Folder / "games.mdb"; }
  std::string Query(const std::string& sql) const { return OtherConnection(ArchivePath()).Query(sql); }

  OpenSession venue;
  ArchiveAccess access{{.Session = venue.session,
                        .Disk = venue.Disk,
                        .Engine = venue.Databases,
                        .Strings = venue.Strings,
                        .UserDataFolder = venue.Folder.Path(),
                        .ProgramFolder = venue.Folder / "program"}};
  FakeFileDialog dialog;
  std::optional<StringTable> strings;
  bool unsaved = false;
  std::optional<OwnText> busy;
  bool imports = true;
  int imported = 0;
  std::vector<std::int64_t> charted;
  std::vector<std::int64_t> exported;
  std::unique_ptr<PastGames> window;
};

TEST_F(WindowOfPastGames, BeginsWithTheLatestMonthAndItsLatestGame) {
  KeepFour();
  Open();
  EXPECT_THAT(Column("MonthTable", 0), ElementsAre("All games", "2026-11", "2026-10", "Deleted"));
  EXPECT_THAT(Column("MonthTable", 1), ElementsAre("4", "3", "1", ""));
  EXPECT_EQ(Months().currentIndex().row(), 1);
  EXPECT_THAT(Listed(), ElementsAre("400", "300", "200"));
  EXPECT_EQ(Games().currentIndex().row(), 0);
  EXPECT_THAT(Board(), ElementsAre("Blue  7: Mole", "Red  0"));
  EXPECT_THAT(Get<QLabel>("BoardLabel").text().toStdString(), HasSubstr(", None"));
  EXPECT_EQ(window->focusWidget(), &Games());
  EXPECT_EQ(Status(), "");
}

TEST_F(WindowOfPastGames, SaysSoWithoutAnyGameAndMakesNoArchive) {
  Open();
  EXPECT_EQ(Status(), venue.Strings.Text(OwnText::PastNone));
  for (const char* button : {"Open", "SaveFile", "Charts", "Export", "Delete"}) {
    EXPECT_FALSE(Enabled(button)) << button;
  }
  EXPECT_FALSE(std::filesystem::exists(ArchivePath()));
}

TEST_F(WindowOfPastGames, ShowsTheBoardOfTheGameThatTheArrowKeysReach) {
  KeepFour();
  Open();
  Type(*window, Qt::Key_Down);
  EXPECT_THAT(Board(), ElementsAre("Blue  7: Fox", "Red  0"));
  Type(*window, Qt::Key_Down);
  EXPECT_THAT(Board(), ElementsAre("Blue  7: Mole", "Red  0"));
}

TEST_F(WindowOfPastGames, ListsTheMonthThatIsChosen) {
  KeepFour();
  Open();
  Months().selectRow(2);
  EXPECT_THAT(Listed(), ElementsAre("100"));
  Months().selectRow(0);
  EXPECT_THAT(Listed(), ElementsAre("400", "300", "200", "100"));
}

TEST_F(WindowOfPastGames, FindsGamesByMissionMemberGunAndPeriod) {
  KeepFour();
  Open();
  auto& mission = Get<QComboBox>("SearchMission");
  mission.setCurrentIndex(mission.findText(QStringLiteral("Flag")));
  Press("Search");
  EXPECT_EQ(Months().currentIndex().row(), 0);
  EXPECT_THAT(Listed(), ElementsAre("300", "200"));
  Get<QLineEdit>("SearchMember").setText(QStringLiteral("Mo"));
  Press("Search");
  EXPECT_THAT(Listed(), ElementsAre("200"));
  Press("ShowAll");
  EXPECT_EQ(Get<QLineEdit>("SearchMember").text(), QString());
  EXPECT_THAT(Listed(), ElementsAre("400", "300", "200", "100"));
  Get<QLineEdit>("SearchFrom").setText(QStringLiteral("20/11/2026"));
  Get<QLineEdit>("SearchUntil").setText(QStringLiteral("21/11/2026"));
  QTest::keyClick(&Get<QLineEdit>("SearchUntil"), Qt::Key_Return);
  EXPECT_THAT(Listed(), ElementsAre("300", "200"));
  Press("ShowAll");
  Get<QComboBox>("SearchTeam").setCurrentIndex(2);
  Get<QSpinBox>("SearchNumber").setValue(7);
  Press("Search");
  EXPECT_EQ(Listed().size(), 4U);
  Get<QSpinBox>("SearchNumber").setValue(8);
  Press("Search");
  EXPECT_THAT(Listed(), IsEmpty());
  EXPECT_EQ(Status(), venue.Strings.Text(OwnText::PastNothingFound));
  EXPECT_THAT(Board(), IsEmpty());
}

TEST_F(WindowOfPastGames, SearchesOneMonthIfThatIsChosenAfterwards) {
  KeepFour();
  Open();
  Get<QLineEdit>("SearchMember").setText(QStringLiteral("Mo"));
  Press("Search");
  EXPECT_THAT(Listed(), ElementsAre("400", "200", "100"));
  Months().selectRow(1);
  EXPECT_THAT(Listed(), ElementsAre("400", "200"));
}

TEST_F(WindowOfPastGames, TellsOfEntriesThatMakeNoSense) {
  KeepFour();
  Open();
  Get<QLineEdit>("SearchFrom").setText(QStringLiteral("soon"));
  Press("Search");
  EXPECT_EQ(Status(), "soon is no date. Write it like " + venue.Time.ShortDate() + ".");
  EXPECT_EQ(window->focusWidget(), &Get<QLineEdit>("SearchFrom"));
  Get<QLineEdit>("SearchFrom").clear();
  Get<QLineEdit>("SearchMember").setText(QStringLiteral("Zed"));
  Press("Search");
  EXPECT_EQ(Status(), "No member has a name that begins with Zed.");
  EXPECT_EQ(Listed().size(), 3U);
}

TEST_F(WindowOfPastGames, HasGunsOfATeamOnly) {
  Open();
  EXPECT_FALSE(Get<QSpinBox>("SearchNumber").isEnabled());
  Get<QComboBox>("SearchTeam").setCurrentIndex(3);
  EXPECT_TRUE(Get<QSpinBox>("SearchNumber").isEnabled());
  EXPECT_EQ(Get<QSpinBox>("SearchNumber").maximum(), 31);
  Get<QComboBox>("SearchTeam").setCurrentIndex(1);
  EXPECT_EQ(Get<QSpinBox>("SearchNumber").maximum(), 95);
}

TEST_F(WindowOfPastGames, GivesTheGameToOpen) {
  KeepFour();
  Open();
  Games().selectRow(1);
  Press("Open");
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(window->result(), QDialog::Accepted);
  ASSERT_TRUE(window->Chosen());
  EXPECT_EQ(window->Chosen()->GameId, 3);
  EXPECT_EQ(window->Chosen()->State, 0);
  EXPECT_EQ(window->Chosen()->Bytes, access.Archive().FileOf(3));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(WindowOfPastGames, OpensByReturn) {
  KeepFour();
  Open();
  Type(*window, Qt::Key_Return);
  ASSERT_TRUE(window->Chosen());
  EXPECT_EQ(window->Chosen()->GameId, 4);
}

TEST_F(WindowOfPastGames, AsksBeforeAnUnsavedGameIsReplaced) {
  KeepFour();
  Open();
  unsaved = true;
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  Press("Open");
  EXPECT_TRUE(window->isVisible());
  EXPECT_FALSE(window->Chosen());
  const std::string game = Get<QLabel>("BoardLabel").text().toStdString();
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{
                  "The game on the board is not saved as a file. Replace it with the game of " + game + "?",
                  DefaultBoxTitle, BoxIcon::Question, BoxButtons::OkCancel}));
  venue.Boxes.Answers = {BoxAnswer::Ok};
  Press("Open");
  EXPECT_TRUE(window->Chosen());
}

TEST_F(WindowOfPastGames, OpensNothingWhileSomethingElseRuns) {
  KeepFour();
  Open();
  busy = OwnText::ScoresComeIn;
  Press("Open");
  EXPECT_FALSE(window->Chosen());
  EXPECT_EQ(Status(), "Not now: scores are being downloaded. Open the game when it has ended.");
}

TEST_F(WindowOfPastGames, ShowsAndOpensEarlierStates) {
  KeepFour();
  Game later(venue.Strings);
  later.Players(Red0).Active = true;
  later.Players(Red0).Soldiering = 7;
  access.Archive().KeepAgain(4, {.Game = later, .Mission = "None"}, FormerState::KeptToo);
  access.Close();
  Open();
  auto& state = Get<QComboBox>("State");
  EXPECT_TRUE(state.isVisible());
  EXPECT_EQ(state.count(), 2);
  EXPECT_THAT(Board(), ElementsAre("Red  0"));
  state.setCurrentIndex(1);
  EXPECT_THAT(Board(), ElementsAre("Blue  7: Mole", "Red  0"));
  Press("Open");
  ASSERT_TRUE(window->Chosen());
  EXPECT_EQ(window->Chosen()->State, 1);
  EXPECT_EQ(window->Chosen()->Bytes, access.Archive().FileOf(4, 1));
}

TEST_F(WindowOfPastGames, HidesTheStatesOfAGameThatHasOnlyOne) {
  KeepFour();
  Open();
  EXPECT_FALSE(Get<QComboBox>("State").isVisible());
  EXPECT_FALSE(Get<QLabel>("StateLabel").isVisible());
}

TEST_F(WindowOfPastGames, SavesAGameFile) {
  KeepFour();
  Open();
  const std::string path = venue.Folder / "mine.game.xml";
  dialog.Answers = {std::nullopt, path};
  Press("SaveFile");
  EXPECT_EQ(Status(), "");
  Press("SaveFile");
  EXPECT_EQ(ReadFile(path), access.Archive().FileOf(4));
  EXPECT_EQ(dialog.Calls.back().Name, "2026-11-22 2000 None.game.xml");
  EXPECT_TRUE(dialog.Calls.back().Save);
  EXPECT_EQ(Status(), "Saved: " + path);
}

TEST_F(WindowOfPastGames, AsksBeforeAFileIsReplaced) {
  KeepFour();
  Open();
  const std::string path = venue.Folder / "mine.game.xml";
  WriteFile(path, "old");
  dialog.Answers = {path, path};
  venue.Boxes.Answers = {BoxAnswer::No, BoxAnswer::Yes};
  Press("SaveFile");
  EXPECT_EQ(ReadFile(path), "old");
  Press("SaveFile");
  EXPECT_EQ(ReadFile(path), access.Archive().FileOf(4));
  EXPECT_EQ(venue.Boxes.Boxes.size(), 2U);
}

TEST_F(WindowOfPastGames, TellsAFileThatCannotBeWrittenInItsLine) {
  KeepFour();
  Open();
  dialog.Answers = {venue.Folder / "nowhere/mine.game.xml"};
  Press("SaveFile");
  EXPECT_THAT(Status(), HasSubstr("That did not work: "));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(WindowOfPastGames, HandsGamesToChartsAndExports) {
  KeepFour();
  Open();
  Press("Charts");
  EXPECT_THAT(charted, ElementsAre(4));
  Games().selectAll();
  Press("Export");
  EXPECT_THAT(exported, ElementsAre(4, 3, 2));
}

TEST_F(WindowOfPastGames, LooksAnewAfterAnImport) {
  Open();
  EXPECT_TRUE(Get<QPushButton>("Import").isVisible());
  Keep("2026-11-22 20:00:00", "None", 400);
  Press("Import");
  EXPECT_EQ(imported, 1);
  EXPECT_THAT(Listed(), ElementsAre("400"));
  imports = false;
  Open();
  EXPECT_FALSE(Get<QPushButton>("Import").isVisible());
}

TEST_F(WindowOfPastGames, DeletesAGameAfterAQuestion) {
  KeepFour();
  Open();
  Games().selectRow(1);
  venue.Boxes.Answers = {BoxAnswer::Cancel, BoxAnswer::Ok};
  Press("Delete");
  EXPECT_EQ(Listed().size(), 3U);
  Games().setFocus();
  Type(*window, Qt::Key_Delete);
  EXPECT_THAT(Listed(), ElementsAre("400", "200"));
  EXPECT_EQ(Games().currentIndex().row(), 1);
  EXPECT_EQ(window->focusWidget(), &Games());
  EXPECT_EQ(Status(), "Deleted games: 1");
  EXPECT_THAT(Column("MonthTable", 1), ElementsAre("3", "2", "1", ""));
  EXPECT_EQ(venue.Boxes.Boxes.front().Text,
            "Delete the game of " + PastGameModel::TimeText("2026-11-21 20:00:00").toStdString() +
                "? For 30 days it can be brought back: choose Deleted among the months.");
  EXPECT_EQ(Query("SELECT Deleted FROM Games WHERE GameID = 3"), venue.Time.Now());
}

TEST_F(WindowOfPastGames, BringsDeletedGamesBack) {
  KeepFour();
  Open();
  Games().selectAll();
  Press("Delete");
  EXPECT_EQ(venue.Boxes.Boxes.front().Text,
            "Delete 3 games? For 30 days they can be brought back: choose Deleted among the months.");
  EXPECT_THAT(Column("MonthTable", 0), ElementsAre("All games", "2026-10", "Deleted"));
  Months().selectRow(2);
  EXPECT_THAT(Listed(), ElementsAre("400", "300", "200"));
  EXPECT_THAT(Board(), ElementsAre("Blue  7: Mole", "Red  0"));
  EXPECT_FALSE(Enabled("Open"));
  EXPECT_FALSE(Enabled("Export"));
  EXPECT_FALSE(Get<QPushButton>("Delete").isVisible());
  EXPECT_TRUE(Enabled("SaveFile"));
  Type(*window, Qt::Key_Return);
  EXPECT_FALSE(window->Chosen());
  Games().selectRow(0);
  Press("BringBack");
  EXPECT_THAT(Listed(), ElementsAre("300", "200"));
  EXPECT_EQ(Status(), "Games brought back: 1");
  Games().selectAll();
  Press("BringBack");
  EXPECT_THAT(Listed(), IsEmpty());
  Months().selectRow(1);
  EXPECT_THAT(Listed(), ElementsAre("400", "300", "200"));
  EXPECT_EQ(Status(), "");
}

TEST_F(WindowOfPastGames, TellsInItsLineWhatCannotBeReadAndTriesAgain) {
  KeepFour();
  Lock([this] { Open(); });
  EXPECT_THAT(Status(), HasSubstr("That did not work: "));
  EXPECT_THAT(Listed(), IsEmpty());
  Press("Search");
  EXPECT_EQ(Listed().size(), 4U);
  EXPECT_EQ(Status(), "");
  EXPECT_EQ(Get<QComboBox>("SearchMission").count(), 3);
  Lock([this] { Games().selectRow(2); });
  EXPECT_THAT(Status(), HasSubstr("That did not work: "));
  EXPECT_THAT(Board(), IsEmpty());
  EXPECT_FALSE(Enabled("Open"));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(WindowOfPastGames, TellsARowThatCannotBeReadInItsLine) {
  KeepFour();
  Open();
  OtherConnection(ArchivePath()).Execute("ALTER TABLE GameFiles RENAME TO Elsewhere");
  Months().selectRow(2);
  QTest::qWait(0);
  EXPECT_THAT(Status(), HasSubstr("That did not work: "));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(WindowOfPastGames, TellsAGameWhoseFileIsDamaged) {
  KeepFour();
  OtherConnection(ArchivePath()).Execute("UPDATE sqlar SET data = x'00'");
  Open();
  EXPECT_EQ(Listed().size(), 3U);
  EXPECT_THAT(Board(), IsEmpty());
  EXPECT_THAT(Status(), HasSubstr("2026-11-22/2000-000004.game.xml"));
  EXPECT_FALSE(Enabled("Open"));
  EXPECT_TRUE(Enabled("Delete"));
}

TEST_F(WindowOfPastGames, TellsOfAnArchiveThatCannotBeUsed) {
  WriteFile(ArchivePath(), "no database");
  Open();
  EXPECT_EQ(Status(), venue.Strings.Text(OwnText::PastNone));
  WriteFile(venue.Folder / "games-new.mdb", MadeDatabase("games"));
  Keep("2026-11-22 20:00:00", "None", 400);
  access.Close();
  Open();
  EXPECT_EQ(Listed().size(), 1U);
  EXPECT_THAT(Status(), HasSubstr(ArchivePath()));
}

TEST_F(WindowOfPastGames, CopiesItsListsAsText) {
  KeepFour();
  Open();
  Games().setFocus();
  QTest::keyClick(&Games(), Qt::Key_C, Qt::ControlModifier);
  const QString text = QApplication::clipboard()->text();
  EXPECT_TRUE(text.startsWith(QStringLiteral("Time\tMission\tPlayers\tRed\t")));
  EXPECT_TRUE(text.contains(QStringLiteral("Mole, 400")));
  auto& board = Get<QTableView>("BoardTable");
  board.setFocus();
  QTest::keyClick(&board, Qt::Key_C, Qt::ControlModifier);
  EXPECT_TRUE(QApplication::clipboard()->text().contains(QStringLiteral("Blue  7: Mole\t 400")));
}

TEST_F(WindowOfPastGames, ClosesByEscape) {
  KeepFour();
  Open();
  Type(*window, Qt::Key_Escape);
  EXPECT_FALSE(window->isVisible());
  EXPECT_FALSE(window->Chosen());
}

TEST_F(WindowOfPastGames, NamesItsControlsInBothLanguages) {
  KeepFour();
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    Open(language);
    EXPECT_EQ(window->windowTitle().toStdString(), strings->Text(OwnText::PastGamesTitle));
    EXPECT_EQ(Get<QPushButton>("Open").text().toStdString(), strings->Text(OwnText::PastOpen));
    for (const char* name : {"SearchFrom", "SearchUntil", "SearchMission", "SearchMember", "SearchTeam",
                             "MonthTable", "GameTable", "State", "BoardTable"}) {
      const auto labels = window->findChildren<QLabel*>();
      EXPECT_TRUE(std::any_of(labels.begin(), labels.end(), [name](const QLabel* label) {
        return label->buddy() != nullptr && label->buddy()->objectName() == QLatin1String(name) &&
               !label->text().isEmpty();
      })) << name;
    }
    EXPECT_FALSE(Get<QSpinBox>("SearchNumber").accessibleName().isEmpty());
  }
}

}  // namespace
