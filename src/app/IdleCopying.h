#pragma once

#include <QObject>
#include <QTimer>
#include <chrono>
#include <functional>

#include "platform/MonotonicClock.h"

/// Has the archive's long work done, its weekly copy above all, step by step, while the operator leaves the
/// program alone.
class IdleCopying : public QObject {
 public:
  struct Parts {
    std::function<bool()> DoAPart;  ///< does a step; false if there is nothing more to do for now
    std::function<bool()> Busy;     ///< true while a command or a window waits for the operator
    const MonotonicClock& Elapsed;
  };

  /// The program has just started, so that there is a copy, if any, after a while.
  explicit IdleCopying(Parts parts);

  /// Does a step if nobody waits for the program, and returns how long to wait before the next call.
  std::chrono::milliseconds Look();

  /// There may be something to do, which is not to wait for the next call of its own.
  void LookSoon() { timer_.start(BetweenLooks); }

  /// The archive is about to be closed.
  void End();

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  static constexpr std::chrono::seconds BetweenLooks{1};

  const Parts parts_;
  QTimer timer_;
  std::chrono::microseconds lastInput_;
};
