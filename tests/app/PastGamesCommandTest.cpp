#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>
#include <QRadioButton>
#include <nlohmann/json.hpp>

#include "archive/past/PastGames.h"
#include "audience/GuestNameEntry.h"
#include "charts/GameCharts.h"
#include "charts/ScoreChart.h"
#include "exports/ExportGames.h"
#include "tests/support/Frames.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// Games, Past Games on real databases and files.
class PastGamesCommand : public testing::Test {
 protected:
  PastGamesCommand() : venue(Language::English, Waits::Real) {
    venue.PutDefaultFiles();
    venue.ChangeDatabase("members.mdb",
                         "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES "
                         "(5, 'Bo', 'Ray', 'Mole')");
    venue.Start();
  }

  void Clear() {
    venue.Boxes.Answers = {BoxAnswer::Ok};
    venue.Trigger("mnuClearScores");
  }
  void PutGame() {
    venue.LoadGame(GameFile(PlayerOf(1, "<BonusPoints>5</BonusPoints>") +
                                PlayerOf(40, "<BonusPoints>9</BonusPoints><MemberIndex>5</MemberIndex>"),
                            "First Muster"));
  }
  /// Opens the window of past games for `act`, which must close it.
  void Look(const std::function<void(PastGames&)>& act) {
    const WhileModal<PastGames> look(act);
    venue.Trigger("mnuPastGames");
    EXPECT_EQ(look.Runs(), 1);
  }
  void OpenLatest() {
    Look([](PastGames& window) { ::Press(window, "Open"); });
  }
  /// Of the latest game, the best player first.
  std::vector<std::string> NamesInCharts() {
    std::vector<std::string> names;
    Look([&names](PastGames& window) {
      const WhileModal<GameCharts> charts([&names](GameCharts& shown) {
        for (const PlayerParts& player : Find<ScoreChart>(shown, "Bars").Players()) {
          names.push_back(player.Player.Name);
        }
        shown.close();
      });
      ::Press(window, "Charts");
      EXPECT_EQ(charts.Runs(), 1);
      window.close();
    });
    return names;
  }
  std::string Query(const std::string& sql) const { return venue.QueryDatabase("games.mdb", sql); }

  Venue venue;
};

TEST_F(PastGamesCommand, HasAShortcut) {
  EXPECT_EQ(venue.Find<QAction>("mnuPastGames").shortcut(), QKeySequence(Qt::CTRL | Qt::Key_H));
}

