#pragma once

#include <atomic>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <optional>
#include <span>
#include <string>

#include "sim/line/FileDescriptor.h"

namespace sim {

/// How fast bytes pass a line: as its baud rate has it, or as fast as the machine can.
enum class Pace { AsWired, Fast };

/// A device's end of a serial line (8 data bits, no parity, 1 stop bit, so 10 bits a byte). The other end is
/// a slave device that a client opens by its path; the client may close and open it again without the line
/// breaking. One thread uses it; only Interrupt may be called from another.
class PseudoTerminal {
 public:
  /// Throws std::system_error when the system grants no pseudo terminal.
  PseudoTerminal(int baud, Pace pace);

  using Clock = std::chrono::steady_clock;

  const std::string& SlavePath() const { return slavePath_; }

  /// Bytes pass at `baud` from now on.
  void SetBaud(int baud) { baud_ = baud; }

  /// False after an interruption or the end of the line.
  bool IsUp() const { return !interrupted_ && master_.IsOpen(); }

  /// What the line needs for `bytes` bytes; nothing when it is not paced.
  std::chrono::nanoseconds DurationOf(std::size_t bytes) const;

  /// The next byte from the client, once its last bit is through; none after `timeout` (for ever without
  /// one), an interruption or the end of the line. Bytes that the client wrote at once follow each other
  /// without a gap, however late they are asked for.
  std::optional<std::uint8_t> ReadByte(std::optional<std::chrono::nanoseconds> timeout = std::nullopt);

  /// Sends `bytes` back to back and returns when the last one is through. A byte never arrives before its
  /// last bit would, and lateness of one does not delay those behind it. Returns how many went out: fewer
  /// than all only after an interruption or the end of the line.
  std::size_t Write(std::span<const std::uint8_t> bytes);

  /// Hands `bytes` to the client at once, for callers that keep the line's pace themselves and must go on
  /// reading meanwhile. What a client that does not read has no room for is lost, as on a line without flow
  /// control. Returns how many went out.
  std::size_t Put(std::span<const std::uint8_t> bytes);

  /// As Write, but in pieces of one to three bytes with pauses between them.
  std::size_t WriteTorn(std::span<const std::uint8_t> bytes);

  /// Pulls the line out: the client sees its device vanish. The line cannot be used again.
  void HangUp();

  /// Ends the line from this side but lets the client close first. False when it has not done so within
  /// `limit`.
  bool WaitForClientToClose(std::chrono::milliseconds limit);

  /// Makes a wait that is under way, and all later ones, return at once.
  void Interrupt();

 private:
  struct Arrival {
    std::uint8_t Byte;
    Clock::time_point Through;  // when its last bit is
  };

  bool IsPaced() const { return pace_ == Pace::AsWired; }
  bool TakeArrivals();
  bool WaitFor(short events, std::optional<std::chrono::nanoseconds> timeout);
  std::size_t WriteAtOnce(std::span<const std::uint8_t> bytes);

  FileDescriptor master_;
  FileDescriptor slave_;
  FileDescriptor wakeReader_;
  FileDescriptor wakeWriter_;
  std::string slavePath_;
  int baud_;
  Pace pace_;
  Clock::time_point inputFree_;
  std::deque<Arrival> arrivals_;
  std::atomic<bool> interrupted_ = false;
};

}  // namespace sim
