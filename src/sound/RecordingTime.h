#pragma once

#include <chrono>
#include <cstdint>

#include "sound/RecorderLink.h"

/// About how long `pages` take to send: wire and pauses, without erasing and the hardware's own time.
std::chrono::milliseconds RecordingTime(std::int64_t pages, Recorder recorder);
