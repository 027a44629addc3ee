#pragma once

#include <string>

/// Converts a date from a Jet file, in days since 1899-12-30, to "YYYY-MM-DD HH:MM:SS". The fraction is the
/// time of day, and counts forwards for negative dates too.
std::string JetDateText(double date);
