#pragma once

#include <cstdint>
#include <string>

/// Where this user's data and the program's own files are. Paths have no trailing separator.
class Folders {
 public:
  virtual ~Folders() = default;

  static constexpr std::uint32_t Found = 0;
  static constexpr std::uint32_t DoesNotExist = 1;
  static constexpr std::uint32_t InvalidFolderId = 0x80070057;

  /// The per-user application data folder, created if missing. Returns Found and sets `path`, or returns the
  /// reason for failure.
  virtual std::uint32_t LocalAppData(std::string& path) const = 0;

  /// The folder that holds the default data files.
  virtual std::string Program() const = 0;
};
