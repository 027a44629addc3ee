#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <vector>

#include "sim/line/PseudoTerminal.h"

namespace sim {

/// What goes over a line in one piece.
struct LinePiece {
  std::vector<std::uint8_t> Bytes;
  bool Torn = false;            ///< in pieces of one to three bytes with pauses between them
  bool LineEndsBehind = false;  ///< the line is pulled out when the last byte is through
};

/// Sends pieces one after the other at a line's pace while its owner goes on reading: the owner calls SendDue
/// whenever UntilDue has passed. Lateness of one byte does not delay those behind it.
class PacedSender {
 public:
  using Clock = PseudoTerminal::Clock;

  /// `onSent` is called with each piece that has gone out whole.
  PacedSender(PseudoTerminal& line, std::function<void(const LinePiece&)> onSent);

  /// Pieces go out in the order of `ready`, before which none begins; of equal times, in the order of adding.
  void Add(Clock::time_point ready, LinePiece piece);

  /// None when nothing is to be sent; else how long until SendDue has something to do, 0 at least.
  std::optional<std::chrono::nanoseconds> UntilDue() const;

  void SendDue();

 private:
  void Begin(Clock::time_point ready, LinePiece piece);
  void SendByte();

  PseudoTerminal& line_;
  std::function<void(const LinePiece&)> onSent_;
  std::multimap<Clock::time_point, LinePiece> waiting_;
  LinePiece piece_;  // the one that goes out, when `sent_` is less than its size
  std::size_t sent_ = 0;
  Clock::time_point due_;  // of its next byte, or when the line was last free
};

}  // namespace sim
