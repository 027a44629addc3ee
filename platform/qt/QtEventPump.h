#pragma once

#include <QTimer>

#include "platform/EventPump.h"

/// Waits on the toolkit's event loop, asleep in the operating system until an event comes. Needs a
/// QCoreApplication.
class QtEventPump : public EventPump {
 public:
  QtEventPump();

  void DoEvents() override;
  WaitResult WaitFor(const std::function<bool()>& condition, std::chrono::milliseconds limit) override;
  void Sleep(std::chrono::milliseconds time) override;

  /// The program closes: all present and later waits return Ended, unless their condition holds.
  void EndWaits() override { ended_ = true; }

  /// True while a wait, a long pause or DoEvents is on the stack, and with it the routine that waits.
  bool Waiting() const { return depth_ > 0; }

  /// Called from the event loop once the last wait and the routines around it have unwound. A routine that
  /// waits again at once is not interrupted: the call then comes after that wait.
  std::function<void()> OnIdle;

 private:
  class OnStack;

  int depth_ = 0;
  bool ended_ = false;
  QTimer idle_;
};
