// Which games and which names are on the results page.

#include <gmock/gmock.h>

#include <QListWidget>
#include <QPushButton>
#include <filesystem>
#include <utility>

#include "core/text/Filled.h"
#include "tests/app/ResultsVenue.h"
#include "tests/support/Frames.h"

namespace {

using testing::HasSubstr;
using testing::Not;

class GamesOnThePage : public ResultsVenue {};

TEST_P(GamesOnThePage, ShowsGunsUntilNamesAreSwitchedOn) {
  Serve();
  venue.LoadGame(SmallGame());
  NameGuest("Guest40", "Ann");
  EXPECT_TRUE(IsServed("/en/g/1/40"));
  EXPECT_TRUE(IsServed("/zh/g/1/1"));
  EXPECT_FALSE(AnyServed("Ann"));
  ShowNames();
  EXPECT_TRUE(AnyServed("Ann"));
  Set([](PageSetup& setup) { setup.Names = NamesShown::Nowhere; });
  EXPECT_FALSE(AnyServed("Ann"));
}

TEST_P(GamesOnThePage, TakesNamesOffTheBoardTooWhereThatIsSet) {
  Serve();
  venue.LoadGame(SmallGame());
  NameGuest("Guest40", "Ann");
  venue.Trigger("mnuAudienceResults");
  EXPECT_THAT(NamesOnBoard().front(), "Ann");
  Set([](PageSetup& setup) { setup.Names = NamesShown::Nowhere; });
  EXPECT_THAT(NamesOnBoard().front(), Not("Ann"));
  Set([](PageSetup& setup) { setup.Names = NamesShown::OnBoard; });
  EXPECT_THAT(NamesOnBoard().front(), "Ann");
}

TEST_P(GamesOnThePage, HasTheGameThatIsOnTheBoardWhenItIsSwitchedOn) {
  venue.LoadGame(SmallGame());
  Serve();
  EXPECT_TRUE(IsServed("/en/g/1/"));
  EXPECT_THAT(Served().at("/en/"), HasSubstr("14:20"));
}

TEST_P(GamesOnThePage, LeavesGamesOfOtherDaysAway) {
  Serve();
  venue.Time.Stamps["today"] = "2013-05-20 20:00:00";
  venue.LoadGame(SmallGame());
  EXPECT_FALSE(IsServed("/en/g/1/"));
  venue.Time.Stamps.erase("today");
  venue.LoadGame(SmallGame());
  EXPECT_FALSE(IsServed("/en/g/1/"));
}

TEST_P(GamesOnThePage, HasAPulledGameOnceItIsScored) {
  Serve();
  bool wasThere = false;
  bool answered = false;
  venue.Port.OnOutput = [&](std::uint8_t byte) {
    wasThere = wasThere || IsServed("/en/g/1/");
    if (byte == 0 && venue.Port.Sent.size() >= 2 && !std::exchange(answered, true)) {
      venue.Port.Receive({1});
      venue.Port.Receive(FrameOfBlue0());
    }
  };
  venue.Trigger("mnuGetKeshData");
  EXPECT_TRUE(answered);
  EXPECT_FALSE(wasThere);
  EXPECT_TRUE(IsServed("/en/g/1/"));
  EXPECT_FALSE(IsServed("/en/g/2/"));
}

TEST_P(GamesOnThePage, HasNoGameThatIsNotYetScored) {
  int boxes = 0;
  venue.Boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) {  // the calculation asks about a member
    ++boxes;
    Serve();
    EXPECT_FALSE(IsServed("/en/g/1/"));
  };
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>99</MemberIndex>")));
  EXPECT_EQ(boxes, 1);
  EXPECT_TRUE(IsServed("/en/g/1/"));
}

TEST_P(GamesOnThePage, NumbersTheGamesAndShowsAsManyAsAreSet) {
  Serve();
  for (int game = 0; game < 4; ++game) {
    venue.LoadGame(SmallGame());
  }
  EXPECT_TRUE(IsServed("/en/g/1/"));
  EXPECT_TRUE(IsServed("/en/g/4/"));
  Set([](PageSetup& setup) { setup.Games = 2; });
  EXPECT_FALSE(IsServed("/en/g/2/"));
  EXPECT_TRUE(IsServed("/en/g/3/"));
  Set([](PageSetup& setup) { setup.Games = 3; });
  EXPECT_TRUE(IsServed("/en/g/2/"));
}

