#pragma once

#include <atomic>
#include <chrono>
#include <mutex>
#include <string>
#include <thread>

/// Ends the process when the event loop gives no sign of life for too long, and tells what was done last. The
/// sanitizer then prints where the main thread hangs.
class Watchdog {
 public:
  /// To be made on the main thread.
  explicit Watchdog(std::chrono::seconds patience);
  ~Watchdog();
  Watchdog(const Watchdog&) = delete;
  Watchdog& operator=(const Watchdog&) = delete;

  /// The event loop lives.
  void Beat() { beats_.fetch_add(1, std::memory_order_relaxed); }

  void NoteCommand(const std::string& command);

 private:
  void Watch();

  const std::chrono::seconds patience_;
  const pthread_t mainThread_;
  std::atomic<long> beats_{0};
  std::atomic<bool> ended_{false};
  std::mutex mutex_;
  std::string latestCommand_ = "start";
  std::thread thread_;
};
