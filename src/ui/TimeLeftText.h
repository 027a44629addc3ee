#pragma once

#include <chrono>
#include <string>

#include "core/text/StringTable.h"

/// The time left for a job, in words: for one of which the share `done` (0 to 1) took the time `spent`. Empty
/// while there is no telling.
std::string TimeLeftText(std::chrono::microseconds spent, double done, const StringTable& strings);
