#pragma once

#include <functional>
#include <string>
#include <vector>

#include "sim/venue/DeviceEntry.h"
#include "sim/venue/VenueOptions.h"

namespace sim {

/// A command line option, for the parser and the help.
struct CommandLineOption {
  std::vector<std::string> Spellings;  ///< the help shows the first
  std::string Value;                   ///< how the help names it; empty for an option without one
  std::string Meaning;
  /// `spelling`: the one that was used. Throws std::invalid_argument with a text for the user.
  std::function<void(VenueOptions& options, const std::string& spelling, const std::string& value)> Take;
};

/// The options that concern the whole venue.
std::vector<CommandLineOption> GeneralOptions();

/// The options of one device, from its entry.
std::vector<CommandLineOption> OptionsOf(const DeviceEntry& entry);

}  // namespace sim
