#pragma once

#include <cstdint>
#include <string>

/// The window in which a device is selected, and which lists the configuration bytes of the one that is
/// connected. The program has none.
class DeviceSelector {
 public:
  virtual ~DeviceSelector() = default;

  virtual void Open() = 0;
  virtual void ClearConfigBytes() = 0;
  virtual void AddConfigByte(const std::string& name, std::uint32_t address) = 0;
};
