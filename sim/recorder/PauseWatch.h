#pragma once

#include <array>
#include <chrono>
#include <cstddef>
#include <optional>
#include <string>

namespace sim {

/// The pauses that a host must leave. InData is that of a whole block: 255 times 1 ms.
enum class RecorderPause {
  InCommand,
  BeforePageCount,
  InPageCount,
  BeforePage,
  InData,
  BeforeCheckByte,
  BetweenSounds,
};

/// Tells when a host leaves out pauses. On a busy machine the recorder may be late to see a byte and then
/// finds the pause behind it too short, so a short pause or two prove nothing: a fault is told once at
/// least three of a kind, and more than half of those seen, are shorter than three quarters of what is due.
class PauseWatch {
 public:
  /// Returns the fault, worded to follow "the host ", when this pause reveals it; once for each kind.
  std::optional<std::string> See(RecorderPause pause, std::chrono::nanoseconds length);

  /// What is due.
  static std::chrono::milliseconds Due(RecorderPause pause);

 private:
  struct Count {
    std::size_t Seen = 0;
    std::size_t Short = 0;
    bool Told = false;
  };

  std::array<Count, 7> counts_;
};

}  // namespace sim
