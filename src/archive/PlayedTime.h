#pragma once

#include <string>

#include "platform/Clock.h"

/// The local time ("YYYY-MM-DD HH:MM:SS") at which a game was played, told by the date text of its file and
/// by the time at which the file was last changed:
/// * a date with a time, in the form of this computer or year first, is that time;
/// * a date with a time of day in another form is that time if only one order of day, month and year is
///   possible, or if the file was changed on one of the two days;
/// * a date alone is that day, at the time of the file if that was changed on the same day, else at midnight;
/// * everything else gives the time of the file.
std::string TimePlayed(const std::string& dateText, const std::string& fileTime, const Clock& time);
