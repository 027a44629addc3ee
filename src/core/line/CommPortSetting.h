#pragma once

#include <cstdint>
#include <string>

#include "core/data/IniReader.h"
#include "platform/SerialDevices.h"

/// The serial port that the settings choose. Read anew by each call, so that a number saved a moment ago
/// counts.
class CommPortSetting {
 public:
  /// Both must outlive this object.
  CommPortSetting(const IniReader& ini, const SerialDevices& devices) : ini_(ini), devices_(devices) {}

  /// Key "commport" of section "comm", 1 without it. Throws RuntimeError 13 for a text that is no number, an
  /// empty one too, and 6 for one beyond 16 bits.
  std::int16_t Number() const;

  /// Path of the device that port `number` stands for, whether it exists or not. Throws RuntimeError 8002
  /// when it stands for none.
  std::string DeviceOf(std::int16_t number) const;

  /// The device of the number in the settings. Throws as both of the above.
  std::string Device() const { return DeviceOf(Number()); }

 private:
  const IniReader& ini_;
  const SerialDevices& devices_;
};
