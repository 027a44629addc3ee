// The evening's games on the results page, also those from before the page or the program was there.

#include <gmock/gmock.h>

#include <filesystem>

#include "members/Members.h"
#include "tests/app/ResultsVenue.h"

namespace {

using testing::HasSubstr;

/// A game that no other is like: Red 0 and, for member 4711, Blue 7.
std::string GameWithShots(int shots) {
  const std::string fired = "<ShotCount>" + std::to_string(shots) + "</ShotCount>";
  return GameFile(PlayerOf(1, fired) + PlayerOf(40, fired + "<MemberIndex>4711</MemberIndex>"));
}

class EveningOnThePage : public ResultsVenue {
 protected:
  EveningOnThePage() {
    venue.ChangeDatabase("members.mdb",
                         "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES "
                         "(4711, 'Ada', 'Byron', 'Mole')");
    StartAgain();
    for (const int shots : {10, 20, 30}) {
      const std::string minute = std::to_string(shots + 1);
      venue.Time.Stamps["today"] = "2013-05-21 14:" + minute + ":00";
      venue.LoadGame(GameWithShots(shots));
    }
  }
};

TEST_P(EveningOnThePage, IsThereAfterTheNextStart) {
  Serve();
  ShowNames();
  ASSERT_TRUE(IsServed("/en/g/3/40"));
  const auto before = Served();
  StartAgain();
  Serve();
  EXPECT_THAT(Served().at("/en/g/1/"), HasSubstr("14:11"));
  EXPECT_THAT(Served().at("/en/g/1/"), HasSubstr("Mole"));
  EXPECT_THAT(Served().at("/en/"), HasSubstr("14:31"));
  EXPECT_EQ(Served(), before);
}

TEST_P(EveningOnThePage, IsThereWhenThePageIsSwitchedOnLater) {
  Serve();
  EXPECT_THAT(Served().at("/en/"), HasSubstr("14:31"));
  EXPECT_TRUE(IsServed("/en/g/1/"));
  EXPECT_FALSE(IsServed("/en/g/4/"));  // the game on the board is one of the three
  venue.LoadGame(GameWithShots(40));
  EXPECT_TRUE(IsServed("/en/g/4/"));
}

TEST_P(EveningOnThePage, KnowsItsGamesWhenTheyComeOntoTheBoardAgain) {
  StartAgain();
  Serve();
  venue.Time.Stamps["today"] = "2013-05-21 14:21:00";
  venue.LoadGame(GameWithShots(20));
  EXPECT_FALSE(IsServed("/en/g/4/"));
  EXPECT_EQ(Host().Setup().Games, 10);
}

TEST_P(EveningOnThePage, HasGamesOfTheLastTwelveHoursOnly) {
  venue.Time.DateAndTime = "2013-05-22 02:21:00";  // twelve hours after the second
  StartAgain();
  Serve();
  EXPECT_THAT(Served().at("/en/"), HasSubstr("14:31"));
  EXPECT_TRUE(IsServed("/en/g/1/"));
  EXPECT_FALSE(IsServed("/en/g/2/"));
}

TEST_P(EveningOnThePage, HasAsManyGamesAsAreSet) {
  StartAgain();
  Set([](PageSetup& setup) { setup.Games = 2; });
  Serve();
  EXPECT_FALSE(IsServed("/en/g/1/"));
  EXPECT_TRUE(IsServed("/en/g/2/"));
  EXPECT_TRUE(IsServed("/en/g/3/"));
  Set([](PageSetup& setup) { setup.Games = 3; });
  EXPECT_TRUE(IsServed("/en/g/1/"));
}

TEST_P(EveningOnThePage, HasTheNamesOfNowAndKeepsHiddenOnesHidden) {
  StartAgain();
  venue.ChangeDatabase("members.mdb", "UPDATE Members SET NickName = 'Otter' WHERE ContactID = 4711");
  Serve();
  EXPECT_FALSE(AnyServed("Otter"));
  ShowNames();
  EXPECT_THAT(Served().at("/en/g/1/"), HasSubstr("Otter"));
  EXPECT_FALSE(AnyServed("Mole"));
  venue.LoadGame(GameWithShots(20));
  Hide(1);
  EXPECT_FALSE(AnyServed("Otter"));
  StartAgain();
  Serve();
  EXPECT_TRUE(IsServed("/en/g/3/40"));
  EXPECT_FALSE(AnyServed("Otter"));
}

TEST_P(EveningOnThePage, HasNoNameOfAMemberWhoIsTakenOffTheList) {
  Serve();
  ShowNames();
  ASSERT_TRUE(AnyServed("Mole"));
  const WhileModal<Members> window([this](Members& members) {
    venue.ChangeDatabase("members.mdb", "DELETE FROM Members WHERE ContactID = 4711");
    members.close();
  });
  venue.Trigger("mnuManageMembers");
  EXPECT_EQ(window.Runs(), 1);
  EXPECT_TRUE(IsServed("/en/g/1/40"));
  EXPECT_FALSE(AnyServed("Mole"));
}

TEST_P(EveningOnThePage, HasNoGameThatWasDeleted) {
  venue.ChangeDatabase("games.mdb", "UPDATE Games SET Deleted = '2013-05-21 14:32:00' WHERE GameID = 1");
  StartAgain();
  Serve();
  EXPECT_THAT(Served().at("/en/g/1/"), HasSubstr("14:21"));
  EXPECT_FALSE(IsServed("/en/g/3/"));
}

TEST_P(EveningOnThePage, GoesOnWithoutAGameThatCannotBeRead) {
  venue.ChangeDatabase("games.mdb", "UPDATE sqlar SET data = x'00' WHERE rowid = 2");
  StartAgain();
  Serve();
  EXPECT_THAT(Served().at("/en/g/1/"), HasSubstr("14:11"));
  EXPECT_THAT(Served().at("/en/g/2/"), HasSubstr("14:31"));
  EXPECT_FALSE(IsServed("/en/g/3/"));
}

TEST_P(EveningOnThePage, BeginsAnewWhereNoGamesCanBeRead) {
  venue.Window->close();
  venue.Window.reset();
  std::filesystem::remove(venue.DataFile("games.mdb"));
  std::filesystem::create_directory(venue.DataFile("games.mdb"));
  venue.Start();
  Serve();
  EXPECT_FALSE(IsServed("/en/g/1/"));
  venue.LoadGame(GameWithShots(50));
  EXPECT_TRUE(IsServed("/en/g/1/"));
}

INSTANTIATE_TEST_SUITE_P(Languages, EveningOnThePage,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "SimplifiedChinese";
                         });

}  // namespace
