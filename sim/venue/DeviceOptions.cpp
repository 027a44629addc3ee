#include "sim/venue/DeviceOptions.h"

#include <stdexcept>

namespace sim {

std::uint64_t DeviceOptions::Number(std::string_view option) const {
  const auto found = Numbers.find(option);
  if (found == Numbers.end()) {
    throw std::out_of_range("no option " + std::string(option));
  }
  return found->second;
}

std::optional<std::string> DeviceOptions::File(std::string_view option) const {
  const auto found = Files.find(option);
  return found == Files.end() ? std::nullopt : std::optional(found->second);
}

}  // namespace sim
