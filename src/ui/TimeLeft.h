#pragma once

#include <chrono>
#include <optional>

/// What a job still takes that has done `done` of `whole` steps in the time `spent`, at the speed so far.
/// None while there is no telling: within the first second, and before the first step. Zero when all is done.
std::optional<std::chrono::milliseconds> TimeLeft(std::chrono::milliseconds spent, double done, double whole);
