#include "firmware/pic24f/PortNames.h"

#include <string_view>

#include "core/text/NumberForms.h"

std::string DeviceOfPort(const std::string& port, const CommPortSetting& setting) {
  constexpr std::string_view prefix = "COM";
  if (!port.starts_with(prefix) || !IsNumeric(port.substr(prefix.size()))) {
    return port;
  }
  return setting.DeviceOf(ToInt16(port.substr(prefix.size())));
}
