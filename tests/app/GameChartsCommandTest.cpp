#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QTabWidget>

#include "audience/GuestNameEntry.h"
#include "charts/ChartTable.h"
#include "charts/GameCharts.h"
#include "charts/HitMap.h"
#include "charts/ScoreChart.h"
#include "members/Members.h"
#include "tests/support/CaredFor.h"
#include "tests/support/OnScreen.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"
#include "web/ResultsPage.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

/// The window of the charts; null if none is open.
GameCharts* OpenCharts() {
  for (QWidget* window : QApplication::topLevelWidgets()) {
    if (auto* charts = qobject_cast<GameCharts*>(window); charts != nullptr && charts->isVisible()) {
      return charts;
    }
  }
  return nullptr;
}

/// The players of the score chart with their scores, from the top.
std::vector<std::pair<std::string, std::int32_t>> ChartedScores(const GameCharts& charts) {
  std::vector<std::pair<std::string, std::int32_t>> scores;
  for (const PlayerParts& player : Find<ScoreChart>(charts, "Bars").Players()) {
    scores.emplace_back(player.Player.Name, player.Soldiering);
  }
  return scores;
}

class ChartsCommand : public testing::Test {
 protected:
  ChartsCommand() { venue.Start(); }

  GameCharts& Charts() {
    if (OpenCharts() == nullptr) {
      venue.Trigger("mnuGameCharts");
    }
    return *OpenCharts();
  }

  std::vector<std::string> ChartedNames() {
    std::vector<std::string> names;
    for (const auto& [name, score] : ChartedScores(Charts())) {
      names.push_back(name);
    }
    return names;
  }

  /// Blue 7 is a member with a nickname, Red 0 a guest.
  void PutMemberAndGuest() {
    venue.ChangeDatabase(
        "members.mdb",
        "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES (5, 'Bo', 'Ray', 'Mole')");
    venue.MakeWindow().FormLoad();
    Show(*venue.Window);
    venue.LoadGame(GameFile(PlayerOf(1, "<BonusPoints>5</BonusPoints>") +
                            PlayerOf(40, "<BonusPoints>9</BonusPoints><MemberIndex>5</MemberIndex>")));
  }

  void NameGuest(const char* name) {
    const WhileModal<GuestNameEntry> entry([name](GuestNameEntry& window) {
      Find<QLineEdit>(window, "Guest1").setText(QString::fromUtf8(name));
      ::Press(window, "SaveExit");
    });
    venue.Trigger("mnuGuestNames");
    EXPECT_EQ(entry.Runs(), 1);
  }

  void HideRow(int row) {
    venue.Find<QTableView>("ScoreDisplay").selectRow(row);
    venue.Boxes.Answers = {BoxAnswer::Ok};
    venue.Trigger("mnuHidePlayer");
  }

  /// Soldiering of the player on that row of the board.
  std::string ScoreOnBoard(int row) const { return venue.Row("ScoreDisplay", row).at(2); }

  Venue venue;
};

TEST_F(ChartsCommand, ShowsTheGameOnTheBoard) {
  venue.LoadGame(SmallGame());
  const auto scores = ChartedScores(Charts());
  ASSERT_EQ(static_cast<int>(scores.size()), venue.RowCount("ScoreDisplay"));
  for (std::size_t row = 0; row < scores.size(); ++row) {
    EXPECT_EQ(QString::fromStdString(ScoreOnBoard(static_cast<int>(row))).toInt(), scores[row].second);
    for (const PlayerParts& player : Find<ScoreChart>(Charts(), "Bars").Players()) {
      EXPECT_EQ(player.Of(ScorePart::Other), 0) << player.Player.Name;
    }
  }
}

