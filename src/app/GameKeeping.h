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

  /// Guns are about to be read into the board.
  void BeginPull(GameSource source) { keeper_.BeginPull(source); }
  /// The operator may have changed members.
  void NoteMembers() { Do(&GameKeeper::NoteMembers); }
  /// The members may be others, all of them.
  void CheckMembers() { Do(&GameKeeper::CheckMembers); }
  const KeptState& State() const { return keeper_.State(); }

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  void Do(void (GameKeeper::*act)());

  GameKeeper keeper_;
  const std::function<bool()> pulling_;
  const std::function<void(const KeptState& state)> tell_;
  KeptState told_;
};
