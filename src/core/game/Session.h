#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "core/data/Backups.h"
#include "core/game/Board.h"
#include "core/game/CalculationReads.h"
#include "core/game/CommitGame.h"
#include "core/game/Game.h"
#include "core/game/Listeners.h"
#include "core/game/MemberLookup.h"
#include "core/game/MissionList.h"
#include "core/game/ScoreAnalysis.h"
#include "core/game/SoldieringFactors.h"
#include "core/text/StringTable.h"
#include "platform/Clock.h"
#include "platform/Database.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "platform/OldDatabases.h"

/// What has just happened in a session.
enum class SessionChange {
  PlayerRows,  ///< the list of players has other rows, or another order
  TeamRows,    ///< the list of teams has
  Scores,      ///< a calculation is complete: figures, places and both lists
  Cleared,     ///< the game was emptied; a load begins so too
  Loaded,      ///< a file's game is in its place; its scores come next
  Saved,       ///< the game was written to a file
  Committed,   ///< the game was added to its members' totals, as far as that went
  Missions,    ///< the list of missions was read anew; the choice of the first one comes next
  Mission,     ///< a mission was chosen, maybe the same again
  MissionRow,  ///< its row was looked for: MissionIsActive and MissionDescription hold for it
};

/// A run of the program as far as it is about games: the one on the board, what its scores depend on, both
/// lists, and the open databases. Whoever shows something of it listens; there may be any number of them.
///
/// Until Open has succeeded, and after Close, only Game, Factors, List, ClearPlayerData and SortByHeader may
/// be used.
class Session {
 public:
  /// What opening works with; all but the folders outlives the session.
  struct Sources {
    DatabaseEngine& Engine;
    OldDatabases& Old;
    Files& Disk;
    std::string UserDataFolder;
    std::string ProgramFolder;
  };

  /// Fills `game`, once the mission's name is known calls `chooseMission` with it, and returns true; or
  /// returns false when there was no game to read.
  using MissionChoice = std::function<void(const std::string& missionName)>;
  using GameReader = std::function<bool(::Game& game, const MissionChoice& chooseMission)>;

  /// Keeps a game that was played in a mission; false when it did not.
  using GameWriter = std::function<bool(const ::Game& game, const std::string& missionName)>;

  Session(const StringTable& strings, const Clock& time, MessageBoxes& boxes);
  Session(const Session&) = delete;
  Session& operator=(const Session&) = delete;

  /// Has `listener` called after each change, until the handle ends.
  Subscription Listen(std::function<void(SessionChange)> listener);

  /// Opens both databases, as OpenUserDatabase does, and reads the missions. Returns false when the operator
  /// chose to end the program.
  bool Open(const Sources& sources);
  void Close();

  /// What the operator should know of a backup copy that could not be made; empty for nothing new.
  std::string TakeBackupFailure();

  ::Game& Game() { return game_; }
  SoldieringFactors& Factors() { return factors_; }
  const Board& List(BoardList list) const { return list == BoardList::Players ? players_ : teams_; }
  MissionList& Missions() { return *missions_; }
  MemberLookup& Members() { return *members_; }
  Database& DbScenarios() { return *dbScenarios_; }
  Recordset& RsScenarios() { return *rsScenarios_; }
  Database& DbMembers() { return *dbMembers_; }
  Recordset& RsMembers() { return *rsMembers_; }

  /// Throws as ScoreAnalysis::CalculateScores does; the lists are then empty, and Scores is not told. Nor is
  /// it told by a calculation that a command in one of its boxes has overtaken. While a box is open, other
  /// programs can write both databases.
  void CalculateScores();
  /// Does so when there is a game and the databases are open.
  void CalculateScoresWhenPresent();
  void ClearPlayerData();
  /// The answer to a click on column header `header` (counted from 1) of the players.
  void SortByHeader(int header);

  /// Reads the missions anew and makes "None" the active one. A failure to read them leaves list and active
  /// mission as they were.
  void FillMissionList();
  /// Makes entry `index` of the missions the active one. A mission whose row is gone is told in a box.
  void SelectMission(int index);
  /// True when the active entry is a mission whose row was there when it was chosen.
  bool MissionIsActive() const { return missionIsActive_; }
  /// First line of that mission's description; empty without one.
  const std::string& MissionDescription() const { return missionDescription_; }

  /// Empties the game and has `read` fill it. A failure of it is passed on; what it read so far stays,
  /// without scores.
  void LoadGame(const GameReader& read);
  void SaveGame(const GameWriter& write);
  CommitResult CommitGame();

 private:
  void ChooseMission(const std::string& name);

  const StringTable& strings_;
  const Clock& time_;
  MessageBoxes& boxes_;
  Listeners<SessionChange> listeners_;
  ::Game game_;
  SoldieringFactors factors_;
  Board players_{[this] { listeners_.Tell(SessionChange::PlayerRows); }};
  Board teams_{[this] { listeners_.Tell(SessionChange::TeamRows); }};
  bool missionIsActive_ = false;
  std::string missionDescription_;
  UnlockingBoxes unlockingBoxes_{boxes_};

  // In the order in which Open makes them.
  std::optional<Backups> backups_;
  std::unique_ptr<Database> dbScenarios_;
  std::unique_ptr<Recordset> rsScenarios_;
  std::optional<MissionList> missions_;
  std::unique_ptr<Database> dbMembers_;
  std::unique_ptr<Recordset> rsMembers_;
  std::optional<MemberLookup> members_;
  std::optional<ScoreAnalysis> analysis_;
};
