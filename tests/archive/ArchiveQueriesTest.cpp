#include "archive/ArchiveQueries.h"

#include <gmock/gmock.h>

#include <functional>
#include <utility>

#include "tests/archive/ArchiveVenue.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

/// Passes statements on and remembers them.
class HeardSql : public Sql {
 public:
  explicit HeardSql(Sql& sql) : sql_(sql) {}

  void Query(const std::string& statement, const SqlValues& values,
             const std::function<void(const SqlRow& row)>& act) override {
    Heard.emplace_back(statement, values);
    sql_.Query(statement, values, act);
  }
  std::int64_t Change(const std::string& statement, const SqlValues& values) override {
    return sql_.Change(statement, values);
  }
  std::int64_t Insert(const std::string& statement, const SqlValues& values) override {
    return sql_.Insert(statement, values);
  }

  std::vector<std::pair<std::string, SqlValues>> Heard;

 private:
  Sql& sql_;
};

class AskedArchive : public testing::Test, protected ArchiveVenue {
 protected:
  /// Bo plays in all games, a guest on Red 0, Cy on Yellow 3 from the third on.
  AskedArchive() {
    Keep("2026-10-31 23:59:59", "None", 100);
    Keep("2026-11-01 00:00:00", "Flag", 300);
    Game.Players(Yellow3).Active = true;
    Game.Players(Yellow3).MemberIndex = 6;
    Keep("2026-11-30 20:00:00", "Flag", 200);
    Game.Players(Blue7).ShotCount = 0;
    Keep("2026-12-01 10:00:00", "None", -5);
  }

  std::int64_t Keep(const std::string& played, const std::string& mission, int soldiering) {
    Game.Players(Blue7).Soldiering = soldiering;
    GameState state = State(played);
    state.Mission = mission;
    return Archive->Keep(state);
  }

  void Delete(std::int64_t game) {
    InArchive("UPDATE Games SET Deleted = '2027-01-01 00:00:00' WHERE GameID = " + std::to_string(game));
  }

  HeardSql sql{ArchiveDatabase->Statements()};
  ArchiveQueries queries{sql};
};

TEST_F(AskedArchive, CountsTheGamesOfEachMonth) {
  const auto texts = [this] {
    std::vector<std::string> months;
    for (const MonthOfGames& month : queries.Months()) {
      months.push_back(month.Month + ":" + std::to_string(month.Games));
    }
    return months;
  };
  EXPECT_THAT(texts(), ElementsAre("2026-12:1", "2026-11:2", "2026-10:1"));
  Delete(4);
  Delete(3);
  EXPECT_THAT(texts(), ElementsAre("2026-11:1", "2026-10:1"));
}

TEST_F(AskedArchive, ListsTheLatestGamesFirst) {
  EXPECT_THAT(queries.Games({}), ElementsAre(4, 3, 2, 1));
  Keep("2026-11-30 20:00:00", "Flag", 1);
  EXPECT_THAT(queries.Games({}), ElementsAre(4, 5, 3, 2, 1));
  Delete(3);
  EXPECT_THAT(queries.Games({}), ElementsAre(4, 5, 2, 1));
}

TEST_F(AskedArchive, FindsGamesByPeriodMissionMemberAndGun) {
  EXPECT_THAT(queries.Games({.From = "2026-11", .Before = "2026-12"}), ElementsAre(3, 2));
  EXPECT_THAT(queries.Games({.From = "2026-11-30 20:00:00"}), ElementsAre(4, 3));
  EXPECT_THAT(queries.Games({.Mission = "None"}), ElementsAre(4, 1));
  EXPECT_THAT(queries.Games({.Member = 6}), ElementsAre(4, 3));
  EXPECT_THAT(queries.Games({.Player = Yellow3}), ElementsAre(4, 3));
  EXPECT_THAT(queries.Games({.Player = Red0}), ElementsAre(4, 3, 2, 1));
  EXPECT_THAT(
      queries.Games(
          {.From = "2026-11", .Before = "2026-12", .Mission = "Flag", .Member = 6, .Player = Yellow3}),
      ElementsAre(3));
  EXPECT_THAT(queries.Games({.Mission = "' OR 1 = 1 --"}), IsEmpty());
  EXPECT_THAT(queries.Games({.Member = 7}), IsEmpty());
  EXPECT_THAT(queries.Games({.Members = {6}}), ElementsAre(4, 3));
  EXPECT_THAT(queries.Games({.Mission = "None", .Members = {6, 5, 7}}), ElementsAre(4, 1));
  EXPECT_THAT(queries.Games({.Members = {7, 8}}), IsEmpty());
}

