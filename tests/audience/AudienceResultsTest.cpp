#include "audience/AudienceResults.h"

#include <gmock/gmock.h>

#include "tests/support/OpenSession.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr int Red0 = 1;
constexpr int Blue7 = 40;
constexpr int Yellow0 = 65;

class PublicResults : public testing::Test {
 protected:
  AudienceResults Results() {
    return ResultsOf(venue.session, [](int index) { return index == Blue7 ? "Guest" : ""; });
  }

  std::vector<std::string> Names() {
    std::vector<std::string> names;
    for (const Standing& player : Results().Players) {
      names.push_back(player.PublicName);
    }
    return names;
  }

  OpenSession venue;
};

TEST_F(PublicResults, NameMembersGuestsAndGuns) {
  ExecuteSql(venue.MembersFile(),
             "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES "
             "(3, 'Ada', 'Byron', 'Mole')");
  venue.Open();
  venue.Play(Red0, 5);
  venue.Play(Blue7, 9);
  venue.Play(Yellow0, 7).MemberIndex = 3;
  venue.session.CalculateScores();
  EXPECT_THAT(Names(), ElementsAre("Guest", "Mole", "Red 0"));
}

TEST_F(PublicResults, CallMembersByTheNicknamesOfToday) {
  ExecuteSql(venue.MembersFile(),
             "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES "
             "(3, 'Ada', 'Byron', 'Mole'), (4, 'Bo', 'Ek', 'Owl')");
  venue.Open();
  venue.Play(Yellow0, 7).MemberIndex = 3;
  venue.Play(Red0, 5).MemberIndex = 4;
  venue.Play(Blue7, 3);
  venue.session.CalculateScores();
  AudienceResults results = Results();
  ExecuteSql(
      venue.MembersFile(),
      "UPDATE Members SET NickName = 'Badger' WHERE ContactID = 3; DELETE FROM Members WHERE ContactID = 4");
  LookUpNickNames(results, venue.session);
  ShowNames(results, [](const NameHolder& holder) {
    return holder.NickName.empty() ? holder.GuestName : holder.NickName;
  });
  EXPECT_EQ(results.Players[0].PublicName, "Badger");
  EXPECT_EQ(results.Players[1].PublicName, "Red 0");
  EXPECT_EQ(results.Players[2].PublicName, "Guest");
}

TEST_F(PublicResults, HoldATotalForEachTeamThatPlayedHighestFirst) {
  venue.Open();
  venue.Play(Red0, 5);
  venue.Play(Blue7, 9);
  venue.session.CalculateScores();
  const AudienceResults results = Results();
  ASSERT_EQ(results.Totals.size(), 2U);
  EXPECT_EQ(results.Totals[0].Team, 2);
  EXPECT_EQ(results.Totals[0].Points, venue.session.Game().TeamTotals(2));
  EXPECT_EQ(results.Totals[1].Team, 1);
  EXPECT_THAT(results.Mission, IsEmpty());
}

TEST_F(PublicResults, AreEmptyWithoutAPlayer) {
  venue.Open();
  EXPECT_TRUE(Results().IsEmpty());
}

TEST(TeamLetter, IsTheFirstOfTheTeamsName) {
  const StringTable english(Language::English);
  const StringTable chinese(Language::SimplifiedChinese);
  for (int team = 1; team <= 3; ++team) {
    const auto number = static_cast<std::int16_t>(team);
    EXPECT_EQ(TeamLetter(english, team), TeamNameFromNumber(english, number).substr(0, 1));
    EXPECT_EQ(TeamLetter(chinese, team), TeamNameFromNumber(chinese, number).substr(0, 3));
  }
  EXPECT_EQ(ShortGunName(english, {.Team = 2, .Number = 7}), "B7");
}

}  // namespace
