#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "platform/Files.h"

/// A log that keeps the latest rows: two files of a limited size in one folder, NAME.log and, with what came
/// before, NAME.1.log. A log never makes anything fail: rows that cannot be written are dropped.
class LogRing {
 public:
  static constexpr std::uint64_t FreeBytesKept = 32U << 20U;  ///< disk space that a log leaves free

  /// `files` must outlive this object. `mostBytes` is the size of each file. The folder, but not its parent,
  /// is created when there is something to write.
  LogRing(Files& files, std::string folder, const std::string& name, std::uint64_t mostBytes);

  /// Appends rows, each with its line end.
  void Append(const std::string& rows);

 private:
  void Write(const std::string& rows);

  Files& files_;
  std::string folder_;
  std::string path_;
  std::string olderPath_;
  std::uint64_t mostBytes_;
  std::optional<std::uint64_t> size_;  ///< of the newer file, once known
};
