#pragma once

#include <array>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <string>
#include <string_view>

#include "core/data/LogRing.h"
#include "platform/MonotonicClock.h"

/// What passes the line of one instrument, a row each: seconds since the start of the program, the
/// instrument, "->" for bytes to the host or "<-" for bytes from it, the bytes in hexadecimal, and a note
/// where one is due; "--" for what is no byte. The simulated venue writes the same rows, so that both logs
/// can be laid side by side. The time is that of the row's last byte.
///
/// A row holds bytes of one direction that follow each other within 5 ms, 64 at most. Rows wait in memory
/// until the conversation ends or 16 KB are full.
class Transcript {
 public:
  static constexpr std::chrono::milliseconds RowGap{5};
  static constexpr std::size_t RowBytes = 64;
  static constexpr std::uint64_t FileBytes = 2U << 20U;

  /// What becomes of a conversation that repeats one of the last four to the byte. Polling a reader is the
  /// same ten times a second, or in turn as many as there are steps in a walk along its bus.
  enum class Repeats { Written, Counted };

  /// `time` must outlive this object.
  Transcript(const LogRing& ring, std::string instrument, const MonotonicClock& time, Repeats repeats);
  /// Writes what is left.
  ~Transcript();
  Transcript(const Transcript&) = delete;
  Transcript& operator=(const Transcript&) = delete;

  void ToHost(std::uint8_t byte) { Add('>', byte); }
  void FromHost(std::uint8_t byte) { Add('<', byte); }

  /// Ends the row of bytes, with a note behind them. Does nothing without bytes.
  void EndRow(std::string_view note = {});

  /// A row without bytes. `detail` stands behind the note but makes no difference between repeats.
  void Note(std::string_view note, std::string_view detail = {});

  /// The conversation is over: writes or counts it.
  void End();

 private:
  // Inline, so that it stands beside the code of whoever adds a byte: bytes come so slowly that the
  // processor's cache has forgotten both in between.
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
  /// Tells how often the last conversations were repeated; empty when they were not.
  std::string RepeatsRow();
  void Write();

  const MonotonicClock& time_;
  std::chrono::microseconds rowTime_{0};
  char rowDirection_ = 0;
  std::uint8_t rowSize_ = 0;
  std::array<std::uint8_t, RowBytes> row_{};

  const Repeats repeats_;
  LogRing ring_;
  const std::string instrument_;
  std::string rows_;                  ///< not written yet
  std::string passed_;                ///< the present conversation without its times
  std::deque<std::string> previous_;  ///< the last ones
  bool isWhole_ = true;               ///< nothing of the present one was written yet
  int repeatCount_ = 0;
  std::chrono::microseconds repeatTime_{0};
};
