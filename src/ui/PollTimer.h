#pragma once

#include <QTimer>
#include <functional>

class Commands;

/// A timer of a window whose tick is one of its commands: a failure is reported, and a close waits for the
/// tick's end. No tick runs while a box or dialog is open in front of the window, nor within another tick;
/// what falls due meanwhile is left out.
class PollTimer : public QTimer {
 public:
  /// Belongs to the window of `commands`. Not yet started.
  PollTimer(Commands& commands, int milliseconds, std::function<void()> tick);

 private:
  void Tick();

  Commands& commands_;
  std::function<void()> tick_;
  bool ticking_ = false;
};
