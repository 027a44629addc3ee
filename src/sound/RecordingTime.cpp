#include "sound/RecordingTime.h"

std::chrono::milliseconds RecordingTime(std::int64_t pages, Recorder recorder) {
  // Three pauses of 20 ms a page, and in a product four of 10 ms and one of 1 ms behind each byte; the rest
  // is the wire.
  constexpr std::int64_t inProduct = 375;
  constexpr std::int64_t standAlone = 84;
  return std::chrono::milliseconds(pages * (recorder == Recorder::StandAlone ? standAlone : inProduct));
}
