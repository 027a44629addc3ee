#pragma once

#include <sys/resource.h>

#include <string>
#include <utility>
#include <vector>

#include "platform/SerialDevices.h"

/// Time spent on a job on a real serial line, in seconds.
struct Spent {
  double Wall;
  double Processor;
};

/// Processor time of `who` (RUSAGE_SELF or RUSAGE_THREAD), in seconds.
inline double ProcessorSeconds(int who) {
  rusage usage{};
  getrusage(who, &usage);
  return static_cast<double>(usage.ru_utime.tv_sec + usage.ru_stime.tv_sec) +
         static_cast<double>(usage.ru_utime.tv_usec + usage.ru_stime.tv_usec) / 1e6;
}

/// A machine with one serial port.
class OneDevice : public SerialDevices {
 public:
  explicit OneDevice(std::string device) : device_(std::move(device)) {}
  std::vector<std::string> Names() const override { return {device_}; }
  bool Exists(const std::string& device) const override { return device == device_; }

 private:
  std::string device_;
};
