#pragma once

#include <vector>

#include "sim/venue/DeviceEntry.h"

namespace sim {

DeviceEntry BaseUnitEntry();
DeviceEntry BootCodeEntry();
DeviceEntry BoxEntry();
DeviceEntry OneWireEntry();
DeviceEntry Pic24fEntry();
DeviceEntry RadioEntry();
DeviceEntry RecorderEntry();

/// All devices of the venue, in output order.
const std::vector<DeviceEntry>& Devices();

}  // namespace sim
