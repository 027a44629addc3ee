#pragma once

#include <atomic>
#include <chrono>
#include <cstdint>
#include <map>
#include <string>
#include <thread>
#include <vector>

/// A boot loader on a pseudo terminal that takes and gives each byte in the time of its line: it writes and
/// reads rows of program memory, and answers at once.
class PacedLoader {
 public:
  explicit PacedLoader(int baud);
  ~PacedLoader();
  PacedLoader(const PacedLoader&) = delete;
  PacedLoader& operator=(const PacedLoader&) = delete;

  const std::string& Device() const { return device_; }

  /// In both directions.
  std::size_t BytesOnTheLine() const { return bytes_; }

 private:
  void Serve();
  void Take(std::uint8_t byte);
  void Obey();
  void Send(std::vector<std::uint8_t> data);

  const std::chrono::nanoseconds timeOfByte_;
  int terminal_;
  int other_;  ///< kept open, so that the line is never hung up
  std::string device_;
  std::chrono::steady_clock::time_point idleAt_;
  std::vector<std::uint8_t> packet_;
  bool escaped_ = false;
  std::map<std::uint32_t, std::vector<std::uint8_t>> rows_;
  std::atomic<std::size_t> bytes_{0};
  std::atomic<bool> ended_{false};
  std::thread thread_;
};
