#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "core/data/IniReader.h"
#include "platform/SerialDevices.h"

/// Maps serial port numbers to devices: port n is the device named by key "com<n>" of section "ports" or,
/// without such a key, the machine's n-th port. The section and the list of ports are read only once, so
/// create an object for each use.
class EnumPorts {
 public:
  /// `devices` must outlive this object.
  EnumPorts(const IniReader& ini, const SerialDevices& devices);

  /// True if port `number` has a device that exists.
  bool PortExists(std::int16_t number) const;

  /// Path of the device, whether or not it exists; empty if port `number` has none.
  std::string DeviceOf(std::int16_t number) const;

 private:
  const SerialDevices& devices_;
  std::map<std::int16_t, std::string> named_;
  std::vector<std::string> found_;
};
