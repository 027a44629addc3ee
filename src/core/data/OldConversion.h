#pragma once

#include <string>
#include <vector>

#include "core/data/UserDatabase.h"

/// Converts a database of an old installation and reports it in a box. Rows that were meanwhile entered into
/// the fresh database are offered for joining. What is not taken over is also written to a text file, ".txt"
/// behind the database's name, before the new file takes its place. Throws RuntimeError 3343 with the reason,
/// in the program's language, if it cannot be converted; nothing has changed then.
void ConvertOldDatabase(const UserDatabase& database, const DatabaseParts& parts);

/// Why an old file was not converted, for the operator.
std::string ReasonOf(const OldDatabaseRefused& error, const StringTable& strings);

/// What was not taken over, a line for each; the last one counts those beyond what a box holds.
std::string LinesOf(const std::vector<NotTakenOver>& all, const StringTable& strings);
