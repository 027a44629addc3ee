#pragma once

#include <string>
#include <vector>

/// The machine's serial devices.
class SerialDevices {
 public:
  virtual ~SerialDevices() = default;

  /// Paths of the real serial ports, in natural order of their names (ttyS2 before ttyS10).
  virtual std::vector<std::string> Names() const = 0;

  /// True when the device at path `device` exists.
  virtual bool Exists(const std::string& device) const = 0;
};
