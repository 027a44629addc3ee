#include <gmock/gmock.h>

#include <QCheckBox>
#include <QHeaderView>
#include <QLineEdit>
#include <QRadioButton>
#include <nlohmann/json.hpp>

#include "audience/GuestNameEntry.h"
#include "exports/ExportGames.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using nlohmann::ordered_json;
using testing::ElementsAre;
using testing::IsEmpty;

/// Games, Export on real databases and files.
class ExportCommand : public testing::Test {
 protected:
  ExportCommand() {
    venue.Start();
    venue.ChangeDatabase("members.mdb",
                         "INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName) VALUES "
                         "(5, 'BB00000000000001', 'Bo', 'Ray', 'Mole')");
    venue.MakeWindow().FormLoad();
    Show(*venue.Window);
  }

  /// Exports what stands on the board as JSON, with these boxes ticked.
  ordered_json Exported(const std::vector<const char*>& ticks = {}) {
    const std::string path = venue.Folder / "game.json";
    std::filesystem::remove(path);
    const WhileModal<ExportGames> act([&](ExportGames& window) {
      Find<QRadioButton>(window, "FormatJson").click();
      for (const char* tick : ticks) {
        Find<QCheckBox>(window, tick).click();
      }
      venue.Dialog.Answers = {path};
      ::Press(window, "ExportButton");
      window.close();
    });
    venue.Trigger("mnuExport");
    EXPECT_EQ(act.Runs(), 1);
    const auto document = ordered_json::parse(ReadFile(path));
    return document.at("games").at(0);
  }

  Venue venue;
};

TEST_F(ExportCommand, TakesTheGameOnTheBoard) {
  venue.LoadGame(GameFile(PlayerOf(1, "<BonusPoints>5</BonusPoints>") +
                              PlayerOf(40,
                                       "<BonusPoints>9</BonusPoints>"
                                       "<DallasID>BB00000000000001</DallasID>") +
                              PlayerOf(105, "<BonusPoints>7</BonusPoints>"),
                          "First Muster"));
  venue.Boxes.Boxes.clear();
  const ordered_json game = Exported();
  EXPECT_EQ(game.at("mission"), "First Muster");
  EXPECT_EQ(game.at("game_date"), "today");
  EXPECT_EQ(game.at("received"), venue.Time.DateAndTime);
  std::vector<std::string> names;
  std::vector<int> soldiering;
  for (const ordered_json& player : game.at("players")) {
    names.push_back(player.at("name"));
    soldiering.push_back(player.at("soldiering"));
    EXPECT_FALSE(player.contains("first_name"));
  }
  EXPECT_THAT(names, ElementsAre("Mole", "Red 40", "Red 0"));
  EXPECT_THAT(soldiering, ElementsAre(9, 7, 5));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(ExportCommand, NamesTheGuestsOfTheGameOnTheBoard) {
  venue.LoadGame(GameFile(PlayerOf(40, "<BonusPoints>9</BonusPoints>"), "First Muster"));
  EXPECT_EQ(Exported().at("players").at(0).at("name"), "Blue 7");
  const WhileModal<GuestNameEntry> entry([](GuestNameEntry& window) {
    Find<QLineEdit>(window, "Guest40").setText(QStringLiteral("Ann"));
    ::Press(window, "SaveExit");
  });
  venue.Trigger("mnuGuestNames");
  EXPECT_EQ(entry.Runs(), 1);
  EXPECT_EQ(Exported().at("players").at(0).at("name"), "Ann");
}

TEST_F(ExportCommand, FollowsTheStandingsHoweverTheBoardIsSorted) {
  venue.LoadGame(SmallGame());
  QTest::mouseClick(venue.Find<QTableView>("ScoreDisplay").horizontalHeader()->viewport(), Qt::LeftButton, {},
                    QPoint(20, 5));
  venue.ActiveMission().setCurrentIndex(1);  // calculates, and ranks the lowest first
  const ordered_json players = Exported().at("players");
  EXPECT_EQ(players[0].at("name"), "Blue 7");
  EXPECT_EQ(players[0].at("place"), 1);
  EXPECT_EQ(players[0].at("rank"), 2);
  EXPECT_EQ(players[1].at("rank"), 1);
}

TEST_F(ExportCommand, NamesMembersWhereThatIsTicked) {
  venue.LoadGame(GameFile(PlayerOf(40, "<DallasID>BB00000000000001</DallasID>")));
  const ordered_json player = Exported({"FullNames", "MemberNumbers", "Buttons"}).at("players")[0];
  EXPECT_EQ(player.at("first_name"), "Bo");
  EXPECT_EQ(player.at("last_name"), "Ray");
  EXPECT_EQ(player.at("member"), 5);
  EXPECT_EQ(player.at("button"), "BB00000000000001");
}

TEST_F(ExportCommand, ShowsNoBoxForAMemberWhoIsGone) {
  venue.LoadGame(GameFile(PlayerOf(40, "<MemberIndex>5</MemberIndex>")));
  venue.ChangeDatabase("members.mdb", "DELETE FROM Members WHERE ContactID = 5");
  const ordered_json player = Exported({"FullNames", "MemberNumbers"}).at("players")[0];
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(player.at("name"), "Blue 7");
  EXPECT_TRUE(player.at("first_name").is_null());
  EXPECT_EQ(player.at("member"), 5);
}

TEST_F(ExportCommand, SuggestsANameWithDateAndMission) {
  venue.LoadGame(SmallGame());
  const WhileModal<ExportGames> act([](ExportGames& window) {
    ::Press(window, "ExportButton");
    window.close();
  });
  venue.Dialog.Calls.clear();
  venue.Trigger("mnuExport");
  ASSERT_EQ(venue.Dialog.Calls.size(), 1U);
  EXPECT_EQ(venue.Dialog.Calls[0].Name, "2013-05-21 1430 None players.csv");
}

TEST_F(ExportCommand, HasNothingToExportOnAnEmptyBoard) {
  const WhileModal<ExportGames> act([](ExportGames& window) {
    EXPECT_FALSE(Find<QPushButton>(window, "ExportButton").isEnabled());
    window.close();
  });
  venue.Trigger("mnuExport");
  EXPECT_EQ(act.Runs(), 1);
}

TEST_F(ExportCommand, TakesThePastGamesOfAPeriod) {
  for (const int points : {5, 6, 7}) {
    venue.LoadGame(GameFile(PlayerOf(1, "<BonusPoints>" + std::to_string(points) + "</BonusPoints>")));
  }
  venue.Boxes.Answers = {BoxAnswer::Ok};
  venue.Trigger("mnuClearScores");
  const std::string path = venue.Folder / "games.json";
  const WhileModal<ExportGames> act([&](ExportGames& window) {
    Find<QRadioButton>(window, "WhichPeriod").click();
    Find<QRadioButton>(window, "FormatJson").click();
    venue.Dialog.Answers = {path};
    ::Press(window, "ExportButton");
    window.close();
  });
  venue.Trigger("mnuExport");
  EXPECT_EQ(act.Runs(), 1);
  std::vector<int> soldiering;
  const auto document = ordered_json::parse(ReadFile(path));
  for (const ordered_json& game : document.at("games")) {
    soldiering.push_back(game.at("players").at(0).at("soldiering"));
  }
  EXPECT_THAT(soldiering, ElementsAre(5, 6, 7));
}

}  // namespace
