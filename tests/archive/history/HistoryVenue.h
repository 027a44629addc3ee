#pragma once

#include <functional>
#include <string>

#include "tests/archive/ArchiveVenue.h"

/// Passes statements on; tells how the database answers the last query.
class PlannedSql : public Sql {
 public:
  explicit PlannedSql(Sql& sql) : sql_(sql) {}

  void Query(const std::string& statement, const SqlValues& values,
             const std::function<void(const SqlRow& row)>& act) override {
    statement_ = statement;
    values_ = values;
    sql_.Query(statement, values, act);
  }
  std::int64_t Change(const std::string& statement, const SqlValues& values) override {
    return sql_.Change(statement, values);
  }
  std::int64_t Insert(const std::string& statement, const SqlValues& values) override {
    return sql_.Insert(statement, values);
  }

  /// A line for each step.
  std::string Plan() {
    std::string plan;
    sql_.Query("EXPLAIN QUERY PLAN " + statement_, values_,
               [&plan](const SqlRow& row) { plan += row.Text(3) + "\n"; });
    return plan;
  }

 private:
  Sql& sql_;
  std::string statement_;
  SqlValues values_;
};

/// An archive in which Bo (5) plays on Blue 7 and Cy (6) on Yellow 3.
class HistoryVenue : public ArchiveVenue {
 public:
  static constexpr const char* CysButton = "CC00000000000001";

  HistoryVenue() {
    Player& yellow = Game.Players(Yellow3);
    yellow.Active = true;
    yellow.MemberIndex = 6;
    yellow.DallasID = CysButton;
    yellow.Soldiering = 40;
  }

  /// Keeps a game in which Bo has this soldiering.
  std::int64_t Keep(const std::string& played, int soldiering, bool committed = true) {
    Game.Players(Blue7).Soldiering = soldiering;
    Game.Players(Blue7).Committed = committed;
    return Archive->Keep(State(played));
  }

  void Delete(std::int64_t game) const {
    InArchive("UPDATE Games SET Deleted = '2027-01-01 00:00:00' WHERE GameID = " + std::to_string(game));
  }

  /// Bo's lifetime figures.
  void SetLifetime(int games, int soldiering) const {
    InMembers("UPDATE Members SET TotalGamesPlayed = " + std::to_string(games) +
              ", TotalSoldiering = " + std::to_string(soldiering) + " WHERE ContactID = 5");
  }

  Sql& ArchiveSql() const { return ArchiveDatabase->Statements(); }
  Sql& MembersSql() const { return MembersDatabase->Statements(); }
};
