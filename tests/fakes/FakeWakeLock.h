#pragma once

#include <string>
#include <vector>

#include "platform/WakeLock.h"

/// Records who keeps the computer awake.
class FakeWakeLock : public WakeLock {
 public:
  /// The reason of each hold so far.
  std::vector<std::string> Reasons;

  /// Holds that were not released yet.
  int Held = 0;

  void Hold(const std::string& reason) override {
    Reasons.push_back(reason);
    ++Held;
  }

  void Release() override { --Held; }
};
