#include "members/MemberQueries.h"

#include <gtest/gtest.h>

#include "tests/members/MemberFile.h"
#include "tests/support/Thrown.h"

namespace {

class Query : public testing::Test {
 protected:
  std::string Numbers(const std::string& query) { return AllNumbers(*database->OpenRecordset(query)); }

  MemberFile file;
  std::unique_ptr<Database> database = file.Open();
};

TEST_F(Query, OfASearchIsExactlyThis) {
  EXPECT_EQ(SearchQuery("mo"),
            "SELECT * FROM Members WHERE ([FirstName] LIKE 'mo*' OR [LastName] LIKE 'mo*' OR [NickName] LIKE "
            "'mo*')");
  EXPECT_EQ(SearchQuery(""), "SELECT * FROM Members");
}

TEST_F(Query, OfTheListDoublesApostrophes) {
  EXPECT_EQ(HitsQuery("O'B"),
            "SELECT * FROM Members WHERE ([FirstName] LIKE 'O''B*' OR [LastName] LIKE 'O''B*' OR [NickName] "
            "LIKE 'O''B*')");
  EXPECT_EQ(HitsQuery("mo"), SearchQuery("mo"));
  EXPECT_EQ(HitsQuery(""), "SELECT * FROM Members");
}

TEST_F(Query, FindsTheBeginningOfAnyOfTheThreeNames) {
  EXPECT_EQ(Numbers(SearchQuery("mo")), "1 2 ");
  EXPECT_EQ(Numbers(SearchQuery("MO")), "1 2 ");
  EXPECT_EQ(Numbers(SearchQuery("bel")), "2 ");
  EXPECT_EQ(Numbers(SearchQuery("王")), "9 ");
  EXPECT_EQ(Numbers(SearchQuery("")), "1 2 5 9 ");
  EXPECT_EQ(Numbers(SearchQuery("nobody")), "");
}

TEST_F(Query, TakesTheDatabasesWildcards) {
  EXPECT_EQ(Numbers(SearchQuery("*mont")), "2 ");
  EXPECT_EQ(Numbers(SearchQuery("?h")), "1 5 ");
  EXPECT_EQ(Numbers(SearchQuery("[a-b]")), "2 ");
  EXPECT_EQ(Numbers(SearchQuery("%")), "");
  EXPECT_EQ(Numbers(SearchQuery("_h")), "");
  EXPECT_EQ(NumberThrownBy([&] { Numbers(SearchQuery("[")); }), 93);
}

TEST_F(Query, WithAnApostropheInTheSearchCannotBeRead) {
  EXPECT_EQ(NumberThrownBy([&] { Numbers(SearchQuery("O'B")); }), 3075);
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members"), "4");
}

TEST_F(Query, OfTwoNamesDoublesApostrophes) {
  EXPECT_EQ(NameQuery("D'Arcy", "O''Brien"),
            "SELECT * FROM Members WHERE ([FirstName] = 'D''Arcy' AND [LastName] = 'O''''Brien')");
  EXPECT_EQ(Numbers(NameQuery("Sean", "O'Brien")), "5 ");
  EXPECT_EQ(Numbers(NameQuery("Sean", "O'*")), "");
}

TEST_F(Query, OfAButtonFindsItToTheLetter) {
  file.Execute("UPDATE Members SET DallasID = 'EFCDAB8967452301' WHERE ContactID = 5");
  EXPECT_EQ(Numbers(ButtonQuery("EFCDAB8967452301")), "5 ");
  EXPECT_EQ(Numbers(ButtonQuery("FFCDAB8967452301")), "");
}

}  // namespace