TEST_F(PastGamesCommand, PutsAGameBackOnTheBoardWithoutKeepingItTwice) {
  PutGame();
  const std::vector<std::string> before = venue.Column("ScoreDisplay", 1);
  const std::vector<std::string> scores = venue.Column("ScoreDisplay", 2);
  Clear();
  venue.Boxes.Boxes.clear();
  OpenLatest();
  EXPECT_EQ(venue.Column("ScoreDisplay", 1), before);
  EXPECT_EQ(venue.Column("ScoreDisplay", 2), scores);
  EXPECT_EQ(venue.ActiveMission().currentText(), QStringLiteral("First Muster"));
  EXPECT_EQ(Query("SELECT count(*) FROM Games"), "1");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(PastGamesCommand, LeavesTheBoardAloneUntilAGameIsOpened) {
  PutGame();
  const std::vector<std::string> before = venue.Column("ScoreDisplay", 1);
  Look([](PastGames& window) {
    EXPECT_EQ(Find<QTableView>(window, "BoardTable").model()->index(0, 1).data().toString(),
              QStringLiteral("Blue  7: Mole"));
    window.close();
  });
  EXPECT_EQ(venue.Column("ScoreDisplay", 1), before);
}

TEST_F(PastGamesCommand, KeepsAChangeOfAnEarlierStateBesideTheLastOne) {
  venue.Port.OnOutput = [this](std::uint8_t byte) {
    if (byte == 1) {
      venue.Port.Receive({1});
      venue.Port.Receive(FrameOfRed1());
    }
  };
  venue.Press("GetScores");
  venue.Press("GetScores");
  EXPECT_EQ(Query("SELECT count(*) FROM sqlar"), "2");
  Clear();
  Look([](PastGames& window) {
    Find<QComboBox>(window, "State").setCurrentIndex(1);
    ::Press(window, "Open");
  });
  EXPECT_EQ(Query("SELECT count(*) FROM sqlar"), "2");
  auto& missions = venue.Find<QComboBox>("ActiveMission");
  QTest::keyClick(&missions, Qt::Key_Down);
  EXPECT_EQ(Query("SELECT count(*) FROM Games"), "1");
  EXPECT_EQ(Query("SELECT count(*) FROM sqlar"), "3");
}

TEST_F(PastGamesCommand, DoesNotOfferTheFileUsedLastForTheGame) {
  PutGame();
  Clear();
  OpenLatest();
  const std::string before = ReadFile(venue.Folder / "game.xml");
  venue.Dialog.Answers = {std::nullopt};
  venue.Trigger("mnuSaveScores");
  EXPECT_THAT(venue.Dialog.Calls.back().Name, testing::EndsWith(" First Muster.game.xml"));
  EXPECT_EQ(ReadFile(venue.Folder / "game.xml"), before);
}

TEST_F(PastGamesCommand, ShowsChartsThatAddUpToTheScores) {
  PutGame();
  Look([](PastGames& window) {
    const WhileModal<GameCharts> charts([](GameCharts& shown) {
      const auto& players = Find<ScoreChart>(shown, "Bars").Players();
      ASSERT_EQ(players.size(), 2U);
      for (const PlayerParts& player : players) {
        EXPECT_EQ(player.Of(ScorePart::Other), 0) << player.Player.Name;
      }
      EXPECT_EQ(players.front().Player.Name, "Blue  7 (Mole)");
      shown.close();
    });
    ::Press(window, "Charts");
    EXPECT_EQ(charts.Runs(), 1);
    window.close();
  });
}

TEST_F(PastGamesCommand, ChartsGuestsByTheirNamesAndLeavesOutHiddenOnes) {
  PutGame();
  const WhileModal<GuestNameEntry> entry([](GuestNameEntry& window) {
    Find<QLineEdit>(window, "Guest1").setText(QStringLiteral("Ann"));
    ::Press(window, "SaveExit");
  });
  venue.Trigger("mnuGuestNames");
  EXPECT_EQ(entry.Runs(), 1);
  EXPECT_THAT(NamesInCharts(), ElementsAre("Blue  7 (Mole)", "Red  0 (Ann)"));
  venue.Find<QTableView>("ScoreDisplay").selectRow(0);
  venue.Boxes.Answers = {BoxAnswer::Ok};
  venue.Trigger("mnuHidePlayer");
  EXPECT_THAT(NamesInCharts(), ElementsAre("Blue  7", "Red  0 (Ann)"));
}

TEST_F(PastGamesCommand, ExportsTheChosenGames) {
  PutGame();
  Clear();
  venue.LoadGame(GameFile(PlayerOf(2, "<BonusPoints>5</BonusPoints>"), "None"));
  const std::string path = venue.Folder / "games.json";
  Look([&](PastGames& window) {
    const WhileModal<ExportGames> act([&](ExportGames& exports) {
      Find<QRadioButton>(exports, "FormatJson").click();
      venue.Dialog.Answers = {path};
      ::Press(exports, "ExportButton");
      exports.close();
    });
    Find<QTableView>(window, "MonthTable").selectRow(0);
    Find<QTableView>(window, "GameTable").selectAll();
    ::Press(window, "Export");
    EXPECT_EQ(act.Runs(), 1);
    window.close();
  });
  const auto games = nlohmann::ordered_json::parse(ReadFile(path)).at("games");
  ASSERT_EQ(games.size(), 2U);
  EXPECT_THAT((std::vector<std::string>{games.at(0).at("mission"), games.at(1).at("mission")}),
              testing::UnorderedElementsAre("First Muster", "None"));
}

TEST_F(PastGamesCommand, FindsMembersByTheBeginningOfTheirNames) {
  PutGame();
  Look([](PastGames& window) {
    Find<QLineEdit>(window, "SearchMember").setText(QStringLiteral("ra"));
    ::Press(window, "Search");
    EXPECT_EQ(Find<QTableView>(window, "GameTable").model()->rowCount(), 1);
    Find<QLineEdit>(window, "SearchMember").setText(QStringLiteral("zed"));
    ::Press(window, "Search");
    EXPECT_FALSE(Find<QLabel>(window, "Status").text().isEmpty());
    window.close();
  });
}

}  // namespace