TEST_F(ChartsCommand, FollowsTheBoardWhileItIsOpen) {
  const GameCharts& charts = Charts();
  EXPECT_TRUE(Find<QLabel>(charts, "EmptyLabel").isVisible());
  venue.LoadGame(GameOfManyHits());
  EXPECT_FALSE(Find<QLabel>(charts, "EmptyLabel").isVisible());
  EXPECT_EQ(static_cast<int>(ChartedScores(charts).size()), venue.RowCount("ScoreDisplay"));
  EXPECT_GT(Find<HitMap>(charts, "Map").Matrix().Most(), 0);
  venue.Trigger("mnuClearScores");
  EXPECT_TRUE(Find<QLabel>(charts, "EmptyLabel").isVisible());
  EXPECT_TRUE(ChartedScores(charts).empty());
}

TEST_F(ChartsCommand, FollowsAChangeOfTheMissionUpToTheLastPoint) {
  venue.LoadGame(GameOfManyHits());
  const GameCharts& charts = Charts();
  for (int mission = 0; mission < venue.ActiveMission().count(); ++mission) {
    venue.ActiveMission().setCurrentIndex(mission);
    EXPECT_THAT(Find<QLabel>(charts, "TitleLabel").text().toStdString(),
                HasSubstr(venue.ActiveMission().currentText().toStdString()));
    for (const PlayerParts& player : Find<ScoreChart>(charts, "Bars").Players()) {
      EXPECT_EQ(player.Of(ScorePart::Other), 0) << player.Player.Name << ", mission " << mission;
    }
  }
}

TEST_F(ChartsCommand, NamesMembersByTheirNicknamesOnly) {
  venue.ChangeDatabase(
      "members.mdb",
      "INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName) VALUES "
      "(5, 'BB00000000000001', 'Bo', 'Ray', 'Mole'), (6, 'BB00000000000002', 'Ann', 'Doe', NULL)");
  venue.MakeWindow().FormLoad();
  Show(*venue.Window);
  venue.LoadGame(GameFile(PlayerOf(40,
                                   "<BonusPoints>9</BonusPoints>"
                                   "<DallasID>BB00000000000001</DallasID>") +
                              PlayerOf(105,
                                       "<BonusPoints>7</BonusPoints>"
                                       "<DallasID>BB00000000000002</DallasID>"),
                          "First Muster"));
  ASSERT_THAT(venue.Row("ScoreDisplay", 1).at(1), HasSubstr("Ann Doe"));
  const auto scores = ChartedScores(Charts());
  ASSERT_EQ(scores.size(), 2U);
  EXPECT_THAT(scores[0].first, HasSubstr("(Mole)"));
  EXPECT_THAT(scores[1].first, testing::Not(HasSubstr("Ann")));
}

TEST_F(ChartsCommand, NamesGuestsAsSoonAsTheyAreEntered) {
  PutMemberAndGuest();
  EXPECT_THAT(ChartedNames(), ElementsAre("Blue  7 (Mole)", "Red  0"));
  NameGuest("Ann");
  EXPECT_THAT(ChartedNames(), ElementsAre("Blue  7 (Mole)", "Red  0 (Ann)"));
  NameGuest("");
  EXPECT_THAT(ChartedNames(), ElementsAre("Blue  7 (Mole)", "Red  0"));
}

TEST_F(ChartsCommand, LeavesOutHiddenNamesUntilTheyAreShownAgain) {
  PutMemberAndGuest();
  NameGuest("Ann");
  ASSERT_THAT(ChartedNames(), ElementsAre("Blue  7 (Mole)", "Red  0 (Ann)"));
  HideRow(0);
  EXPECT_THAT(ChartedNames(), ElementsAre("Blue  7", "Red  0 (Ann)"));
  HideRow(1);
  EXPECT_THAT(ChartedNames(), ElementsAre("Blue  7", "Red  0"));
  const WhileModal<ResultsPage> page([](ResultsPage& window) {
    auto& hidden = Find<QListWidget>(window, "HiddenPlayers");
    hidden.setCurrentItem(hidden.findItems(QStringLiteral("Mole"), Qt::MatchExactly).value(0));
    ::Press(window, "ShowAgain");
    window.close();
  });
  venue.Trigger("mnuResultsPage");
  EXPECT_EQ(page.Runs(), 1);
  EXPECT_THAT(ChartedNames(), ElementsAre("Blue  7 (Mole)", "Red  0"));
}