TEST_F(AskedArchive, FindsTheGamesOfMoreMembersThanAStatementTakes) {
  std::vector<std::int32_t> many;
  for (std::int32_t member = 100; member < 40'000; ++member) {
    many.push_back(member);
  }
  EXPECT_THAT(queries.Games({.Members = many}), IsEmpty());
  many.push_back(6);
  EXPECT_THAT(queries.Games({.Members = many}), ElementsAre(4, 3));
  many.insert(many.begin(), 5);
  EXPECT_THAT(queries.Games({.Mission = "None", .Members = many}), ElementsAre(4, 1));
  Delete(4);
  EXPECT_THAT(queries.Games({.Members = many}), ElementsAre(3, 2, 1));
  int steps = 0;
  EXPECT_THAT(queries.Games({.Members = many}, [&steps](double done) { return done < 0.5 && ++steps > 0; }),
              IsEmpty());
  EXPECT_GT(steps, 10);
}

TEST_F(AskedArchive, TellsAGame) {
  const std::optional<ListedGame> game = queries.Game(2);
  ASSERT_TRUE(game);
  EXPECT_EQ(game->GameId, 2);
  EXPECT_EQ(game->Played, "2026-11-01 00:00:00");
  EXPECT_EQ(game->DateText, "21.11.2026 20:15");
  EXPECT_EQ(game->Mission, "Flag");
  EXPECT_EQ(game->Players, 2);
  EXPECT_THAT(game->TeamTotals, ElementsAre(-4, 250, 0));
  EXPECT_EQ(game->BestPlayer, Blue7);
  EXPECT_EQ(game->BestMember, 5);
  EXPECT_EQ(game->BestSoldiering, 300);
  EXPECT_EQ(game->Pulls, 1);
  EXPECT_EQ(game->Committed, 1);
  EXPECT_EQ(queries.Game(77), std::nullopt);
  EXPECT_EQ(game->Deleted, "");
  EXPECT_EQ(game->EarlierStates, 0);
  Delete(2);
  EXPECT_EQ(queries.Game(2)->Deleted, "2027-01-01 00:00:00");
}

TEST_F(AskedArchive, TellsAGameWithoutPlayers) {
  Game.Clear();
  const std::int64_t empty = Archive->Keep(State());
  const std::optional<ListedGame> game = queries.Game(empty);
  ASSERT_TRUE(game);
  EXPECT_EQ(game->Players, 0);
  EXPECT_EQ(game->BestPlayer, 0);
  EXPECT_EQ(game->BestMember, 0);
}

TEST_F(AskedArchive, TellsTheGamesOfAMember) {
  const std::vector<MemberGame> games = queries.GamesOf(5);
  ASSERT_EQ(games.size(), 4U);
  EXPECT_EQ(games[0].GameId, 4);
  EXPECT_EQ(games[0].Place, 3);
  EXPECT_EQ(games[0].Players, 3);
  EXPECT_EQ(games[0].Soldiering, -5);
  EXPECT_EQ(games[0].Accuracy, std::nullopt);
  EXPECT_EQ(games[2].GameId, 2);
  EXPECT_EQ(games[2].Played, "2026-11-01 00:00:00");
  EXPECT_EQ(games[2].Mission, "Flag");
  EXPECT_EQ(games[2].Place, 1);
  EXPECT_EQ(games[2].Players, 2);
  EXPECT_EQ(games[2].Soldiering, 300);
  EXPECT_EQ(games[2].Accuracy, 0.25);
  EXPECT_EQ(games[2].Damage, 120);
  EXPECT_TRUE(games[2].Committed);
  EXPECT_FALSE(queries.GamesOf(6).at(0).Committed);
  Delete(4);
  EXPECT_EQ(queries.GamesOf(5).size(), 3U);
}