TEST_P(GamesOnThePage, RenewsAGameThatIsChanged) {
  Serve();
  venue.LoadGame(SmallGame());
  const std::string before = Served().at("/en/g/1/");
  const std::size_t sent = Server().Input.size();
  venue.OpenPopup(0, [](QMenu&) {});  // calculates, with nothing new
  EXPECT_EQ(Server().Input.size(), sent);
  venue.ActiveMission().setCurrentIndex(0);
  NameGuest("Guest40", "Ann");
  ShowNames();
  EXPECT_NE(Served().at("/en/g/1/"), before);
  EXPECT_FALSE(IsServed("/en/g/2/"));
}

TEST_P(GamesOnThePage, WaitsForTheBoardWhereThatIsSet) {
  Serve();
  Set([](PageSetup& setup) { setup.WithBoard = true; });
  venue.Trigger("mnuAudienceBoard");
  venue.LoadGame(SmallGame());
  EXPECT_FALSE(IsServed("/en/g/1/"));
  venue.Trigger("mnuAudienceResults");
  EXPECT_TRUE(IsServed("/en/g/1/"));
  venue.Trigger("mnuAudienceBoard");
  venue.LoadGame(SmallGame());
  EXPECT_TRUE(IsServed("/en/g/2/"));  // the board is off
}

TEST_P(GamesOnThePage, WaitsNoLongerForABoardThatIsSwitchedOff) {
  Serve();
  Set([](PageSetup& setup) { setup.WithBoard = true; });
  venue.Trigger("mnuAudienceBoard");
  venue.LoadGame(SmallGame());
  ASSERT_FALSE(IsServed("/en/g/1/"));
  venue.Trigger("mnuAudienceBoard");
  EXPECT_TRUE(IsServed("/en/g/1/"));
}

TEST_P(GamesOnThePage, LosesAHiddenNameInAllItsGamesAtOnce) {
  Serve();
  ShowNames();
  venue.Trigger("mnuAudienceBoard");
  for (int game = 0; game < 2; ++game) {
    venue.LoadGame(SmallGame());
    NameGuest("Guest40", "Ann");
  }
  venue.Trigger("mnuAudienceResults");
  ASSERT_THAT(Served().at("/en/g/1/"), HasSubstr("Ann"));
  ASSERT_THAT(NamesOnBoard().front(), "Ann");
  Hide(0);
  EXPECT_FALSE(AnyServed("Ann"));
  EXPECT_THAT(NamesOnBoard().front(), Not("Ann"));
  EXPECT_THAT(venue.Boxes.Boxes.back().Text, HasSubstr("Ann"));
}

TEST_P(GamesOnThePage, LosesAHiddenNameAlsoFromABoardWithAnEarlierGame) {
  venue.Trigger("mnuAudienceBoard");
  venue.LoadGame(SmallGame());
  NameGuest("Guest40", "Ann");
  venue.Trigger("mnuAudienceResults");
  venue.LoadGame(SmallGame());
  NameGuest("Guest40", "Ann");
  ASSERT_THAT(NamesOnBoard().front(), "Ann");
  Hide(0);
  EXPECT_THAT(NamesOnBoard().front(), Not("Ann"));
}

