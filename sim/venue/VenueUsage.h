#pragma once

#include <string>
#include <vector>

#include "sim/venue/Devices.h"

namespace sim {

/// The text of `--help`.
std::string VenueUsage(const std::vector<DeviceEntry>& devices = Devices());

}  // namespace sim
