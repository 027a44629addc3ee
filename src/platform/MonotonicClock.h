#pragma once

#include <chrono>

/// A clock for time stamps and estimates of time left. It cannot be set and never goes back.
class MonotonicClock {
 public:
  virtual ~MonotonicClock() = default;

  /// Time since a fixed moment near the start of the program.
  virtual std::chrono::microseconds Elapsed() const = 0;
};
