#pragma once

#include <chrono>
#include <condition_variable>
#include <mutex>

namespace sim {

/// What a device records on its own thread, for others to read and wait for.
template <class Traffic>
class TrafficRecord {
 public:
  Traffic Copy() const {
    const std::scoped_lock lock(mutex_);
    return traffic_;
  }

  /// Calls `look` with the record and returns what it returns, for records that are too large to copy each
  /// time.
  template <class Look>
  auto Ask(Look look) const {
    const std::scoped_lock lock(mutex_);
    return look(traffic_);
  }

  /// Calls `change` with the record, and wakes all who wait.
  template <class Change>
  void Note(Change change) {
    {
      const std::scoped_lock lock(mutex_);
      change(traffic_);
    }
    changed_.notify_all();
  }

  /// Waits until `condition` holds for the record; false when `limit` passes first.
  template <class Condition>
  bool WaitUntil(std::chrono::milliseconds limit, Condition condition) const {
    std::unique_lock lock(mutex_);
    return changed_.wait_for(lock, limit, [&] { return condition(traffic_); });
  }

 private:
  mutable std::mutex mutex_;
  mutable std::condition_variable changed_;
  Traffic traffic_{};
};

}  // namespace sim
