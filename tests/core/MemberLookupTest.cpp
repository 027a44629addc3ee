#include "core/MemberLookup.h"

#include <gmock/gmock.h>

#include "core/FieldValue.h"
#include "tests/core/ScoredGame.h"

namespace {

using testing::ElementsAre;

class Looking : public testing::Test {
 protected:
  Looking() {
    ExecuteSql(venue.MembersFile(),
               "INSERT INTO Members (ContactID, DallasID, FirstName, LastName, NickName) VALUES "
               "(2, 'AA', 'Ann', 'Lee', ''), (5, 'BB', 'Bo', 'Ray', 'Mole'), (6, 'BB', 'Cy', 'Fox', NULL)");
    venue.Open();
  }

  ScoredGame venue;
};

TEST_F(Looking, StandsOnTheMemberFound) {
  ASSERT_TRUE(venue.Members->LoadMember(5));
  EXPECT_EQ(venue.Members->GetPlayerName(true), "Mole");
  EXPECT_EQ(venue.Members->GetPlayerName(false), "Bo Ray");
}

TEST_F(Looking, TakesTheFullNameWithoutANickname) {
  ASSERT_TRUE(venue.Members->LoadMember(2));
  EXPECT_EQ(venue.Members->GetPlayerName(true), "Ann Lee");
  ASSERT_TRUE(venue.Members->LoadMember(6));
  EXPECT_EQ(venue.Members->GetPlayerName(true), "Cy Fox");
}

TEST_F(Looking, EndsPastTheLastRowWhenThereIsNone) {
  EXPECT_FALSE(venue.Members->LoadMember(3));
  EXPECT_TRUE(venue.RsMembers->Eof());
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Could not locate specified Member in database!", "Member Error",
                                                BoxIcon::Exclamation, BoxButtons::Ok}));
}

TEST_F(Looking, FindsTheFirstHolderOfAButtonAndStandsBehind) {
  EXPECT_EQ(venue.Members->FindByDallasId("BB"), 5);
  EXPECT_EQ(TextOf(venue.RsMembers->Fields("ContactID")), "6");
  EXPECT_EQ(venue.Members->FindByDallasId("CC"), 0);
}

TEST_F(Looking, DoesNotSeeMembersAddedLater) {
  ExecuteSql(venue.MembersFile(), "INSERT INTO Members (ContactID, DallasID) VALUES (9, 'DD')");
  EXPECT_EQ(venue.Members->FindByDallasId("DD"), 0);
  EXPECT_FALSE(venue.Members->LoadMember(9));
}

TEST_F(Looking, SeesNamesChangedLater) {
  ExecuteSql(venue.MembersFile(), "UPDATE Members SET NickName = 'Owl' WHERE ContactID = 5");
  ASSERT_TRUE(venue.Members->LoadMember(5));
  EXPECT_EQ(venue.Members->GetPlayerName(true), "Owl");
}

TEST_F(Looking, DoesNotFindAMemberDeletedLater) {
  ExecuteSql(venue.MembersFile(), "DELETE FROM Members WHERE ContactID = 5");
  EXPECT_FALSE(venue.Members->LoadMember(5));
}

}  // namespace
