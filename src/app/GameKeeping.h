#pragma once

#include <QObject>
#include <functional>

#include "archive/GameKeeper.h"

/// Has the game on the board kept after each of the operator's commands, whichever window they are given in.
class GameKeeping : public QObject {
 public:
  /// Not while `pulling` is true. `tell` is called when there is something else to tell.
  GameKeeping(const GameKeeper::Parts& parts, std::function<bool()> pulling,
              std::function<void(const KeptState& state)> tell);

  /// The session is about to be closed.
  void End();

  /// True if the game on the board is kept as it was at the end of the last command.
  bool IsKept() const { return !keeper_.State().KeptAt.empty() && keeper_.State().Failure.empty(); }

  /// Guns are about to be read into the board.
  void BeginPull(GameSource source) { keeper_.BeginPull(source); }
  /// A past game is being loaded; see GameKeeper::Open.
  void Open(std::int64_t gameId, std::int64_t state, const Game& game, const std::string& missionName) {
    keeper_.Open(gameId, state, game, missionName);
  }
  /// The game of a file is being loaded; see GameKeeper::Load.
  void Load(const Game& game, const std::string& missionName, const std::string& fileTime) {
    keeper_.Load(game, missionName, fileTime);
  }
  /// Removes some of what was deleted long ago; true if there may be more.
  bool RemoveDeleted();
  /// The operator may have changed members.
  void NoteMembers() { Do(&GameKeeper::NoteMembers); }
  /// The members may be others, all of them.
  void CheckMembers() { Do(&GameKeeper::CheckMembers); }
  /// Cuts the numbers of those whom the check found from some past games; true if there is more to do.
  bool CutAPart();
  /// How far that is, from 0 to 1.
  double CutDone() const { return keeper_.CutDone(); }
  /// The archive forgets these; see GameKeeper::ForgetPersons.
  void ForgetPersons(const GamePersons& persons) { keeper_.ForgetPersons(persons); }
  /// Does a step of what there is to do in the archive while nobody waits: of a check, of the removal of
  /// deleted games, of the weekly copy. False if there is nothing more to do for now.
  bool DoAPart();
  const KeptState& State() const { return keeper_.State(); }

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  void Do(void (GameKeeper::*act)());
  void TellChanges();

  GameKeeper keeper_;
  const std::function<bool()> pulling_;
  const std::function<void(const KeptState& state)> tell_;
  KeptState told_;
  bool removing_ = false;  ///< there may be more deleted games to remove
};
