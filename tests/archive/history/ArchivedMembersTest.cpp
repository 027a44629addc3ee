#include "archive/history/ArchivedMembers.h"

#include <gmock/gmock.h>

#include "tests/archive/history/HistoryVenue.h"

namespace {

using testing::ElementsAre;

class KnownToTheArchive : public testing::Test, protected HistoryVenue {
 protected:
  KnownToTheArchive() { Keep("2026-10-01 20:00:00", 1); }

  std::vector<std::string> Listed() const {
    std::vector<std::string> texts;
    for (const ArchivedMember& member : ArchivedMembers(ArchiveSql(), *MembersDatabase)) {
      texts.push_back(std::to_string(member.Number) + " " + member.Name + " " + member.Button);
    }
    return texts;
  }
};

TEST_F(KnownToTheArchive, AreListedByName) {
  EXPECT_THAT(Listed(), ElementsAre("5 Bo Ray \"Mole\" BB00000000000001", "6 Cy Fox "));
}

TEST_F(KnownToTheArchive, StayListedWhenTheyAreMembersNoMore) {
  InMembers("DELETE FROM Members WHERE ContactID = 5");
  EXPECT_THAT(Listed(), ElementsAre("6 Cy Fox ", "5  BB00000000000001"));
  EXPECT_FALSE(ArchivedMembers(ArchiveSql(), *MembersDatabase).back().IsMember);
}

TEST_F(KnownToTheArchive, AreListedAlikeWhenTheyAreMany) {
  for (int number = 100; number < 2200; ++number) {
    ArchiveSql().Change("INSERT INTO KnownMembers (MemberID, DallasID, Digest) VALUES ($1, '', '')",
                        {std::int64_t{number}});
    if (number == 100) {
      ArchiveDatabase->BeginTrans();
    }
  }
  ArchiveDatabase->CommitTrans();
  const std::vector<std::string> listed = Listed();
  ASSERT_EQ(listed.size(), 2102U);
  EXPECT_EQ(listed[0], "5 Bo Ray \"Mole\" BB00000000000001");
  EXPECT_EQ(listed[1], "6 Cy Fox ");
}

TEST(IsFound, LooksForNumberNameAndButton) {
  const ArchivedMember member{.Number = 57, .IsMember = true, .Name = "Bo Ray \"Mole\"", .Button = "BB01"};
  for (const char* text : {"", "57", "ray", "MOLE", "bb0"}) {
    EXPECT_TRUE(IsFound(member, text)) << text;
  }
  for (const char* text : {"5", "7", "fox"}) {
    EXPECT_FALSE(IsFound(member, text)) << text;
  }
}

}  // namespace
