#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <ostream>
#include <vector>

#include "sim/box/BoxFailure.h"
#include "sim/box/BoxFrame.h"
#include "sim/line/Device.h"
#include "sim/line/PacedSender.h"

namespace sim {

struct UtilityBoxSettings {
  BoxFailure Failure = BoxFailure::None;
  std::size_t FailurePlace = 1;  ///< byte of a frame (1 to 10) that the failure concerns
  int Times = 0;                 ///< how many frames the failure concerns, from the first on; 0: all
  std::chrono::milliseconds Late{2500};
  Pace LinePace = Pace::AsWired;
  std::ostream* Log = nullptr;  ///< receives the traffic, and in words what the box was told
};

/// What has come and gone so far.
struct UtilityBoxTraffic {
  std::vector<BoxFrame> Frames;       ///< complete frames, good or not
  std::optional<BoxFrame> Accepted;   ///< the configuration that the box works with
  std::vector<std::uint8_t> Answers;  ///< bytes sent
};

/// A utility box on a 19200 baud line. It takes ten-byte frames and answers 0xAA if it accepts the values,
/// 0x55 if not. It reads on while an answer is due, serves any number of frames, and forgets one that breaks
/// off. A host that sends three frames in a row without pauses of 1 ms between their bytes is at fault.
class UtilityBox : public Device {
 public:
  /// Throws std::invalid_argument when the failure has no such place, std::system_error when the system
  /// grants no pseudo terminal. The log must outlive the box.
  explicit UtilityBox(UtilityBoxSettings settings);

  UtilityBoxTraffic Traffic() const { return traffic_.Copy(); }
  /// Waits until `frames` frames have come; false if `limit` passes first.
  bool WaitUntilTold(std::size_t frames, std::chrono::milliseconds limit) const;

 private:
  using Clock = PseudoTerminal::Clock;

  void Run();
  std::optional<std::chrono::nanoseconds> UntilDue() const;
  void Take(std::uint8_t byte);
  void CheckPauses();
  void BreakOff();
  void Answer(const BoxFrame& frame);
  void NoteSent(const LinePiece& piece);
  bool Strikes(BoxFailure failure) const;
  void NoteFault(const std::string& what);

  UtilityBoxSettings settings_;
  PacedSender sender_;
  BoxFrameReader reader_;
  int frames_ = 0;
  Clock::time_point latest_;        // when the latest byte was seen
  Clock::duration longestPause_{};  // between two bytes of a frame
  int hastyFrames_ = 0;             // frames without pauses that came in a row
  TrafficRecord<UtilityBoxTraffic> traffic_;
  Serving serving_{*this, [this] { Run(); }};
};

}  // namespace sim
