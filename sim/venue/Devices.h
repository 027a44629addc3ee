#pragma once

#include <vector>

#include "sim/venue/DeviceEntry.h"

namespace sim {

DeviceEntry BaseUnitEntry();
DeviceEntry BootCodeEntry();
DeviceEntry BoxEntry();
DeviceEntry OneWireEntry();
DeviceEntry RadioEntry();

/// All devices of the venue, in output order.
const std::vector<DeviceEntry>& Devices();

}  // namespace sim
