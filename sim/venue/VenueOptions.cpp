#include "sim/venue/VenueOptions.h"

#include <algorithm>
#include <stdexcept>
#include <utility>
#include <variant>

#include "sim/venue/CommandLine.h"

namespace sim {
namespace {

DeviceOptions Untold(const DeviceEntry& entry) {
  DeviceOptions options;
  options.Served = entry.ServedUnlessTold;
  for (const DeviceOption& own : entry.Options) {
    if (const auto* number = std::get_if<NumberValue>(&own.Kind)) {
      options.Numbers.emplace(own.Name, number->Default);
    } else if (std::holds_alternative<ChoiceValue>(own.Kind)) {
      options.Numbers.emplace(own.Name, 0);
    }
  }
  return options;
}

bool IsSpelled(const CommandLineOption& option, const std::string& argument) {
  return std::find(option.Spellings.begin(), option.Spellings.end(), argument) != option.Spellings.end();
}

bool ServesNothing(const VenueOptions& options) {
  return std::none_of(options.Devices.begin(), options.Devices.end(),
                      [](const auto& device) { return device.second.Served; });
}

}  // namespace

const DeviceOptions& VenueOptions::Of(std::string_view device) const {
  const auto found = Devices.find(device);
  if (found == Devices.end()) {
    throw std::out_of_range("no device " + std::string(device));
  }
  return found->second;
}

VenueOptions ParseVenueOptions(const std::vector<std::string>& arguments,
                               const std::vector<DeviceEntry>& devices) {
  VenueOptions options;
  std::vector<CommandLineOption> known = GeneralOptions();
  for (const DeviceEntry& entry : devices) {
    options.Devices.emplace(entry.Name, Untold(entry));
    std::vector<CommandLineOption> own = OptionsOf(entry);
    std::move(own.begin(), own.end(), std::back_inserter(known));
  }
  for (auto argument = arguments.begin(); argument != arguments.end(); ++argument) {
    const std::string& spelling = *argument;
    const auto option = std::find_if(known.begin(), known.end(), [&](const CommandLineOption& candidate) {
      return IsSpelled(candidate, spelling);
    });
    if (option == known.end()) {
      throw std::invalid_argument("There is no option \"" + spelling + "\"");
    }
    if (option->Value.empty()) {
      option->Take(options, spelling, {});
    } else if (++argument == arguments.end()) {
      throw std::invalid_argument(spelling + " wants a value");
    } else {
      option->Take(options, spelling, *argument);
    }
  }
  if (ServesNothing(options) && !options.Help) {
    throw std::invalid_argument("There is no device to serve");
  }
  return options;
}

}  // namespace sim
