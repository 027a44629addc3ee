#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

/// A pseudo terminal whose far end takes and answers bytes at the rate of a serial line, in a thread of its
/// own.
class PacedTerminal {
 public:
  using Clock = std::chrono::steady_clock;

  /// Takes a byte from the host once it is in, and gives the answers to it.
  using Device = std::function<std::vector<std::uint8_t>(std::uint8_t)>;

  /// `delay` is what the device takes for a byte before it begins to answer.
  PacedTerminal(int baud, std::chrono::microseconds delay, Device device);
  ~PacedTerminal();
  PacedTerminal(const PacedTerminal&) = delete;
  PacedTerminal& operator=(const PacedTerminal&) = delete;

  const std::string& Path() const { return path_; }

  /// When each byte from the host was in.
  std::vector<Clock::time_point> Arrivals() const;

 private:
  void Run(const std::stop_token& stop);
  void Answer(const std::vector<std::uint8_t>& bytes, Clock::time_point from);

  const std::chrono::nanoseconds byteTime_;
  const std::chrono::microseconds delay_;
  const Device device_;
  int descriptor_ = -1;
  int hostSide_ = -1;  ///< kept open, so that the line is not hung up between two sessions
  std::string path_;
  Clock::time_point answered_;
  Clock::time_point idle_;  ///< end of the last byte from the host
  mutable std::mutex mutex_;
  std::vector<Clock::time_point> arrivals_;
  std::jthread thread_;
};
