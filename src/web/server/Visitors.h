#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <map>
#include <string>

/// Counts the addresses that asked for something within the last minute. It keeps at most MostVisitors of
/// them; more are not counted.
class Visitors {
 public:
  using Time = std::chrono::steady_clock::time_point;

  static constexpr std::chrono::seconds Remembered{60};

  void Note(const std::string& address, Time now);

  bool Any() const { return !seen_.empty(); }

  /// Forgets those whose minute is over.
  std::uint32_t Count(Time now);

 private:
  std::map<std::string, Time> seen_;
};
