#pragma once

#include <chrono>
#include <filesystem>
#include <string>

#include "tests/soak/kills/Work.h"

/// A falsehood that a process tells or commits on purpose, to prove that it is noticed.
enum class Lie { None, Lost, Doubled, Damaged, Crash };

/// What became of one process that worked until it was killed.
struct Life {
  enum Result {
    Fine,
    Lost,     ///< steps that it reported are gone
    Doubled,  ///< more was done than it had begun
    Damaged,  ///< what was found is no state that any number of steps leaves
    Crashed,  ///< it ended by itself
    Hung      ///< a process that it had started stayed behind
  };
  Result What = Fine;
  std::string Reason;
  int Reported = 0;     ///< its last step that it reported; `done` before it began
  int Found = 0;        ///< steps whose result was found
  bool Killed = false;  ///< in the midst of its work
};

/// Begins `work` behind step `done` in a process of its own, kills that after `time`, and looks at what it
/// left.
Life LiveAndDie(Work& work, const std::filesystem::path& folder, int done, std::chrono::microseconds time,
                Lie lie);
