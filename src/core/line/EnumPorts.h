#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "core/data/IniReader.h"
#include "platform/SerialDevices.h"

/// Serial port numbers: n stands for the device that key "com<n>" of section "ports" names, and without such
/// a key for the n-th of the machine's ports. The section and the list of ports are read once: make a new one
/// at the moment of use.
class EnumPorts {
 public:
  /// `devices` must outlive this object.
  EnumPorts(const IniReader& ini, const SerialDevices& devices);

  /// True when port `number` stands for a device that exists.
  bool PortExists(std::int16_t number) const;

  /// Path of the device, whether it exists or not; empty when `number` stands for none.
  std::string DeviceOf(std::int16_t number) const;

 private:
  const SerialDevices& devices_;
  std::map<std::int16_t, std::string> named_;
  std::vector<std::string> found_;
};
