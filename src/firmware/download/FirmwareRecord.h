#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "core/line/Transcript.h"
#include "platform/Clock.h"
#include "platform/Files.h"
#include "platform/MonotonicClock.h"

/// The record of one download, for support: the file, every answer other than the good one, the first and the
/// last 64 KB of the transcript, and how it ended. The last ten are kept, "firmware-2026-11-21-201500.log" in
/// the folder of the logs. A record never makes a download fail.
class FirmwareRecord {
 public:
  static constexpr std::size_t KeptBytes = 65536;   ///< of the transcript's start, and as many of its end
  static constexpr std::size_t MostAnswers = 1000;  ///< told one by one; noise can bring any number

  /// What it is written with; all must outlive the record.
  struct Parts {
    Files& Disk;
    std::string Folder;  ///< of the logs; created when needed, but not its parent
    const MonotonicClock& Elapsed;
    const Clock& Time;
  };

  /// `contents` says what was in the file: its size and its checksum.
  FirmwareRecord(const Parts& parts, const std::string& fileName, const std::string& contents);

  void Sent(std::uint8_t byte);
  void Received(std::uint8_t byte);

  /// Notes an answer other than the good one, and what it answers: "page 3".
  void BadAnswer(std::string_view toWhat, char answer);

  /// Writes the record, unless nothing came or went over the line.
  void Write(std::string_view end);

 private:
  void Keep(const std::string& rows);
  std::string Text(std::string_view end);

  const Parts parts_;
  std::string head_;     ///< what the record says of the file
  std::string answers_;  ///< rows of the answers that were not good
  std::size_t answerCount_ = 0;
  std::string first_;  ///< rows of the transcript
  std::string last_;
  std::uint64_t leftOut_ = 0;  ///< bytes of rows between these two
  bool isEmpty_ = true;
  Transcript transcript_;
};
