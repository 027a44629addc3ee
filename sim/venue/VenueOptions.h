#pragma once

#include <chrono>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "sim/venue/DeviceOptions.h"
#include "sim/venue/Devices.h"

namespace sim {

/// What the command line of the simulated venue asks for.
struct VenueOptions {
  int Players = 40;  ///< 0 to 224
  std::uint32_t Seed = 1;
  std::chrono::seconds Evening{0};  ///< a new game each time they have passed; 0: one game
  bool Fast = false;
  std::optional<std::string> LogFile;
  bool UntilEof = false;
  bool Help = false;
  /// By the names of their entries; every device of the table is listed, served or not.
  std::map<std::string, DeviceOptions, std::less<>> Devices;

  /// Throws std::out_of_range if the table has no device of that name.
  const DeviceOptions& Of(std::string_view device) const;
};

/// Reads `arguments` (without the program's name). Throws std::invalid_argument with a text for the user.
VenueOptions ParseVenueOptions(const std::vector<std::string>& arguments,
                               const std::vector<DeviceEntry>& devices = Devices());

}  // namespace sim
