#pragma once

#include <string>

/// "YYYY-MM-DD HH:MM:SS" of a date as a Jet file has it: days since 1899-12-30, the time of day being their
/// fraction, also of days before that.
std::string JetDateText(double date);
