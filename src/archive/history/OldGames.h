#pragma once

#include <optional>
#include <string>

#include "archive/ArchiveAccess.h"
#include "platform/Database.h"
#include "platform/Sql.h"

/// For how many years games are to be kept, as the operator wrote it into the settings: a whole number from 1
/// to 100. Anything else keeps them for good.
std::optional<int> YearsToKeep(const std::string& text);

/// The same day and time so many years before `now` ("YYYY-MM-DD HH:MM:SS").
std::string YearsBefore(const std::string& now, int years);

/// How many games were played before `time`, deleted ones included. Throws RuntimeError as Sql does.
int GamesPlayedBefore(Sql& archive, const std::string& time);

/// Deletes at most `most` of them for good, the oldest first, with all that the archive has of them, and
/// returns how many. All of those are gone at once, or none. Throws RuntimeError as Sql does.
int DeleteGamesBefore(Database& archive, const std::string& time, int most);

/// Deletes some of them so, in some 30 milliseconds, if the disk has room to write. True if there may be
/// more; false also after a failure, which leaves them for the next call. `time` is emptied once there are
/// none, and nothing is done with an empty one.
bool DeleteSomeGamesBefore(ArchiveAccess& archive, std::string& time);
