#pragma once

#include <chrono>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

/// How a child program ended.
struct ChildEnd {
  bool Succeeded = false;  ///< it ended by itself with 0
  bool TimedOut = false;   ///< it was silent for too long and was ended
  std::string Error;       ///< first line of what it wrote to standard error
};

/// Runs a program to its end and hands its standard output over piece by piece. It is ended when it writes
/// nothing for `silence`, or when `onOutput` throws, which is passed on. Throws RuntimeError 53 when it
/// cannot be started.
ChildEnd RunChild(const std::string& program, const std::vector<std::string>& arguments,
                  std::chrono::milliseconds silence, const std::function<void(std::string_view)>& onOutput);
