#pragma once

#include <cstdint>
#include <string>

#include "core/data/IniReader.h"
#include "platform/SerialDevices.h"

/// The serial port chosen in the settings. Each call rereads them, so a number that was just saved takes
/// effect.
class CommPortSetting {
 public:
  /// Both must outlive this object.
  CommPortSetting(const IniReader& ini, const SerialDevices& devices) : ini_(ini), devices_(devices) {}

  /// Key "commport" of section "comm"; 1 if it is missing. Throws RuntimeError 13 for a text that is empty or
  /// not a number, 6 for a number beyond 16 bits.
  std::int16_t Number() const;

  /// Path of the device assigned to port `number`, whether or not it exists. Throws RuntimeError 8002 if
  /// there is none.
  std::string DeviceOf(std::int16_t number) const;

  /// The device of the port number in the settings. Throws as the two functions above.
  std::string Device() const { return DeviceOf(Number()); }

 private:
  const IniReader& ini_;
  const SerialDevices& devices_;
};
