#pragma once

#include "platform/SerialDevices.h"

/// Natural order of names, comparing runs of digits as numbers: "ttyS2" before "ttyS10".
bool NaturalLess(const std::string& left, const std::string& right);

class QtSerialDevices : public SerialDevices {
 public:
  std::vector<std::string> Names() const override;

  /// Follows links, such as those under /dev/serial/by-id.
  bool Exists(const std::string& device) const override;
};
