#include "archive/history/LifetimeSums.h"

#include <gmock/gmock.h>

#include "tests/archive/history/HistoryVenue.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;

class SumsOfBo : public testing::Test, protected HistoryVenue {
 protected:
  SumsOfBo() {
    Keep("2026-10-01 20:00:00", 100);
    Keep("2026-10-02 20:00:00", 50);
    SetLifetime(2, 150);
  }

  LifetimeSums Sums(std::int32_t member = 5) const {
    return ReadLifetimeSums(ArchiveQueries(ArchiveSql()).GamesOf(member), member, ArchiveSql(), MembersSql());
  }
  std::vector<std::string> Texts(std::int32_t member = 5) const {
    return LifetimeTexts(Sums(member), Strings);
  }
};

TEST_F(SumsOfBo, AgreeWhereAllGamesAreKept) {
  EXPECT_EQ(Sums().Lifetime, (GameSums{2, 150}));
  EXPECT_THAT(Texts(), ElementsAre("Lifetime figures: games 2, soldiering 150.",
                                   "Committed games listed here: 2, soldiering 150.", "Both agree."));
}

TEST_F(SumsOfBo, TellGamesThatAreNotCommitted) {
  Keep("2026-10-03 20:00:00", -7, false);
  EXPECT_EQ(Sums().Uncommitted, (GameSums{1, -7}));
  EXPECT_THAT(Texts(), ElementsAre(HasSubstr(": games 2, soldiering 150."), HasSubstr(": 2, soldiering 150."),
                                   "Not committed, so not in the lifetime figures: games 1, soldiering -7."));
}

TEST_F(SumsOfBo, TellCommittedGamesThatWereDeleted) {
  Delete(2);
  EXPECT_EQ(Sums().DeletedCommitted, (GameSums{1, 50}));
  EXPECT_THAT(Texts(), ElementsAre(HasSubstr(": games 2"), HasSubstr(": 1, soldiering 100."),
                                   HasSubstr("deleted here; the lifetime figures still count them: games 1, "
                                             "soldiering 50.")));
}

TEST_F(SumsOfBo, TellGamesOfWhichNothingIsKept) {
  SetLifetime(12, 900);
  EXPECT_THAT(Texts().back(), HasSubstr("not kept here under this member: 10."));
}

TEST_F(SumsOfBo, TellMoreCommittedGamesThanWereCounted) {
  SetLifetime(1, 100);
  EXPECT_THAT(Texts().back(), HasSubstr("lifetime figures do not count: 1."));
}

TEST_F(SumsOfBo, TellScoresThatChangedAfterTheCommit) {
  SetLifetime(2, 170);
  EXPECT_THAT(Texts().back(), HasSubstr("soldiering is different by 20:"));
}

TEST_F(SumsOfBo, SayNothingMoreOfWhoIsNoMember) {
  InMembers("DELETE FROM Members WHERE ContactID = 5");
  EXPECT_THAT(Texts(), ElementsAre(HasSubstr("not in the member table any more")));
}

TEST_F(SumsOfBo, AreReadThroughAnIndex) {
  PlannedSql sql(ArchiveSql());
  ReadLifetimeSums({}, 5, sql, MembersSql());
  EXPECT_THAT(sql.Plan(), HasSubstr("SEARCH p USING INDEX GamePlayersByMember (MemberID=?)"));
  EXPECT_THAT(sql.Plan(), Not(HasSubstr("SCAN")));
}

}  // namespace
