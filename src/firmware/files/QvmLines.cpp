#include "firmware/files/QvmLines.h"

#include <utility>

#include "firmware/files/CrLfLines.h"

QvmLines::QvmLines(std::string bytes) : bytes_(std::move(bytes)) {
  CrLfLines lines(bytes_);
  while (const auto line = lines.Next()) {
    if (IsData(*line)) {
      bufferLines_.push_back(*line);
    }
  }
}
