#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "platform/Files.h"

/// A log that keeps the latest rows: two files of a limited size in one folder, NAME.log and, with what came
/// before, NAME.1.log. A log is never a reason to fail: rows that cannot be written are dropped.
class LogRing {
 public:
  static constexpr std::uint64_t FreeBytesKept = 32U << 20U;  ///< what a log leaves of the disk

  /// `files` must outlive this object. `mostBytes` is the size of each file. The folder is made when there is
  /// something to write, but not the one above it.
  LogRing(Files& files, std::string folder, const std::string& name, std::uint64_t mostBytes);

  /// Adds rows, each with its line end.
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
