#pragma once

#include <array>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <string>
#include <string_view>

#include "core/data/LogRing.h"
#include "platform/MonotonicClock.h"

/// The traffic on one instrument's line, in rows: seconds since the start of the program, the instrument,
/// "->" for bytes to the host or "<-" for bytes from it, the bytes in hexadecimal, and in some rows a note;
/// "--" marks rows without bytes. The simulated venue writes the same rows, so the two logs can be compared
/// side by side. The time is that of the row's last byte.
///
/// A row holds up to 64 bytes of one direction that follow each other within 5 ms. Rows wait in memory until
/// the conversation ends or they exceed 16 KB.
class Transcript {
 public:
  static constexpr std::chrono::milliseconds RowGap{5};
  static constexpr std::size_t RowBytes = 64;
  static constexpr std::uint64_t FileBytes = 2U << 20U;

  /// What happens to a conversation that repeats one of the last four byte for byte. Polling a reader gives
  /// the same one ten times a second, or cycles through as many as a walk along its bus has steps.
  enum class Repeats { Written, Counted };

  /// `time` must outlive this object. `write` takes the rows, each with its line end.
  Transcript(std::function<void(const std::string& rows)> write, std::string instrument,
             const MonotonicClock& time, Repeats repeats);
  Transcript(const LogRing& ring, std::string instrument, const MonotonicClock& time, Repeats repeats);
  /// Writes what is left.
  ~Transcript();
  Transcript(const Transcript&) = delete;
  Transcript& operator=(const Transcript&) = delete;

  void ToHost(std::uint8_t byte) { Add('>', byte); }
  void FromHost(std::uint8_t byte) { Add('<', byte); }

  /// Ends the row of bytes, with a note after them. Does nothing if there are none.
  void EndRow(std::string_view note = {});

  /// Adds a row without bytes. `detail` follows the note but is ignored when looking for repeats.
  void Note(std::string_view note, std::string_view detail = {});

  /// Ends the conversation: writes or counts it.
  void End();

 private:
  // Inline, so that it is next to its caller's code: bytes come so slowly that both have left the processor's
  // cache in between.
  void Add(char direction, std::uint8_t byte) {
    const auto now = time_.Elapsed();
    if (direction != rowDirection_ || rowSize_ == RowBytes || now - rowTime_ > RowGap) {
      BeginRow(direction);
    }
    row_[rowSize_++] = byte;
    rowTime_ = now;
  }
  void BeginRow(char direction);
  std::string RowStart(std::chrono::microseconds time, std::string_view direction) const;
  void FinishRow(std::string_view note, std::string_view detail = {});
  /// A row that says how often the last conversations were repeated; empty if they were not.
  std::string RepeatsRow();
  void Write();

  const MonotonicClock& time_;
  std::chrono::microseconds rowTime_{0};
  char rowDirection_ = 0;
  std::uint8_t rowSize_ = 0;
  std::array<std::uint8_t, RowBytes> row_{};

  const Repeats repeats_;
  const std::function<void(const std::string& rows)> write_;
  const std::string instrument_;
  std::string rows_;                  ///< not written yet
  std::string passed_;                ///< the present conversation without its times
  std::deque<std::string> previous_;  ///< the last ones
  bool isWhole_ = true;               ///< nothing of the present one was written yet
  int repeatCount_ = 0;
  std::chrono::microseconds repeatTime_{0};
};
