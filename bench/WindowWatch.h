#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>

#include "platform/linux/ChildProcess.h"

/// The program itself in a process of its own, with its results page on and its window watched.
class WindowWatch {
 public:
  /// `program` is bench-watched-window; `folder` an empty one for its data.
  WindowWatch(const std::string& program, const std::string& folder);

  /// Where its pages are answered; 0 if it did not come up.
  std::uint16_t Port() const { return port_; }

  /// The longest time in milliseconds for which an event of the window had to wait while `work` ran; throws
  /// std::runtime_error when the window is gone.
  double LongestDelay(const std::function<void()>& work);

 private:
  /// The number in the next line that it tells; throws std::runtime_error when none comes.
  double NextNumber();
  double Ask();

  Pipe orders_;
  Pipe answers_;
  std::uint16_t port_ = 0;
  std::unique_ptr<ChildProcess> process_;
};
