#pragma once

#include "platform/EventPump.h"

/// Waits on the toolkit's event loop, asleep in the operating system until an event comes. Needs a
/// QCoreApplication.
class QtEventPump : public EventPump {
 public:
  void DoEvents() override;
  WaitResult WaitFor(const std::function<bool()>& condition, std::chrono::milliseconds limit) override;
  void Sleep(std::chrono::milliseconds time) override;
  void EndWaits() override { ended_ = true; }

 private:
  bool ended_ = false;
};
