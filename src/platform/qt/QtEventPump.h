#pragma once

#include "platform/EventPump.h"
#include "platform/MonotonicClock.h"

/// Waits in the toolkit's event loop, asleep in the operating system until an event arrives. Also the
/// monotonic clock. Needs a QCoreApplication.
class QtEventPump : public EventPump, public MonotonicClock {
 public:
  void DoEvents() override;
  WaitResult WaitFor(const std::function<bool()>& condition, std::chrono::milliseconds limit) override;
  void Sleep(std::chrono::milliseconds time) override;
  void EndWaits() override { ended_ = true; }

  /// Time since this object was created.
  std::chrono::microseconds Elapsed() const override {
    return std::chrono::duration_cast<std::chrono::microseconds>(std::chrono::steady_clock::now() - start_);
  }

 private:
  const std::chrono::steady_clock::time_point start_ = std::chrono::steady_clock::now();
  bool ended_ = false;
};
