#pragma once

#include <chrono>
#include <optional>
#include <string>

/// A local time "YYYY-MM-DD HH:MM:SS", as if there were one time for all; none for another text.
std::optional<std::chrono::sys_seconds> TimeIn(const std::string& text);

/// The text that TimeIn reads; for years of four digits.
std::string TextOf(std::chrono::sys_seconds time);

/// "HH:MM" of such a text; empty for a shorter one.
std::string HoursAndMinutes(const std::string& stamp);
