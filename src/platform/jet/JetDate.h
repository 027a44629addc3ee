#pragma once

#include <string>

/// True from 0100-01-01 to 9999-12-31, the dates that a Jet file can hold.
bool IsJetDate(double date);

/// Converts a date from a Jet file, in days since 1899-12-30, to "YYYY-MM-DD HH:MM:SS". The fraction is the
/// time of day, and counts forwards for negative dates too.
std::string JetDateText(double date);
