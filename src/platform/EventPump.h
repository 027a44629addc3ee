#pragma once

#include <chrono>
#include <functional>

enum class WaitResult {
  Met,       ///< the condition holds
  TimedOut,  ///< the limit passed first
  Ended      ///< the program is closing: give up without a word
};

/// The one thread's way to wait: events (timers, paint, input, serial data) are served meanwhile, and an idle
/// wait costs no processor time.
class EventPump {
 public:
  virtual ~EventPump() = default;

  /// Serves the events that are pending now.
  virtual void DoEvents() = 0;

  /// Serves events until `condition` holds or `limit` has passed. The condition is tested first, and again
  /// after each batch of events; it must depend on something that an event changes. Waits nest: an outer one
  /// goes on when the inner one has returned.
  virtual WaitResult WaitFor(const std::function<bool()>& condition, std::chrono::milliseconds limit) = 0;

  /// Pauses. Up to 50 ms the thread just sleeps; a longer pause serves events and ends early when the program
  /// closes.
  virtual void Sleep(std::chrono::milliseconds time) = 0;

  /// The program closes: all present and later waits return Ended, whatever their condition.
  virtual void EndWaits() = 0;
};
