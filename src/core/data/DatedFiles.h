#pragma once

#include <cstddef>
#include <string>

#include "platform/Files.h"

/// Files of one folder of which the latest are kept, each with its date in its name:
/// "members-2026-11-21-201500.mdb".
class DatedFiles {
 public:
  /// `disk` must outlive this object. `extension` with its dot.
  DatedFiles(Files& disk, std::string folder, std::string name, std::string extension, std::size_t most)
      : disk_(disk),
        folder_(std::move(folder)),
        name_(std::move(name)),
        extension_(std::move(extension)),
        most_(most) {}

  /// Name of a file of the time `now` ("YYYY-MM-DD HH:MM:SS"), without the folder.
  std::string NameAt(std::string now) const;

  /// Deletes the oldest files that are too many. `newest` stays even if the computer's clock was set back.
  /// Throws as Files::Delete does.
  void DeleteOldest(const std::string& newest) const;

 private:
  bool IsOurs(const std::string& file) const;

  Files& disk_;
  const std::string folder_;
  const std::string name_;
  const std::string extension_;
  const std::size_t most_;
};
