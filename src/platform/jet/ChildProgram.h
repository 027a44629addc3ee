#pragma once

#include <chrono>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

/// How a child program ended.
struct ChildEnd {
  bool Succeeded = false;  ///< it exited with status 0
  bool TimedOut = false;   ///< it was silent for too long, or wrote errors without end, and was killed
  std::string Error;       ///< first line of what it wrote to standard error
};

/// What RunChild calls meanwhile.
struct ChildListener {
  std::function<void(std::string_view)> OnOutput;  ///< each piece of its standard output
  std::function<void()> OnWait = [] {};            ///< some 20 times a second
};

/// Runs a program to its end. The program is killed when it writes nothing to standard output for `silence`,
/// or a megabyte of errors, or when the listener throws; that exception is passed on. Throws RuntimeError 53
/// if it cannot be started.
ChildEnd RunChild(const std::string& program, const std::vector<std::string>& arguments,
                  std::chrono::milliseconds silence, const ChildListener& listener);
