#include <gmock/gmock.h>

#include <QProgressBar>

#include "core/gamefile/GameFile.h"
#include "tests/archive/past/PastGamesVenue.h"
#include "tests/support/RandomGame.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

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

TEST_F(WindowOfPastGames, FindsMissionsThatAnImportBrought) {
  KeepFour();
  Open();
  auto& missions = Get<QComboBox>("SearchMission");
  missions.setCurrentIndex(missions.findText(QStringLiteral("None")));
  Keep("2026-11-23 20:00:00", "Hill", 500);
  Keep("2026-11-23 21:00:00", "Tower", 600);
  Press("Import");
  std::vector<std::string> offered;
  for (int entry = 1; entry < missions.count(); ++entry) {
    offered.push_back(missions.itemText(entry).toStdString());
  }
  EXPECT_THAT(offered, ElementsAre("Flag", "Hill", "None", "Tower"));
  EXPECT_EQ(missions.currentText(), QStringLiteral("None"));
  missions.setCurrentIndex(missions.findText(QStringLiteral("Hill")));
  Press("Search");
  EXPECT_THAT(Listed(), ElementsAre("500"));
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

TEST_F(WindowOfPastGames, LeavesADeletedGameThatIsThereAgain) {
  const std::int64_t first = Keep("2026-11-20 20:00:00", "Flag", 200);
  Keep("2026-11-21 20:00:00", "Flag", 300);
  access.Archive().Delete({first}, "2026-11-22 10:00:00");
  Keep("2026-11-20 20:00:00", "Flag", 200, 6);  // of the same file, with another member
  access.Archive().Delete({2}, "2026-11-22 10:00:00");
  access.Close();
  Open();
  Months().selectRow(2);
  EXPECT_EQ(Listed().size(), 2U);
  Games().selectAll();
  Press("BringBack");
  EXPECT_THAT(Listed(), ElementsAre("200"));
  EXPECT_EQ(Status(),
            "Games brought back: 1. Left among the deleted ones, since past games have them already: 1");
  EXPECT_EQ(Query("SELECT group_concat(GameID) FROM (SELECT GameID FROM Games WHERE Deleted IS NULL ORDER BY "
                  "GameID)"),
            "2,3");
}

TEST_F(WindowOfPastGames, NeitherDeletesNorBringsBackWhileTheDiskIsNarrow) {
  KeepFour();
  Open();
  disk.Space = LeastFreeSpace - 1;
  Games().selectRow(1);
  Press("Delete");
  EXPECT_THAT(Status(), testing::HasSubstr("32 MB"));
  EXPECT_EQ(Query("SELECT count(*) FROM Games WHERE Deleted IS NULL"), "4");
  disk.Space = LeastFreeSpace;
  Press("Delete");
  disk.Space = LeastFreeSpace - 1;
  Months().selectRow(Months().model()->rowCount() - 1);
  Games().selectRow(0);
  Press("BringBack");
  EXPECT_THAT(Status(), testing::HasSubstr("32 MB"));
  EXPECT_EQ(Query("SELECT count(*) FROM Games WHERE Deleted IS NULL"), "3");
}

TEST_F(WindowOfPastGames, BringsGamesWithLargeFilesBackInShortSteps) {
  constexpr int many = 90;
  Game game(venue.Strings);
  FillRandomly(game, 40, 7);
  std::vector<std::int64_t> games;
  for (int i = 10; i < 10 + many; ++i) {
    const std::string played =
        "2026-11-20 2" + std::to_string(i / 50) + ":" + std::to_string(10 + i % 50) + ":00";
    game.GameDate = played;
    games.push_back(access.Archive().Keep({.Game = game, .Mission = "None", .Played = played}));
  }
  Keep("2026-11-22 20:00:00", "None", 400);
  access.Archive().Delete(games, "2026-11-22 10:00:00");
  access.Close();
  Open();
  Months().selectRow(Months().model()->rowCount() - 1);
  Games().selectAll();
  events.At(std::chrono::milliseconds(0), [this] { Press("Stop"); });
  Press("BringBack");
  const auto back = [this] {
    return std::stoi(Query("SELECT count(*) FROM Games WHERE Deleted IS NULL")) - 1;
  };
  EXPECT_GT(back(), 0);
  EXPECT_LT(back(), many / 2);
  EXPECT_EQ(static_cast<int>(Listed().size()), many - back());
  EXPECT_FALSE(Get<QPushButton>("Stop").isVisible());
  Games().selectAll();
  Press("BringBack");
  EXPECT_EQ(back(), many);
}

class ManyPastGames : public WindowOfPastGames {
 protected:
  static constexpr int Many = 20'000;

  ManyPastGames() {
    Keep("2026-11-22 20:00:00", "None", 400);
    access.Close();
    ExecuteSql(ArchivePath(),
               "WITH RECURSIVE n(i) AS (SELECT 2 UNION ALL SELECT i + 1 FROM n WHERE i < 20000) INSERT INTO "
               "Games SELECT i, '2026-10-01 00:00:00', '', 'None', 'cable', 1, 2, 0, 0, 0, 0, 1, 1, 1, 1, 1, "
               "1, 1, '', NULL FROM n");
    Open();
    Months().selectRow(0);
    Games().setFocus();
    Games().selectAll();
  }

  /// In the middle of the next long run.
  void Meanwhile(std::function<void()> act) {
    events.At(std::chrono::milliseconds(0), [this, act = std::move(act)] {
      EXPECT_TRUE(Get<QProgressBar>("Progress").isVisible());
      EXPECT_FALSE(Games().isEnabled());
      EXPECT_FALSE(Enabled("Close"));
      act();
    });
  }
  void ExpectReady() const {
    EXPECT_FALSE(Get<QPushButton>("Stop").isVisible());
    EXPECT_FALSE(Get<QProgressBar>("Progress").isVisible());
    EXPECT_TRUE(Games().isEnabled());
    EXPECT_EQ(window->focusWidget(), &Games());
  }
  std::string Deleted() const { return Query("SELECT count(*) FROM Games WHERE Deleted IS NOT NULL"); }
};

TEST_F(ManyPastGames, AreCopiedWithProgress) {
  Type(*window, Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(QGuiApplication::clipboard()->text().count(u'\n'), Many + 1);
  EXPECT_EQ(Status(), "Rows copied: 20000");
  ExpectReady();
}

TEST_F(ManyPastGames, AreNotCopiedWhenTheOperatorStops) {
  QGuiApplication::clipboard()->setText(QStringLiteral("mine"));
  Meanwhile([this] { Press("Stop"); });
  Type(*window, Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(QGuiApplication::clipboard()->text(), QStringLiteral("mine"));
  EXPECT_EQ(Status(), "Stopped. Nothing was copied.");
  ExpectReady();
}

TEST_F(ManyPastGames, AreDeletedAndBroughtBackAllTogether) {
  Press("Delete");
  EXPECT_EQ(Deleted(), std::to_string(Many));
  EXPECT_EQ(Status(), "Deleted games: 20000");
  ExpectReady();
  Months().selectRow(1);
  Games().selectAll();
  Press("BringBack");
  EXPECT_EQ(Deleted(), "0");
  EXPECT_EQ(Status(), "Games brought back: 20000");
}

TEST_F(ManyPastGames, AreDeletedOnlyAsFarAsTheOperatorLets) {
  Meanwhile([this] { Press("Stop"); });
  Press("Delete");
  const int deleted = std::stoi(Deleted());
  EXPECT_GT(deleted, 0);
  EXPECT_LT(deleted, Many);
  EXPECT_EQ(Status(),
            "Stopped. Games deleted until then: " + std::to_string(deleted) + ". They stand under Deleted.");
  EXPECT_EQ(static_cast<int>(Listed().size()), Many - deleted);
  ExpectReady();
}

TEST_F(ManyPastGames, CloseInTheMiddleOfARun) {
  Meanwhile([this] { window->close(); });
  Press("Delete");
  EXPECT_FALSE(window->isVisible());
  EXPECT_LT(std::stoi(Deleted()), Many);
}

}  // namespace
