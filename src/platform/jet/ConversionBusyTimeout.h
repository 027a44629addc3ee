#pragma once

#include <chrono>

/// How long a conversion waits for a lock: not for long, since at the start hardly anyone else has the files
/// open.
inline constexpr std::chrono::milliseconds ConversionBusyTimeout(100);
