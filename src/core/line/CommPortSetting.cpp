#include "core/line/CommPortSetting.h"

#include "core/line/EnumPorts.h"
#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"

std::int16_t CommPortSetting::Number() const {
  return ToInt16(ini_.ReadIni(Keys::CommPort));
}

std::string CommPortSetting::DeviceOf(std::int16_t number) const {
  std::string device = EnumPorts(ini_, devices_).DeviceOf(number);
  if (device.empty()) {
    throw RuntimeError(Fault::InvalidPortNumber);
  }
  return device;
}
