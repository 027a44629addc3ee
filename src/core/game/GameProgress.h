#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "core/game/Session.h"
#include "platform/Clock.h"

/// A mission that was chosen while a game was on the board.
struct MissionChange {
  std::string From;
  std::string To;
  int Rescored = 0;  ///< players whose score is another now
};

/// How many of the players who are members have been committed.
struct CommitCount {
  int Done = 0;
  int Of = 0;
};

/// The steps after a game.
enum class GameStep { Results, Print, Commit, Save, Clear };
inline constexpr int GameStepCount = 5;

/// A number that changes with anything that a game file holds and a calculation does not work out by itself.
/// Without `commits` the marks of committed players do not count.
std::uint64_t InputsDigest(const Game& game, const std::string& missionName, bool commits = true);

/// Counts the players who are members, or were when they were committed.
CommitCount CountCommits(const Game& game);

/// The records of members who have more than one gun, in ascending order, each member's together.
std::vector<std::vector<int>> SharedMembers(const Game& game);

/// Follows the game on a session's board: what was done with it since it came in. Listeners that subscribe
/// later find it up to date.
class GameProgress {
 public:
  /// Both must outlive this object, and the session must be open.
  GameProgress(Session& session, const Clock& time);

  /// True if the game on the board differs from the file that it was last loaded from or saved to.
  bool Unsaved() const;
  /// True if there is such a file.
  bool HasFile() const { return hasFile_; }
  /// When the game came in, "YYYY-MM-DD HH:MM:SS"; for one that is still to come, now.
  std::string Received() const;
  /// The last choice of a mission that changed the scores, until the game is cleared.
  const std::optional<MissionChange>& Mission() const { return mission_; }
  /// True if the places on the board begin with the lowest score.
  bool LowestFirst() const { return lowestFirst_; }

  /// True if the step has been taken for the game as it is now.
  bool IsDone(GameStep step) const;
  /// The operator has entered the mission's results.
  void ResultsEntered() { resultsEntered_ = true; }
  /// The sheets of the game as it is now have been made.
  void Printed();

 private:
  using Scores = std::array<std::int32_t, PlayerCount>;

  void Hear(SessionChange change);
  void HearMission();
  void HearScores();
  /// A new game begins.
  void Reset();
  Scores ScoresNow() const;
  std::uint64_t Digest(bool commits) const;

  Session& session_;
  const Clock& time_;
  std::string missionName_;  ///< the active one
  /// A choice whose scores are still to come.
  struct PendingChange {
    std::string From;
    Scores Before;
  };
  std::optional<PendingChange> pending_;
  std::optional<MissionChange> mission_;
  bool lowestFirst_ = false;
  bool hasFile_ = false;
  bool loading_ = false;  ///< the scores of a loaded game are still to come
  std::uint64_t inFile_ = 0;
  std::optional<std::uint64_t> printed_;
  bool resultsEntered_ = false;
  bool cleared_ = false;  ///< a game was cleared, and none has come since
  std::string gameDate_;  ///< as the game told it when `received_` was taken
  std::string received_;
  Subscription subscription_;
};
