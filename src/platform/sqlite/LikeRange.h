#pragma once

#include <string>

#include "platform/sqlite/SqliteTable.h"

/// `condition` with a range of the column's index added beside each "[Column] LIKE 'text*'" in it, which our
/// own LIKE does not get by itself. Holds for the same rows. Left as it stands where the column does not keep
/// texts, the pattern cannot be read or begins with a wildcard, or the comparison is a part of something more
/// involved than AND, OR, NOT and brackets.
std::string WithLikeRanges(const SqliteTable& table, const std::string& condition);
