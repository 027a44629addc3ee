#pragma once

#include <chrono>
#include <ctime>

/// Processor time that this process has used.
inline std::chrono::microseconds ProcessorTime() {
  timespec used{};
  clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &used);
  return std::chrono::seconds(used.tv_sec) + std::chrono::microseconds(used.tv_nsec / 1000);
}
