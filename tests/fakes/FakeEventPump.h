#pragma once

#include <algorithm>
#include <chrono>
#include <functional>
#include <map>
#include <stdexcept>
#include <utility>
#include <vector>

#include "platform/EventPump.h"
#include "platform/MonotonicClock.h"

/// Event pump, timers and clock in one: a wait of a minute takes no real time. Time stands still while code
/// runs, and passes in waits, in pauses and in blocking calls (Pass).
class FakeEventPump : public EventPump, public MonotonicClock {
 public:
  using Time = std::chrono::milliseconds;

  /// All pauses so far.
  std::vector<Time> Sleeps;

  /// Called at the start of each pause, with its length.
  std::function<void(Time)> OnSleep;

  /// Schedules an event: a timer's tick, arriving bytes, a button pressed in the middle of a wait. Events of
  /// one instant run in the order in which they were scheduled. May be called by an event.
  void At(Time delay, std::function<void()> event) { events_.emplace(now_ + delay, std::move(event)); }

  /// Time since the start, in whole milliseconds.
  Time Now() const { return std::chrono::floor<Time>(now_); }

  std::chrono::microseconds Elapsed() const override { return now_; }

  /// Lets time pass as in a blocking call: no events are processed.
  void Pass(std::chrono::microseconds time) { now_ += time; }

  /// Number of waits and long pauses that are on the stack.
  int Depth() const { return depth_; }

  void EndWaits() override { ended_ = true; }

  void DoEvents() override {
    // Whatever these events schedule is left for the next call, even if it is due at once.
    std::vector<std::function<void()>> due;
    while (!events_.empty() && events_.begin()->first <= now_) {
      due.push_back(TakeNext());
    }
    for (const auto& event : due) {
      event();
    }
  }

  WaitResult WaitFor(const std::function<bool()>& condition, Time limit) override {
    const bool endless = limit > std::chrono::floor<Time>(Instant::max() - now_);
    const Instant deadline = endless ? Instant::max() : now_ + limit;
    const OnStack onStack(depth_);
    while (true) {
      if (ended_) {
        return WaitResult::Ended;
      }
      if (condition()) {
        return WaitResult::Met;
      }
      if (events_.empty() || events_.begin()->first > deadline) {
        if (endless) {
          throw std::logic_error("An endless wait, and no event that could end it");
        }
        now_ = std::max(now_, deadline);
        return WaitResult::TimedOut;
      }
      TakeNext()();
    }
  }

  void Sleep(Time time) override {
    Sleeps.push_back(time);
    if (const auto onSleep = OnSleep) {
      onSleep(time);
    }
    if (time > Time(50)) {
      WaitFor([] { return false; }, time);
    } else {
      now_ += time;
    }
  }

 private:
  using Instant = std::chrono::microseconds;

  class OnStack {
   public:
    explicit OnStack(int& depth) : depth_(depth) { ++depth_; }
    ~OnStack() { --depth_; }
    OnStack(const OnStack&) = delete;
    OnStack& operator=(const OnStack&) = delete;

   private:
    int& depth_;
  };

  std::function<void()> TakeNext() {
    const auto next = events_.begin();
    now_ = std::max(now_, next->first);
    std::function<void()> event = std::move(next->second);
    events_.erase(next);
    return event;
  }

  Instant now_{0};
  int depth_ = 0;
  bool ended_ = false;
  std::multimap<Instant, std::function<void()>> events_;
};