TEST_F(AskedArchive, AddsUpThePeriodOfEachMember) {
  const std::vector<MemberPeriod> all = queries.Period("", "");
  ASSERT_EQ(all.size(), 2U);
  EXPECT_EQ(all[0].Member, 5);
  EXPECT_EQ(all[0].Games, 4);
  EXPECT_EQ(all[0].SoldieringSum, 595);
  EXPECT_EQ(all[0].SoldieringBest, 300);
  EXPECT_EQ(all[0].AccuracySum, 0.75);
  EXPECT_EQ(all[0].AccuracyGames, 3);
  EXPECT_EQ(all[1].Member, 6);
  EXPECT_EQ(all[1].Games, 2);
  EXPECT_EQ(all[1].AccuracyGames, 0);
  const std::vector<MemberPeriod> november = queries.Period("2026-11", "2026-12");
  ASSERT_EQ(november.size(), 2U);
  EXPECT_EQ(november[0].SoldieringSum, 500);
  Delete(2);
  EXPECT_EQ(queries.Period("2026-11", "2026-12").at(0).SoldieringSum, 200);
}

class QueryPlans : public AskedArchive {
 protected:
  /// What the database does for the last question, a line for each step.
  std::string Plan() {
    std::string plan;
    ArchiveDatabase->Statements().Query("EXPLAIN QUERY PLAN " + sql.Heard.back().first,
                                        sql.Heard.back().second,
                                        [&plan](const SqlRow& row) { plan += row.Text(3) + "\n"; });
    return plan;
  }

  std::string PlanOf(const GameFilter& filter) {
    queries.Games(filter);
    return Plan();
  }
};

TEST_F(QueryPlans, OfTheMonthsReadOneIndexOnly) {
  queries.Months();
  EXPECT_THAT(Plan(), HasSubstr("USING COVERING INDEX GamesByPlayed"));
}

TEST_F(QueryPlans, OfAllGamesReadOneIndexInItsOrder) {
  const std::string plan = PlanOf({});
  EXPECT_THAT(plan, HasSubstr("USING COVERING INDEX GamesByPlayed"));
  EXPECT_THAT(plan, Not(HasSubstr("FOR ORDER BY")));
}

TEST_F(QueryPlans, OfMissionsAndDeletedGamesReadOneIndexOnly) {
  queries.Missions();
  EXPECT_THAT(Plan(), HasSubstr("USING COVERING INDEX GamesByMission (Mission>?)"));
  EXPECT_THAT(PlanOf({.Deleted = true}), HasSubstr("USING COVERING INDEX GamesByPlayed"));
}

TEST_F(QueryPlans, OfListsSearchAndScanNothing) {
  const std::vector<std::pair<GameFilter, std::string>> filters = {
      {{.From = "2026-11", .Before = "2026-12"}, "COVERING INDEX GamesByPlayed (Played>? AND Played<?)"},
      {{.Mission = "Flag"}, "INDEX GamesByMission (Mission=?"},
      {{.Member = 5}, "COVERING INDEX GamePlayersByMember (MemberID=?)"},
      {{.Members = {5, 6}}, "COVERING INDEX GamePlayersByMember (MemberID=?)"},
      {{.Player = 40}, "COVERING INDEX GamePlayersByGun (PlayerIndex=?)"},
      {{.From = "2026-11", .Member = 5}, "INDEX GamePlayersByMember (MemberID=?)"},
  };
  for (const auto& [filter, expected] : filters) {
    const std::string plan = PlanOf(filter);
    EXPECT_THAT(plan, HasSubstr(expected));
    EXPECT_THAT(plan, Not(HasSubstr("SCAN")));
  }
}

TEST_F(QueryPlans, OfMembersSearchAndScanNothing) {
  queries.GamesOf(5);
  EXPECT_THAT(Plan(), HasSubstr("SEARCH p USING INDEX GamePlayersByMember (MemberID=?)"));
  EXPECT_THAT(Plan(), HasSubstr("SEARCH g USING INTEGER PRIMARY KEY"));
  queries.Period("2026-11", "2026-12");
  EXPECT_THAT(Plan(), HasSubstr("SEARCH g USING COVERING INDEX GamesByPlayed (Played>? AND Played<?)"));
  EXPECT_THAT(Plan(), HasSubstr("SEARCH p USING PRIMARY KEY (GameID=?)"));
  EXPECT_THAT(Plan(), Not(HasSubstr("SCAN")));
  queries.Game(1);
  EXPECT_THAT(Plan(), Not(HasSubstr("SCAN")));
}

}  // namespace
