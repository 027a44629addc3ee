#pragma once

#include <vector>

#include "sim/venue/DeviceEntry.h"

namespace sim {

DeviceEntry BaseUnitEntry();
DeviceEntry OneWireEntry();
DeviceEntry RadioEntry();

/// Every device that the venue has, in the order of its outputs.
const std::vector<DeviceEntry>& Devices();

}  // namespace sim
