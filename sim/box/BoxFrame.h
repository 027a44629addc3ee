#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

namespace sim {

/// The ten bytes that configure a utility box: 'B', 'C', team x 16 + type, points per activation, points to
/// recharge, amount per activation, automatic time in units of 10 s, 1 if it can be destroyed, 0, 0.
using BoxFrame = std::array<std::uint8_t, 10>;

/// Why a box rejects the frame: "a team of 4"; none if every value is in its range.
std::optional<std::string> WrongIn(const BoxFrame& frame);

/// The values of a frame without faults, in words.
std::string Describe(const BoxFrame& frame);

/// Collects frames from single bytes. What comes before a frame's two letters is dropped.
class BoxFrameReader {
 public:
  /// The frame, once `byte` completes it.
  std::optional<BoxFrame> Take(std::uint8_t byte);
  /// Bytes of the frame that has begun.
  std::size_t Count() const { return count_; }
  void StartOver() { count_ = 0; }

 private:
  BoxFrame frame_{};
  std::size_t count_ = 0;
};

}  // namespace sim
