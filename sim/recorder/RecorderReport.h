#pragma once

#include <string>

#include "sim/recorder/SoundRecorder.h"

namespace sim {

/// What the chip holds, a line for each sound: "sound 3: 78 pages, 0.91 s".
std::string RecorderReport(const SoundChip& chip);

/// Carries out the command "sounds", which returns the report; nothing for an empty line. Throws
/// std::invalid_argument with a text for the user.
std::string ObeyRecorderCommand(const SoundRecorder& recorder, const std::string& line);

}  // namespace sim
