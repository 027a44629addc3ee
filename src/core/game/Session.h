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
  PlayerRows,  ///< the list of players has new rows or a new order
  TeamRows,    ///< the list of teams has
  Scores,      ///< a calculation is complete: figures, places and both lists
  Cleared,     ///< the game was cleared; also the first step of a load
  Loaded,      ///< a file's game was read in; its scores come next
  Saved,       ///< the game was written to a file
  Committed,   ///< the game was added to its members' totals, as far as that succeeded
  Missions,    ///< the list of missions was reread; the choice of its first entry comes next
  Mission,     ///< a mission was chosen, perhaps the same one again, or a choice that failed was taken back
  MissionRow,  ///< its row was looked up: MissionIsActive and MissionDescription now apply to it
};

/// The state of one run of the program: the game on the board, what its scores depend on, both lists, and the
/// open databases. Views listen for changes; there may be any number of them.
///
/// Until Open has succeeded, and after Close, only Game, Factors, List, ClearPlayerData and SortByHeader may
/// be used.
class Session {
 public:
  /// What Open works with; all but the folders must outlive the session.
  struct Sources {
    DatabaseEngine& Engine;
    OldDatabases& Old;
    Files& Disk;
    std::string UserDataFolder;
    std::string ProgramFolder;
  };

  /// Reads a game into `game`, calls `chooseMission` once the mission's name is known, and returns true.
  /// Returns false if there was no game to read.
  using MissionChoice = std::function<void(const std::string& missionName)>;
  using GameReader = std::function<bool(::Game& game, const MissionChoice& chooseMission)>;

  /// Saves a game and the name of its mission. Returns false if it did not.
  using GameWriter = std::function<bool(const ::Game& game, const std::string& missionName)>;

  Session(const StringTable& strings, const Clock& time, MessageBoxes& boxes);
  Session(const Session&) = delete;
  Session& operator=(const Session&) = delete;

  /// Called before the game is cleared.
  std::function<void()> BeforeClear;

  /// Calls `listener` after each change, until the returned handle ends.
  Subscription Listen(std::function<void(SessionChange)> listener);

  /// Opens both databases, as OpenUserDatabase does, and reads the missions. Returns false if the operator
  /// chose to end the program.
  bool Open(const Sources& sources);
  void Close();
  /// Opens both databases and their cursors anew, also after Close: for files that were changed or replaced
  /// as a whole. Every reference to them ends. The mission stays the chosen one if it still exists, else one
  /// of its name, else none; the scores of a game are calculated anew. Throws RuntimeError if one cannot be
  /// opened or read; what was open stays open then.
  void Reopen();

  /// Copies the members as they are now to the backup copies. False if it was stopped. Throws RuntimeError if
  /// it cannot.
  bool BackUpMembers(const KeepOn& keepOn);
  /// Returns the operator's message about a backup copy that failed, or an empty text if there is none.
  std::string TakeBackupFailure();
  /// True if a change was made without one, since too little of the disk is free.
  bool BackupLacksRoom() const { return backups_ && backups_->LacksRoom(); }

  ::Game& Game() { return game_; }
  SoldieringFactors& Factors() { return factors_; }
  const Board& List(BoardList list) const { return list == BoardList::Players ? players_ : teams_; }
  MissionList& Missions() { return *missions_; }
  MemberLookup& Members() { return *members_; }
  Database& DbScenarios() { return *dbScenarios_; }
  Recordset& RsScenarios() { return *rsScenarios_; }
  Database& DbMembers() { return *dbMembers_; }
  Recordset& RsMembers() { return *rsMembers_; }

  /// Throws as ScoreAnalysis::CalculateScores does, with both lists left empty. Listeners hear of Scores only
  /// when a calculation is complete, not when it fails or when a command given in one of its boxes has
  /// replaced it. While a box is open, other programs can write both databases.
  void CalculateScores();
  /// Does the same, but only if there is a game and the databases are open.
  void CalculateScoresWhenPresent();
  /// A copy of the game with its scores calculated; the board stays as it is, and no box is shown about a
  /// mission or a member that is gone. Throws as CalculateScores does.
  ::Game ScoredCopy();
  void ClearPlayerData();
  /// Sorts the players as a click on column header `header` (counted from 1) does.
  void SortByHeader(int header);

  /// Rereads the missions and makes "None" the active one. If they cannot be read, the list and the active
  /// mission stay as they were.
  void FillMissionList();
  /// Makes entry `index` of the missions the active one and recalculates. A box reports a mission whose row
  /// is gone. If the row cannot be read, the choice is taken back.
  void SelectMission(int index);
  /// True if the active entry is a mission whose row existed when it was chosen.
  bool MissionIsActive() const { return missionIsActive_; }
  /// First line of that mission's description; empty without one.
  const std::string& MissionDescription() const { return missionDescription_; }

  /// The points of the mission that the last calculation used; none if it was without a mission or a player.
  const std::optional<MissionPoints>& PointsOfMission() const { return analysis_->PointsOfMission(); }

  /// Clears the game and has `read` fill it. An exception from `read` is passed on; what it has read by then
  /// stays, without scores.
  void LoadGame(const GameReader& read);
  void SaveGame(const GameWriter& write);
  CommitResult CommitGame();

 private:
  /// Opens one of the user's databases; null if the operator chose to end the program.
  std::unique_ptr<Database> OpenDatabase(const std::string& name, const std::string& table);
  /// The entry of `missions` that stands for the one chosen before.
  int ChosenIn(const MissionList& missions) const;
  void LookUpMission();
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

  std::optional<Sources> sources_;
  MissionList::Item chosen_{{}, 0};  ///< the mission that Close left

  // In the order in which Open creates them.
  std::optional<Backups> backups_;
  std::unique_ptr<Database> dbScenarios_;
  std::unique_ptr<Recordset> rsScenarios_;
  std::optional<MissionList> missions_;
  std::unique_ptr<Database> dbMembers_;
  std::unique_ptr<Recordset> rsMembers_;
  std::optional<MemberLookup> members_;
  std::optional<ScoreAnalysis> analysis_;
};
