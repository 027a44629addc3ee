#include "sound/WaveFile.h"

bool WaveFile::WaveOpenFile(const std::string& path) {
  bytesAvailable_ = 0;
  lastError_ = WaveError::None;
  if (path.empty()) {
    return false;
  }
  const WaveCheck check = CheckWave(files_, path);
  lastError_ = check.Error;
  if (check.Error != WaveError::None) {
    ShowWaveError(boxes_, check.Error);
    return false;
  }
  dataOffset_ = check.DataOffset;
  bytesAvailable_ = check.DataLength;
  return true;
}

void ShowWaveError(MessageBoxes& boxes, WaveError error) {
  boxes.Show("Sound File Format error: " + std::string(TextOf(error)), DefaultBoxTitle, BoxIcon::None);
}
