#pragma once

#include <chrono>
#include <optional>

/// The time left for a job that has done `done` of `whole` steps in the time `spent`, at its speed so far.
/// None while there is no telling: in the first second, and before the first step. Zero when all is done.
std::optional<std::chrono::milliseconds> TimeLeft(std::chrono::milliseconds spent, double done, double whole);
