#include "core/line/EnumPorts.h"

#include <algorithm>
#include <charconv>
#include <cstddef>

#include "core/text/TextEncoding.h"

namespace {

/// n of a key "com<n>" in plain decimal, 0 when the key is none.
int PortOfKey(const std::string& key) {
  constexpr std::size_t PrefixLength = 3;
  std::string prefix = key.substr(0, PrefixLength);
  std::transform(prefix.begin(), prefix.end(), prefix.begin(), LowerAscii);
  if (prefix != "com" || key.size() == PrefixLength || key[PrefixLength] == '0') {
    return 0;
  }
  int number = 0;
  const char* const end = key.data() + key.size();
  const auto parsed = std::from_chars(key.data() + PrefixLength, end, number);
  return parsed.ec == std::errc() && parsed.ptr == end && number > 0 ? number : 0;
}

}  // namespace

EnumPorts::EnumPorts(const IniReader& ini, const SerialDevices& devices)
    : devices_(devices), found_(devices.Names()) {
  for (const auto& [key, device] : ini.ReadSection("ports")) {
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
