#include "sim/venue/Devices.h"

namespace sim {

const std::vector<DeviceEntry>& Devices() {
  static const std::vector<DeviceEntry> devices{BaseUnitEntry(), OneWireEntry(),  RadioEntry(), BoxEntry(),
                                                BootCodeEntry(), RecorderEntry(), Pic24fEntry()};
  return devices;
}

}  // namespace sim
