#pragma once

#include <chrono>
#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

/// A program of this computer that runs as long as this one wants it to, reads what this one writes, and is
/// heard. It gets nothing else: no environment, and no handle but its two pipes (its errors go nowhere).
/// Nothing here ever waits for it.
class PipedProgram {
 public:
  virtual ~PipedProgram() = default;

  /// Called while events are processed, with what the program has written.
  std::function<void(std::string_view bytes)> OnOutput;

  /// What OnEnd tells of a program that could not be started, and of one that something killed.
  static constexpr int NotStarted = 127;
  static constexpr int Killed = 128;

  /// Called while events are processed, when the program has ended by itself or could not be started.
  std::function<void(int exitCode)> OnEnd;

  /// Starts the program `words[0]`, a path, with the other words as arguments, after a pause. One that still
  /// runs or waits for its start is stopped.
  virtual void Start(const std::vector<std::string>& words, std::chrono::milliseconds pause) = 0;

  /// Passes bytes on as soon as the program reads them; without one, nothing happens.
  virtual void Write(std::string_view bytes) = 0;

  /// Bytes that it has not read yet, as far as this program keeps them.
  virtual std::size_t Unread() const = 0;

  /// Ends the program at once. No further calls of OnOutput and OnEnd.
  virtual void Stop() = 0;
};
