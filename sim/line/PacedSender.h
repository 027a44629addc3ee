#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <vector>

#include "sim/line/PseudoTerminal.h"

namespace sim {

/// Bytes that go over a line in one piece.
struct LinePiece {
  std::vector<std::uint8_t> Bytes;
  bool Torn = false;            ///< in bursts of one to three bytes with pauses between them
  bool LineEndsBehind = false;  ///< the line is pulled out after the last byte
};

/// Sends pieces one after the other at a line's pace while its owner goes on reading: the owner calls SendDue
/// whenever UntilDue has elapsed. A late byte does not delay the ones after it.
class PacedSender {
 public:
  using Clock = PseudoTerminal::Clock;

  /// `onSent` is called with each piece once all of it has been sent.
  PacedSender(PseudoTerminal& line, std::function<void(const LinePiece&)> onSent);

  /// Pieces are sent in order of `ready`, and none earlier; those with equal times, in the order of adding.
  void Add(Clock::time_point ready, LinePiece piece);

  /// How long until SendDue has something to do, at least 0; none if there is nothing left to send.
  std::optional<std::chrono::nanoseconds> UntilDue() const;

  void SendDue();

 private:
  void Begin(Clock::time_point ready, LinePiece piece);
  void SendByte();

  PseudoTerminal& line_;
  std::function<void(const LinePiece&)> onSent_;
  std::multimap<Clock::time_point, LinePiece> waiting_;
  LinePiece piece_;  // being sent while `sent_` is less than its size
  std::size_t sent_ = 0;
  Clock::time_point due_;  // when its next byte is due; after the last, when the line became free
};

}  // namespace sim