TEST_P(GamesOnThePage, KeepsAMemberHiddenUntilShownAgain) {
  venue.ChangeDatabase("members.mdb",
                       "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES "
                       "(4711, 'Ada', 'Byron', 'Mole')");
  StartAgain();
  const std::string game =
      GameFile(PlayerOf(1) + PlayerOf(40, "<BonusPoints>9</BonusPoints><MemberIndex>4711</MemberIndex>"));
  Serve();
  ShowNames();
  venue.LoadGame(game);
  ASSERT_TRUE(AnyServed("Mole"));
  Hide(0);
  EXPECT_FALSE(AnyServed("Mole"));
  StartAgain();
  Serve();
  venue.LoadGame(game);
  EXPECT_TRUE(IsServed("/en/g/1/40"));
  EXPECT_FALSE(AnyServed("Mole"));
  LookAt([this](ResultsPage& window) {
    auto& list = Find<QListWidget>(window, "HiddenPlayers");
    ASSERT_EQ(list.count(), 1);
    EXPECT_EQ(list.item(0)->text(), QStringLiteral("Mole"));
    EXPECT_FALSE(Find<QPushButton>(window, "ShowAgain").isEnabled());
    list.setCurrentRow(0);
    ::Press(window, "ShowAgain");
    EXPECT_EQ(list.count(), 0);
    EXPECT_TRUE(AnyServed("Mole"));
  });
  StartAgain();
  Serve();
  venue.LoadGame(game);
  EXPECT_TRUE(AnyServed("Mole"));
}

TEST_P(GamesOnThePage, HasNothingToHideWithoutAPlayerOrAName) {
  venue.Boxes.Answers = {BoxAnswer::Ok, BoxAnswer::Ok};
  venue.Trigger("mnuHidePlayer");
  EXPECT_EQ(venue.Boxes.Boxes.back().Text, venue.Strings.Text(OwnText::HideSelectFirst));
  venue.LoadGame(SmallGame());
  Hide(1);
  EXPECT_EQ(venue.Boxes.Boxes.back().Text,
            Filled(venue.Strings.Text(OwnText::HideNothing),
                   {venue.Strings.TextLanguage() == Language::English ? "Red 0" : "红队 0"}));
  EXPECT_FALSE(std::filesystem::exists(venue.DataFile("hidden-names.txt")));
}

TEST_P(GamesOnThePage, HasTheRankingOfTheMonthWhereItIsWanted) {
  std::filesystem::copy_file(TESSARINE_PROGRAM_FOLDER "/games_default.mdb", venue.DataFile("games.mdb"));
  venue.ChangeDatabase("members.mdb",
                       "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES "
                       "(4711, 'Ada', 'Byron', 'Mole'), (4712, 'Bob', 'Cole', NULL)");
  for (const char* played : {"2013-05-01 20:00:00", "2013-05-31 23:00:00", "2013-06-01 00:00:00"}) {
    venue.ChangeDatabase("games.mdb",
                         "INSERT INTO Games VALUES (NULL, '" + std::string(played) +
                             "', '', '', 'Cable', 1, 2, 0, 0, 0, 0, 1, 1, 1, 1, 1, 1, 1, '', NULL)");
    venue.ChangeDatabase("games.mdb",
                         "INSERT INTO GamePlayers SELECT max(GameID), 1, 4711, '', 1, 350, 0.5, 1, 1, 1, 1, "
                         "1, 1, 0, NULL FROM Games");
    venue.ChangeDatabase(
        "games.mdb",
        "INSERT INTO GamePlayers SELECT max(GameID), 2, 4712, '', 2, 20, 0.5, 1, 1, 1, 1, 1, "
        "1, 0, NULL FROM Games");
  }
  StartAgain();
  Serve();
  Set([](PageSetup& setup) { setup.Ranking = true; });
  EXPECT_FALSE(IsServed("/en/month"));
  ShowNames();
  ASSERT_TRUE(IsServed("/en/month"));
  EXPECT_THAT(Served().at("/zh/month"), HasSubstr("Mole"));
  EXPECT_THAT(Served().at("/en/month"), HasSubstr("<td>700"));
  EXPECT_FALSE(AnyServed("Cole"));
  EXPECT_FALSE(AnyServed("4711"));
  venue.LoadGame(GameFile(PlayerOf(40, "<MemberIndex>4711</MemberIndex>")));
  Hide(0);
  EXPECT_THAT(Served().at("/en/month"), Not(HasSubstr("Mole")));
}

INSTANTIATE_TEST_SUITE_P(Languages, GamesOnThePage,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "SimplifiedChinese";
                         });

}  // namespace
