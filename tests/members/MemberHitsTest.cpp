#include "members/MemberHits.h"

#include <gtest/gtest.h>

#include "tests/members/MemberFile.h"

namespace {

class Hits : public testing::Test {
 protected:
  /// The last names found for `text`, each followed by a blank.
  std::string Found(const std::string& text) {
    hits.Search(text);
    std::string names;
    for (int position = 0; position < hits.Count(); ++position) {
      names += hits.At(position)->LastName + " ";
    }
    return names;
  }

  MemberFile file;
  std::unique_ptr<Database> database = file.Open();
  MemberHits hits{*database};
};

TEST_F(Hits, AreTheMembersOfWhomANameBeginsWithTheText) {
  EXPECT_EQ(Found(""), "Morgan Belmont O'Brien 王 ");
  EXPECT_EQ(Found("mo"), "Morgan Belmont ");
  EXPECT_EQ(Found("小"), "王 ");
  EXPECT_EQ(Found("elmont"), "");
}

TEST_F(Hits, TakeAnApostropheAsALetter) {
  EXPECT_EQ(Found("O'B"), "O'Brien ");
  EXPECT_EQ(Found("o'"), "O'Brien ");
  EXPECT_EQ(Found("'"), "");
  EXPECT_EQ(Found("x'); DELETE FROM Members; --"), "");
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members"), "4");
}

TEST_F(Hits, AreNoneForAPatternThatIsNotComplete) {
  EXPECT_EQ(Found("[a"), "");
  EXPECT_EQ(Found("[a]"), "Belmont ");
}

TEST_F(Hits, AreAllTheirNumbersHoweverMany) {
  file.Execute(
      "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 1500) INSERT INTO Members "
      "(ContactID, FirstName, LastName) SELECT i + 1000, 'Zo', 'Adams' FROM n");
  EXPECT_EQ(MembersCalled(*database, "zo").size(), 1500U);
  EXPECT_EQ(MembersCalled(*database, "mole"), std::vector<std::int32_t>{2});
  EXPECT_EQ(MembersCalled(*database, "o'b").size(), 1U);
  EXPECT_TRUE(MembersCalled(*database, "[a").empty());
  EXPECT_TRUE(MembersCalled(*database, "nobody").empty());
}

TEST_F(Hits, TellWhatTheListShows) {
  file.Execute(
      "UPDATE Members SET LastPlayedDate = '2026-11-20 20:15:00', PhotographLength = 3, Photograph = "
      "x'010203' WHERE ContactID = 2");
  hits.Search("mole");
  const std::optional<MemberHit> hit = hits.At(0);
  ASSERT_TRUE(hit);
  EXPECT_EQ(hit->ContactId, 2);
  EXPECT_EQ(hit->Name(), "Alice Belmont");
  EXPECT_EQ(hit->NickName, "Mole");
  EXPECT_EQ(hit->LastPlayed, "2026-11-20 20:15:00");
  EXPECT_TRUE(hit->HasPhoto);
  EXPECT_EQ(hits.Photo(0).substr(0, 3), "\x01\x02\x03");
  hits.Search("morgan");
  EXPECT_FALSE(hits.At(0)->HasPhoto);
  EXPECT_EQ(hits.Photo(0), "");
}

TEST_F(Hits, ShareANameByFirstAndLastNameInAnyCase) {
  file.Execute(
      "INSERT INTO Members (ContactID, FirstName, LastName) VALUES (11, 'RHYS', 'morgan'), "
      "(12, 'Rhys', 'Belmont')");
  Found("");
  EXPECT_TRUE(hits.SharesName(*hits.At(0)));
  EXPECT_FALSE(hits.SharesName(*hits.At(1)));
  EXPECT_FALSE(hits.SharesName(*hits.At(2)));  // with an apostrophe
  EXPECT_TRUE(hits.SharesName(*hits.At(4)));
  EXPECT_FALSE(hits.SharesName(*hits.At(5)));
}

TEST_F(Hits, KnowTheirPositions) {
  Found("mo");
  EXPECT_EQ(hits.PositionOf(1), 0);
  EXPECT_EQ(hits.PositionOf(2), 1);
  EXPECT_EQ(hits.PositionOf(5), -1);
}

TEST_F(Hits, LackAMemberWhoWasDeletedSince) {
  Found("");
  file.Execute("DELETE FROM Members WHERE ContactID = 2");
  EXPECT_FALSE(hits.At(1));
  EXPECT_EQ(hits.At(2)->LastName, "O'Brien");
  EXPECT_FALSE(hits.At(4));
  EXPECT_FALSE(hits.At(-1));
}

TEST_F(Hits, AreNoneBeforeTheFirstSearch) {
  EXPECT_EQ(hits.Count(), 0);
  EXPECT_FALSE(hits.At(0));
  EXPECT_EQ(hits.PositionOf(1), -1);
  EXPECT_EQ(hits.Photo(0), "");
}

TEST_F(Hits, AreGivenUpUntilTheNextSearchWhenTheFileIsLocked) {
  Found("");
  {
    OtherConnection other(file.Path());
    other.Execute("BEGIN EXCLUSIVE");
    EXPECT_FALSE(hits.At(0));
    other.Execute("COMMIT");
  }
  EXPECT_FALSE(hits.At(0));
  EXPECT_EQ(Found("mole"), "Belmont ");
}

TEST_F(Hits, AreNoneInADamagedFileAndThrowNothing) {
  file.Execute("DROP TABLE Members");
  EXPECT_EQ(Found("mo"), "");
}

}  // namespace
