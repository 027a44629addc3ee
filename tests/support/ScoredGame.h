#pragma once

#include <sqlite3.h>

#include <functional>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "core/game/BoardTexts.h"
#include "core/game/Game.h"
#include "core/game/MemberLookup.h"
#include "core/game/MissionList.h"
#include "core/game/ScoreAnalysis.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/TemporaryFolder.h"

/// Runs SQL on the file at `path`, which is created if missing.
inline void ExecuteSql(const std::string& path, const std::string& sql) {
  sqlite3* handle = nullptr;
  sqlite3_open(path.c_str(), &handle);
  char* message = nullptr;
  sqlite3_exec(handle, sql.c_str(), nullptr, nullptr, &message);
  const std::string fault = message != nullptr ? message : "";
  sqlite3_free(message);
  sqlite3_close(handle);
  if (!fault.empty()) {
    throw std::runtime_error(fault);
  }
}

/// A game with real databases: no mission and no member until a test adds them and calls Open.
class ScoredGame {
 public:
  explicit ScoredGame(Language language = Language::English) : Strings(language), game(Strings) {
    WriteFile(ScenariosFile(), MadeDatabase("scenarios", "DELETE FROM Table1; DELETE FROM sqlite_sequence"));
    WriteFile(MembersFile(), MadeDatabase("members"));
  }

  /// Adds a mission: its quoted name, then the points of the sets A, B, C (primary, secondary), respawn and
  /// heal penalty.
  void AddMission(const std::string& values) {
    ExecuteSql(ScenariosFile(),
               "INSERT INTO Table1 (MissionName, PrimaryObjectivePointsA, SecondaryObjectivePointsA, "
               "PrimaryObjectivePointsB, SecondaryObjectivePointsB, PrimaryObjectivePointsC, "
               "SecondaryObjectivePointsC, RespawnPenalty, HealPenalty) VALUES (" +
                   values + ")");
  }

  std::string ScenariosFile() const { return Folder / "scenarios.mdb"; }
  std::string MembersFile() const { return Folder / "members.mdb"; }

  /// Opens both tables as start-up does.
  void Open() {
    dbScenarios_ = engine_.OpenDatabase(ScenariosFile());
    RsScenarios = dbScenarios_->OpenRecordset("Table1");
    dbMembers_ = engine_.OpenDatabase(MembersFile());
    RsMembers = dbMembers_->OpenRecordset("Members");
    Missions = std::make_unique<MissionList>(*RsScenarios, Strings, Boxes);
    Missions->FillMissionList();
    Members = std::make_unique<MemberLookup>(*RsMembers, Boxes);
    analysis_ = std::make_unique<ScoreAnalysis>(game, Factors, *Missions, *Members, Board, Teams);
  }

  Database& DbMembers() { return *dbMembers_; }

  void CalculateScores() {
    if (!analysis_) {
      Open();
    }
    const ReadScope scope(*dbMembers_);
    analysis_->CalculateScores();
  }

  Player& Activate(int index) {
    game.Players(index).Active = true;
    return game.Players(index);
  }

  /// Cells of one column of the board, in display order.
  std::vector<std::string> Column(BoardColumn column) const {
    std::vector<std::string> cells;
    cells.reserve(static_cast<std::size_t>(Board.RowCount()));
    for (int place = 0; place < Board.RowCount(); ++place) {
      cells.push_back(Texts.Cell(Board.RowAt(place), column));
    }
    return cells;
  }

  std::vector<std::vector<std::string>> BoardCells() const { return CellsOf(Board, BoardColumnCount); }
  std::vector<std::vector<std::string>> TeamCells() const { return CellsOf(Teams, TeamColumnCount); }

  std::string Cell(std::size_t row, BoardColumn column) const {
    return Texts.Cell(Board.RowAt(static_cast<int>(row)), column);
  }

  TemporaryFolder Folder;

 private:
  std::vector<std::vector<std::string>> CellsOf(const ::Board& list, int columns) const {
    std::vector<std::vector<std::string>> cells;
    for (int place = 0; place < list.RowCount(); ++place) {
      std::vector<std::string>& row = cells.emplace_back();
      for (int column = 0; column < columns; ++column) {
        row.push_back(Texts.Cell(list.RowAt(place), static_cast<BoardColumn>(column)));
      }
    }
    return cells;
  }

  static void Call(const std::function<void()>& function) {
    if (function) {
      function();
    }
  }

  SqliteEngine engine_;
  std::unique_ptr<Database> dbScenarios_;
  std::unique_ptr<Database> dbMembers_;
  std::unique_ptr<ScoreAnalysis> analysis_;

 public:
  StringTable Strings;
  FakeMessageBoxes Boxes;
  Game game;
  SoldieringFactors Factors;
  BoardTexts Texts{game, Strings};
  std::function<void()> BoardChanged;
  std::function<void()> TeamsChanged;
  ::Board Board{[this] { Call(BoardChanged); }};
  ::Board Teams{[this] { Call(TeamsChanged); }};
  std::unique_ptr<Recordset> RsScenarios;
  std::unique_ptr<Recordset> RsMembers;
  std::unique_ptr<MissionList> Missions;
  std::unique_ptr<MemberLookup> Members;
};
