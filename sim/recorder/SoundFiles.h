#pragma once

#include <filesystem>

#include "sim/recorder/SoundChip.h"

namespace sim {

/// Keeps recordings as files that can be listened to, in folders "recording-1", "recording-2" and so on, of
/// which none that exists is touched. In each
///
/// * "sound-000.wav" and so on: the sounds by number, 8-bit mono, 22,050 samples per second,
/// * of a gun also "pages.wav", all pages in one, and "table.bin", the 256 bytes of the table as they came.
class SoundFiles {
 public:
  /// Creates `folder` if it is missing. Throws std::filesystem::filesystem_error.
  explicit SoundFiles(std::filesystem::path folder);

  /// Returns the new recording's folder. Throws std::system_error.
  std::filesystem::path Keep(const SoundChip& chip) const;

 private:
  std::filesystem::path folder_;
};

}  // namespace sim
