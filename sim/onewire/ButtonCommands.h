#pragma once

#include <string>

#include "sim/onewire/OneWireAdapter.h"

namespace sim {

/// Carries out a command on buttons: "touch ID", "leave ID" or, for all at the reader, "leave"; "fill ID
/// CONTENT" and "show ID" for those with a memory, at the reader or not. An ID is as ParseRomId reads it, a
/// content as ParseButtonContent does. Returns what was done ("touched ID", "left ID", "left", "filled ID")
/// or the block ("ID 00 01 ..."), nothing for an empty line. Throws std::invalid_argument with a text for the
/// user.
std::string ObeyButtonCommand(OneWireAdapter& adapter, const std::string& line);

}  // namespace sim
