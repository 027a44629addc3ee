#pragma once

#include <set>
#include <string>
#include <vector>

#include "platform/SerialDevices.h"

class FakeSerialDevices : public SerialDevices {
 public:
  /// The machine's ports, all of which exist.
  std::vector<std::string> Ports;

  /// Other devices that exist, such as links by id.
  std::set<std::string> Others;

  std::vector<std::string> Names() const override { return Ports; }

  bool Exists(const std::string& device) const override {
    for (const auto& port : Ports) {
      if (port == device) {
        return true;
      }
    }
    return Others.count(device) != 0;
  }
};
