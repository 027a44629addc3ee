#pragma once

#include <functional>
#include <string>
#include <vector>

#include "sim/venue/DeviceEntry.h"
#include "sim/venue/VenueOptions.h"

namespace sim {

/// An option of the program, for its parser and its help.
struct CommandLineOption {
  std::vector<std::string> Spellings;  ///< the first is the one for the help
  std::string Value;                   ///< empty for one that stands alone
  std::string Meaning;
  /// `spelling`: the one that was used. Throws std::invalid_argument with a text for the user.
  std::function<void(VenueOptions& options, const std::string& spelling, const std::string& value)> Take;
};

/// Those that concern the whole venue.
std::vector<CommandLineOption> GeneralOptions();

/// Those of one device, as its entry has them.
std::vector<CommandLineOption> OptionsOf(const DeviceEntry& entry);

}  // namespace sim
