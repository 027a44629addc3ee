#pragma once

#include <string>

/// Keeps the computer from going to sleep while a long job runs, where the desktop allows it.
class WakeLock {
 public:
  virtual ~WakeLock() = default;

  /// The computer stays awake from now on. `reason` is what the desktop shows its user ("Firmware download").
  /// Never fails and never blocks: where nothing can be asked, nothing happens.
  virtual void Hold(const std::string& reason) = 0;

  /// Ends a hold. Holds nest: the computer may sleep again after as many releases.
  virtual void Release() = 0;
};

/// Keeps the computer awake as long as it exists.
class StayAwake {
 public:
  StayAwake(WakeLock& lock, const std::string& reason) : lock_(lock) { lock_.Hold(reason); }
  ~StayAwake() { lock_.Release(); }
  StayAwake(const StayAwake&) = delete;
  StayAwake& operator=(const StayAwake&) = delete;

 private:
  WakeLock& lock_;
};
