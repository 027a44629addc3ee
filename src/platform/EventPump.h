#pragma once

#include <chrono>
#include <functional>

enum class WaitResult {
  Met,       ///< the condition holds
  TimedOut,  ///< the limit passed first
  Ended      ///< the program is closing: give up silently
};

/// How the program's only thread waits: events (timers, painting, input, serial data) are processed
/// meanwhile, and an idle wait uses no processor time.
class EventPump {
 public:
  virtual ~EventPump() = default;

  /// Processes the events that are pending now.
  virtual void DoEvents() = 0;

  /// Processes events until `condition` is true or `limit` has passed. The condition is tested first, and
  /// again after each batch of events; it must depend on something that an event changes. Waits nest: an
  /// outer one resumes when the inner one has returned.
  virtual WaitResult WaitFor(const std::function<bool()>& condition, std::chrono::milliseconds limit) = 0;

  /// Pauses. Up to 50 ms the thread just sleeps; a longer pause processes events and ends early if the
  /// program closes.
  virtual void Sleep(std::chrono::milliseconds time) = 0;

  /// The program is closing: all current and later waits return Ended, whatever their condition.
  virtual void EndWaits() = 0;
};
