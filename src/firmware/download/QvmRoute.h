#pragma once

#include <string_view>
#include <vector>

#include "firmware/download/DownloadLine.h"
#include "firmware/download/FirmwareDisplay.h"

/// The dialect of devices that take QVM files: each line of the file is one buffer.
class QvmRoute {
 public:
  /// All must outlive this object. `stage` follows how far the transfer came.
  QvmRoute(DownloadLine& line, FirmwareDisplay& display, FirmwareStage& stage)
      : line_(line), display_(display), stage_(stage) {}

  /// From identification to the end, "F" included. Throws RuntimeError for a line that cannot be converted or
  /// sent, for a file of a single line, and if the line fails.
  DownloadStep Transfer(const std::vector<std::string_view>& bufferLines);

 private:
  DownloadStep Begin();
  DownloadStep SendLine(std::string_view digits);
  void Convert(std::string_view digits);
  DownloadStep SendBuffer();

  DownloadLine& line_;
  FirmwareDisplay& display_;
  FirmwareStage& stage_;
  std::vector<std::int16_t> lineBytes_;  ///< of the line in work
  std::size_t lineNumber_ = 0;           ///< from 1
};
