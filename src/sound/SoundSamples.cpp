#include "sound/SoundSamples.h"

#include <algorithm>

#include "platform/RuntimeError.h"
#include "sound/WaveCheck.h"

std::vector<std::uint8_t> ReadSamples(const Files& disk, const std::string& path, std::size_t most) {
  if (path.empty()) {
    throw RuntimeError(Fault::FileNotFound);
  }
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
