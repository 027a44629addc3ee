#pragma once

#include <chrono>
#include <cstdint>
#include <deque>
#include <optional>
#include <span>
#include <utility>

#include "sim/line/PseudoTerminal.h"

namespace sim {

/// What the host sends, with the pauses before it. Bytes that turn out to begin something new can be put
/// back.
class RecorderInput {
 public:
  using Clock = PseudoTerminal::Clock;

  explicit RecorderInput(PseudoTerminal& line) : line_(line) {}

  /// None after `limit` (if given) or the end of the line.
  std::optional<std::uint8_t> Read(std::optional<std::chrono::nanoseconds> limit = std::nullopt) {
    isReadAgain_ = !again_.empty();
    std::optional<std::uint8_t> byte;
    if (isReadAgain_) {
      byte = again_.front();
      again_.pop_front();
    } else {
      byte = line_.ReadByte(limit);
    }
    if (byte) {
      const Clock::time_point now = Clock::now();
      gap_ = now - std::exchange(latest_, now);
    }
    return byte;
  }

  /// Puts `bytes` before all that is still to be read.
  void PutBack(std::span<const std::uint8_t> bytes) {
    again_.insert(again_.begin(), bytes.begin(), bytes.end());
  }
  /// True if the latest byte had been put back, so that the pause before it means nothing.
  bool IsReadAgain() const { return isReadAgain_; }

  /// To be called when an answer is through: the pause before the next byte begins there.
  void NoteAnswer() { latest_ = Clock::now(); }
  /// The pause before the latest byte, its own time on the line included.
  std::chrono::nanoseconds Gap() const { return gap_; }
  /// When the latest byte or answer was through.
  Clock::time_point Latest() const { return latest_; }

 private:
  PseudoTerminal& line_;
  std::deque<std::uint8_t> again_;
  bool isReadAgain_ = false;
  Clock::time_point latest_;
  std::chrono::nanoseconds gap_{};
};

}  // namespace sim
