#pragma once

#include <atomic>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <utility>
#include <vector>

#include "sim/line/FileDescriptor.h"
#include "sim/line/LineSettings.h"

namespace sim {

/// How fast bytes pass a line: as its baud rate has it, or as fast as the machine can.
enum class Pace { AsWired, Fast };

/// A device's end of a serial line, 10 bits a byte. The other end is a slave device that a client opens by
/// its path; the client may close and open it again without the line breaking. One thread uses it; only
/// Interrupt may be called from another.
///
/// Bytes of a client whose settings are none of those understood never arrive. A real line would turn them
/// into noise; silence has the advantage that no noise can happen to be a request or an answer, so that such
/// a client fails always and in the same way. The settings are looked at when the bytes are taken, so a
/// client must not change them before its bytes have had their time on the line. The terminal begins with the
/// first settings understood: a client that sets none finds those, or what the client before it has left.
class PseudoTerminal {
 public:
  /// A device that understands 8 data bits without parity at `baud`. Throws std::system_error when the system
  /// grants no pseudo terminal.
  PseudoTerminal(int baud, Pace pace);
  /// A device that understands each of `understood` (one at least) and answers as it was spoken to; the first
  /// until then. Throws like the other.
  PseudoTerminal(std::vector<LineSettings> understood, Pace pace);

  using Clock = std::chrono::steady_clock;

  const std::string& SlavePath() const { return slavePath_; }

  /// From now on the device understands `baud` alone, without parity, and bytes pass at that.
  void SetBaud(int baud) { SetUnderstood({{.Baud = baud}}); }
  /// As SetBaud, with each of `understood`; bytes pass at the first until the client has spoken.
  void SetUnderstood(std::vector<LineSettings> understood);
  const std::vector<LineSettings>& Understood() const { return understood_; }
  /// Those understood ones at which the client has spoken last; the first of them until it has.
  const LineSettings& Current() const { return current_; }

  /// `begin`: a run of bytes at these settings of the host begins.
  using ForeignBytes =
      std::function<void(const LineSettings& host, std::span<const std::uint8_t> bytes, bool begin)>;
  /// `told` is called with bytes that did not arrive for their settings' sake.
  void OnForeignBytes(ForeignBytes told) { onForeignBytes_ = std::move(told); }

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
  bool Understands(std::span<const std::uint8_t> bytes);
  bool WaitFor(short events, std::optional<std::chrono::nanoseconds> timeout);
  std::size_t WriteAtOnce(std::span<const std::uint8_t> bytes);

  FileDescriptor master_;
  FileDescriptor slave_;
  FileDescriptor wakeReader_;
  FileDescriptor wakeWriter_;
  std::string slavePath_;
  std::vector<LineSettings> understood_;
  LineSettings current_;
  std::optional<LineSettings> foreign_;  // settings of the latest bytes, when they were not understood
  ForeignBytes onForeignBytes_;
  Pace pace_;
  Clock::time_point inputFree_;
  std::deque<Arrival> arrivals_;
  std::atomic<bool> interrupted_ = false;
};

}  // namespace sim