TEST_F(ChartsCommand, NamesMembersByTheirNewNicknamesOnceTheWindowIsClosed) {
  PutMemberAndGuest();
  ASSERT_THAT(ChartedNames(), ElementsAre("Blue  7 (Mole)", "Red  0"));
  venue.ChangeDatabase("members.mdb", "UPDATE Members SET NickName = 'Fox'");
  const WhileModal<Members> members([](Members& window) { window.close(); });
  venue.Trigger("mnuManageMembers");
  EXPECT_EQ(members.Runs(), 1);
  EXPECT_THAT(ChartedNames(), ElementsAre("Blue  7 (Fox)", "Red  0"));
}

TEST_F(ChartsCommand, BringsTheOneWindowToTheFront) {
  GameCharts& charts = Charts();
  Find<QTabWidget>(charts, "Charts").setCurrentIndex(1);
  venue.Trigger("mnuGameCharts");
  EXPECT_EQ(OpenCharts(), &charts);
  charts.close();
  EXPECT_EQ(OpenCharts(), nullptr);
  venue.Trigger("mnuGameCharts");
  EXPECT_EQ(OpenCharts(), &charts);
}

TEST_F(ChartsCommand, ClosesItWithTheMainWindow) {
  Charts();
  venue.Window->close();
  EXPECT_EQ(OpenCharts(), nullptr);
}

TEST_F(ChartsCommand, SavesAPictureUnderTheNameOfTheGame) {
  venue.LoadGame(SmallGame());
  venue.Dialog.Calls.clear();
  venue.Dialog.Answers = {venue.Folder / "chart.png"};
  Press(Charts(), "SavePicture");
  ASSERT_EQ(venue.Dialog.Calls.size(), 1U);
  EXPECT_THAT(venue.Dialog.Calls[0].Name, HasSubstr(" Who Hit Whom.png"));
  EXPECT_THAT(venue.Dialog.Calls[0].Name, testing::Not(HasSubstr("game.xml")));
  EXPECT_FALSE(QImage(QString::fromStdString(venue.Folder / "chart.png")).isNull());
}

/// The charts as they open on that screen, with and without a game.
class ChartsOnScreen : public testing::TestWithParam<std::tuple<Language, const char*, int>> {};

TEST_P(ChartsOnScreen, AreCaredFor) {
  const FontOfSize font(std::get<int>(GetParam()));
  Venue venue(std::get<Language>(GetParam()));
  venue.PutDefaultFiles();
  QScreen& screen = ScreenNamed(std::get<const char*>(GetParam()));
  venue.MakeWindow().setScreen(&screen);
  venue.Window->move(screen.geometry().topLeft() + QPoint(10, 30));
  venue.Window->FormLoad();
  Show(*venue.Window);
  venue.Trigger("mnuGameCharts");
  GameCharts& charts = *OpenCharts();
  ExpectCaredFor(charts);
  venue.LoadGame(GameOfManyHits());
  ExpectCaredFor(charts);
  Find<QTabWidget>(charts, "Charts").setCurrentIndex(1);
  ExpectCaredFor(charts);
  EXPECT_GE(Find<HitMap>(charts, "Map").PlaceOf({0, 0}).width(), 2);
}

INSTANTIATE_TEST_SUITE_P(Looks, ChartsOnScreen,
                         testing::Combine(testing::Values(Language::English, Language::SimplifiedChinese),
                                          testing::Values("recommended or better", "as recommended", "laptop",
                                                          "scaled by 2"),
                                          testing::Values(0, 11)));

}  // namespace
