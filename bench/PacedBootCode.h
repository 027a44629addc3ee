#pragma once

#include <atomic>
#include <chrono>
#include <cstddef>
#include <string>
#include <thread>

/// The boot code of a device on a pseudo terminal, in a thread of its own. It takes bytes no faster than a
/// line of 19,200 baud would bring them, and answers each command well.
class PacedBootCode {
 public:
  /// `lineBytes` is the size of each buffer of a QVM file; 0 for a device that takes QVM2 files.
  explicit PacedBootCode(std::size_t lineBytes);
  ~PacedBootCode();
  PacedBootCode(const PacedBootCode&) = delete;
  PacedBootCode& operator=(const PacedBootCode&) = delete;

  const std::string& DevicePath() const { return path_; }

  void Announce();

  /// Seconds that the conversation so far takes on the wire, answers and their times included.
  double ToldSeconds() const;

  static constexpr std::chrono::milliseconds AnswerTime{1};

 private:
  void Run(const std::atomic<bool>& stop);
  std::size_t SizeOf(char command) const;
  char AnswerTo(char command) const;
  void Send(const std::string& text);

  const std::size_t lineBytes_;
  int master_ = -1;
  std::string path_;
  std::atomic<std::size_t> bytes_{0};  ///< in both directions
  std::atomic<std::size_t> answers_{0};
  std::atomic<bool> stop_{false};
  std::thread thread_;
};
