#pragma once

#include <chrono>

/// Time for stamps and for time left. Nobody can set it, and it never goes back.
class MonotonicClock {
 public:
  virtual ~MonotonicClock() = default;

  /// Time since a moment of its own, near the start of the program.
  virtual std::chrono::microseconds Elapsed() const = 0;
};
