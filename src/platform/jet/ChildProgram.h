#pragma once

#include <chrono>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

/// How a child program ended.
struct ChildEnd {
  bool Succeeded = false;  ///< it exited with status 0
  bool TimedOut = false;   ///< it was silent for too long and was killed
  std::string Error;       ///< first line of what it wrote to standard error
};

/// Runs a program to its end and passes its standard output to `onOutput` piece by piece. The program is
/// killed when it writes nothing for `silence`, or when `onOutput` throws; that exception is passed on.
/// Throws RuntimeError 53 if it cannot be started.
ChildEnd RunChild(const std::string& program, const std::vector<std::string>& arguments,
                  std::chrono::milliseconds silence, const std::function<void(std::string_view)>& onOutput);
