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

/// How fast bytes travel: at the line's baud rate, or as fast as the machine can.
enum class Pace { AsWired, Fast };

/// A device's end of a serial line, 10 bits per byte. The other end is a slave device that a client opens by
/// its path; the client may close and reopen it without breaking the line. For use by one thread; only
/// Interrupt and Nudge may be called from another.
///
/// Bytes from a client whose settings are not among those understood never arrive. A real line would turn
/// them into noise; with silence, nothing can pass for a request or a reply by chance, so such a client
/// always fails, and always in the same way. The settings are checked when the bytes are taken, so a client
/// must not change them before its bytes have had their time on the line. The terminal starts with the first
/// of the understood settings: a client that sets none gets those, or whatever the client before it left.
class PseudoTerminal {
 public:
  /// A device that understands 8 data bits without parity at `baud`. Throws std::system_error when the system
  /// grants no pseudo terminal.
  PseudoTerminal(int baud, Pace pace);
  /// A device that understands each of `understood` (at least one) and answers at the settings the client
  /// last used; until then, at the first. Throws like the other.
  PseudoTerminal(std::vector<LineSettings> understood, Pace pace);

  using Clock = std::chrono::steady_clock;

  const std::string& SlavePath() const { return slavePath_; }

  /// From now on the device understands only `baud`, 8 data bits, no parity; bytes travel at that speed.
  void SetBaud(int baud) { SetUnderstood({{.Baud = baud}}); }
  /// As SetBaud, for each of `understood`; bytes travel at the first until the client sends some.
  void SetUnderstood(std::vector<LineSettings> understood);
  const std::vector<LineSettings>& Understood() const { return understood_; }
  /// The understood settings that the client last used; the first of them until it has sent something.
  const LineSettings& Current() const { return current_; }

  /// `begin`: `bytes` start a run at the settings `host`.
  using ForeignBytes =
      std::function<void(const LineSettings& host, std::span<const std::uint8_t> bytes, bool begin)>;
  /// `told` is called with bytes that were dropped because of their settings.
  void OnForeignBytes(ForeignBytes told) { onForeignBytes_ = std::move(told); }

  /// False after an interruption or the end of the line.
  bool IsUp() const { return !interrupted_ && master_.IsOpen(); }

  /// Time that `bytes` bytes take on the line; 0 if it is not paced.
  std::chrono::nanoseconds DurationOf(std::size_t bytes) const;

  /// The next byte from the client, once its last bit has arrived; none after `timeout` (if given), a nudge,
  /// an interruption or the end of the line. Bytes that the client wrote together follow each other without a
  /// gap, however late they are read.
  std::optional<std::uint8_t> ReadByte(std::optional<std::chrono::nanoseconds> timeout = std::nullopt);

  /// Sends `bytes` back to back and returns once the last one is through. No byte arrives before its last bit
  /// would, and a late byte does not delay the ones after it. Returns how many were sent: fewer than all only
  /// after an interruption or the end of the line.
  std::size_t Write(std::span<const std::uint8_t> bytes);

  /// Hands `bytes` to the client at once, for callers that keep the line's pace themselves and must go on
  /// reading meanwhile. If the client does not read, what exceeds its buffer is lost, as on a line without
  /// flow control. Returns how many were sent.
  std::size_t Put(std::span<const std::uint8_t> bytes);

  /// As Write, but in pieces of one to three bytes with pauses between them.
  std::size_t WriteTorn(std::span<const std::uint8_t> bytes);

  /// Pulls the line out: the client sees its device vanish. The line cannot be used again.
  void HangUp();

  /// Ends the line from this side but lets the client close first. False when it has not done so within
  /// `limit`.
  bool WaitForClientToClose(std::chrono::milliseconds limit);

  /// Makes the current wait and all later ones return at once.
  void Interrupt();

  /// Makes the current ReadByte, or else the next one, return at once without a byte.
  void Nudge();

 private:
  struct Arrival {
    std::uint8_t Byte;
    Clock::time_point Through;  // when its last bit has arrived
  };

  bool IsPaced() const { return pace_ == Pace::AsWired; }
  bool TakeArrivals();
  bool TakeNudge();
  bool Understands(std::span<const std::uint8_t> bytes);
  bool WaitFor(short events, std::optional<std::chrono::nanoseconds> timeout);
  std::size_t WriteAtOnce(std::span<const std::uint8_t> bytes);

  FileDescriptor master_;
  FileDescriptor slave_;
  FileDescriptor wakeReader_;
  FileDescriptor wakeWriter_;
  FileDescriptor nudges_;
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
