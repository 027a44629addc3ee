#pragma once

#include <cstdint>
#include <string>

#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "sound/WaveCheck.h"

/// The wave file that was opened last, as far as a window keeps it. The file itself is not held.
class WaveFile {
 public:
  /// Both must outlive this object.
  WaveFile(const Files& files, MessageBoxes& boxes) : files_(files), boxes_(boxes) {}

  /// Checks a wave file and takes its place and size of samples. Returns false, after a box, if it is not in
  /// the chip's format; also, without a box, for an empty path. A failure leaves the size 0, and the offset
  /// of the last good file.
  bool WaveOpenFile(const std::string& path);

  /// Bytes of samples that the file declares.
  std::uint32_t ReadSize() const { return bytesAvailable_; }
  std::uint64_t DataOffset() const { return dataOffset_; }
  /// Of the last WaveOpenFile.
  WaveError LastError() const { return lastError_; }

 private:
  const Files& files_;
  MessageBoxes& boxes_;
  std::uint64_t dataOffset_ = 0;
  std::uint32_t bytesAvailable_ = 0;
  WaveError lastError_ = WaveError::None;
};

/// Shows what is wrong with a sound file.
void ShowWaveError(MessageBoxes& boxes, WaveError error);
