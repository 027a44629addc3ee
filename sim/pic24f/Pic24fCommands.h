#pragma once

#include <string>

#include "sim/pic24f/Pic24fLoader.h"

namespace sim {

/// Carries out a command on the device: "reset" (back from the application to the loader) or "save FILE" (its
/// program memory, four bytes an instruction). Returns what was done, nothing for an empty line. Throws
/// std::invalid_argument with a text for the user.
std::string ObeyPic24fCommand(Pic24fLoader& loader, const std::string& line);

}  // namespace sim
