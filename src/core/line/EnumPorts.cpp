#include "core/line/EnumPorts.h"

#include <algorithm>
#include <cstddef>
#include <string_view>

#include "core/text/NumberForms.h"
#include "platform/Letters.h"

namespace {

/// n from a key "com<n>", in plain decimal digits; 0 for any other key.
std::int16_t PortOfKey(const std::string& key) {
  constexpr std::string_view form = Keys::PortDevice.Key;
  constexpr std::string_view prefix = form.substr(0, form.find('<'));
  const std::string_view start = std::string_view(key).substr(0, prefix.size());
  const bool named = std::equal(start.begin(), start.end(), prefix.begin(), prefix.end(),
                                [](char letter, char of) { return LowerAscii(letter) == of; });
  if (!named || key.size() == prefix.size() || key[prefix.size()] == '0') {
    return 0;
  }
  return NumberOfDigits(std::string_view(key).substr(prefix.size())).value_or(0);
}

}  // namespace

EnumPorts::EnumPorts(const IniReader& ini, const SerialDevices& devices)
    : devices_(devices), found_(devices.Names()) {
  for (const auto& [key, device] : ini.ReadSection(Keys::PortDevice.Section)) {
    named_.try_emplace(PortOfKey(key), device);
  }
  named_.erase(0);
}

bool EnumPorts::PortExists(std::int16_t number) const {
  const std::string device = DeviceOf(number);
  return !device.empty() && devices_.Exists(device);
}

std::string EnumPorts::DeviceOf(std::int16_t number) const {
  if (const auto named = named_.find(number); named != named_.end()) {
    return named->second;
  }
  const auto index = static_cast<std::size_t>(number) - 1;
  return number >= 1 && index < found_.size() ? found_[index] : std::string();
}
