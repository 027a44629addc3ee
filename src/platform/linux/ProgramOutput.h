#pragma once

#include <chrono>
#include <functional>
#include <string>
#include <vector>

/// What a program that was run to its end has written.
struct ProgramOutput {
  std::string Text;
  std::string Errors;  ///< at its standard error; a part of it if that is long
  bool Succeeded = false;
};

/// Runs the program `words[0]` with the other words as arguments, without input, and waits for its end.
/// `keepOn` is asked every few milliseconds; false ends the program, whose output is then empty. Throws
/// RuntimeError 53 when it cannot be started, 68 when it has not ended after `patience`.
ProgramOutput RunToEnd(const std::vector<std::string>& words, std::chrono::milliseconds patience,
                       const std::function<bool()>& keepOn);
