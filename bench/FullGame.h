#pragma once

#include <filesystem>
#include <memory>
#include <string>

#include "core/game/BoardTexts.h"
#include "core/game/Game.h"
#include "core/game/MemberLookup.h"
#include "core/game/MissionList.h"
#include "core/game/ScoreAnalysis.h"
#include "platform/sqlite/SqliteDatabase.h"

/// The fullest game: all 224 players active, all 50,176 hits above 0.
void FillCompletely(Game& game);

/// Creates a mission file at `path` with that many missions.
void MakeMissions(const std::string& path, int missions);

/// Creates a members file at `path` with that many members, named First7 Last7; every second one has a
/// nickname like Nick7.
void MakeMembers(const std::string& path, int members);

/// Scores the fullest game with its own databases. A box is an error and ends the program.
class FullGame {
 public:
  /// `members` is the number of members in the database; every player is one of them.
  explicit FullGame(int members);
  ~FullGame();
  FullGame(const FullGame&) = delete;
  FullGame& operator=(const FullGame&) = delete;

  void CalculateScores();

  /// Makes the texts of all cells of both lists, as a screen that shows them all does; how many letters they
  /// have.
  std::size_t ShowLists() const;

  /// Makes the next calculation look up all players by their buttons.
  void Unassign();

  StringTable Strings{Language::English};
  Game game{Strings};
  std::unique_ptr<MissionList> Missions;

 private:
  class NoBoxes;

  std::filesystem::path folder_;
  std::unique_ptr<NoBoxes> boxes_;
  SqliteEngine engine_;
  std::unique_ptr<Database> dbScenarios_;
  std::unique_ptr<Database> dbMembers_;
  std::unique_ptr<Recordset> rsScenarios_;
  std::unique_ptr<Recordset> rsMembers_;
  std::unique_ptr<MemberLookup> members_;
  SoldieringFactors factors_;
  Board players_{[] {}};
  Board teams_{[] {}};
  BoardTexts texts_{game, Strings};
  std::unique_ptr<ScoreAnalysis> analysis_;
};
