#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

/// Phones that hold the front page open and do what its script does: each asks for the token of the newest
/// board three seconds after it was last answered, and when that has changed loads the page, its style and
/// its script. Each keeps one connection.
class PagePhones {
 public:
  using Time = std::chrono::steady_clock::time_point;

  /// They begin one after the other, evenly over three seconds. Throws std::runtime_error when the server
  /// refuses one.
  PagePhones(std::uint16_t port, int count);
  ~PagePhones();
  PagePhones(const PagePhones&) = delete;
  PagePhones& operator=(const PagePhones&) = delete;

  /// Lets them do that for so long.
  void GoOn(std::chrono::milliseconds time);

  /// Lets them do that until each has a new page that it asked for after `since`, or the time is over.
  /// Returns the seconds from `since` of those that have, in rising order.
  std::vector<double> NewPages(Time since, std::chrono::milliseconds time);

  /// Connections that ended, and answers other than 200.
  std::size_t Failures() const { return failures_; }

 private:
  class Phone;

  void Turn(Time until);

  std::vector<std::unique_ptr<Phone>> phones_;
  std::size_t failures_ = 0;
};
