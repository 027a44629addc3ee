#pragma once

#include <QTimer>
#include <functional>

class Commands;

/// A window's timer whose tick is one of its commands: a failure is reported, and a close waits for the tick
/// to end. No tick runs while a box or dialog is open in front of the window, nor within another tick; ticks
/// that fall due meanwhile are skipped.
class PollTimer : public QTimer {
 public:
  /// Owned by the window of `commands`. Not yet started.
  PollTimer(Commands& commands, int milliseconds, std::function<void()> tick);

 private:
  void Tick();

  Commands& commands_;
  std::function<void()> tick_;
  bool ticking_ = false;
};
