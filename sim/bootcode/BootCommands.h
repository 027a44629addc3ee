#pragma once

#include <string>

#include "sim/bootcode/BootCode.h"

namespace sim {

/// Carries out "power", "power FAILURE" or "power FAILURE K" and returns "switched on"; nothing for an empty
/// line. Throws std::invalid_argument with a text for the user.
std::string ObeyBootCommand(BootCode& device, const std::string& line);

}  // namespace sim
