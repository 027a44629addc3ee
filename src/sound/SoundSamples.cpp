#include "sound/SoundSamples.h"

#include <algorithm>

#include "platform/RuntimeError.h"
#include "sound/WaveCheck.h"

namespace {

/// A play list may name anything, even megabytes without a line's end.
void ThrowIfTooLong(const std::string& path) {
  constexpr std::size_t longestPath = 4095;
  if (path.size() > longestPath) {
    throw RuntimeError(Fault::PathAccess);
  }
}

}  // namespace

std::int64_t RawSize(const Files& disk, const std::string& path) {
  ThrowIfTooLong(path);
  return static_cast<std::int64_t>(disk.FileLen(path));
}

std::vector<std::uint8_t> ReadSamples(const Files& disk, const std::string& path, std::size_t most) {
  if (path.empty()) {
    throw RuntimeError(Fault::FileNotFound);
  }
  ThrowIfTooLong(path);
  std::uint64_t start = 0;
  if (IsWave(path)) {
    const WaveCheck check = CheckWave(disk, path);
    if (check.Error == WaveError::CannotOpen) {
      disk.ReadPart(path, 0, 1);  // says why, with its number
    }
    if (check.Error != WaveError::None) {
      throw RuntimeError(Fault::InvalidFileFormat, std::string(TextOf(check.Error)) + " " + path);
    }
    start = check.DataOffset;
    most = std::min<std::size_t>(most, check.DataLength);
  }
  const std::string bytes = disk.ReadPart(path, start, most);
  return {bytes.begin(), bytes.end()};
}
