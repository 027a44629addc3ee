#pragma once

#include <string>

#include "sim/onewire/OneWireAdapter.h"

namespace sim {

/// Carries out a command on the buttons at the reader: "touch ID", "leave ID" or, for all buttons, "leave",
/// with an ID as ParseRomId reads it. Returns what was done ("touched ID", "left ID" or "left"), nothing for
/// an empty line. Throws std::invalid_argument with a text for the user.
std::string ObeyButtonCommand(OneWireAdapter& adapter, const std::string& line);

}  // namespace sim
