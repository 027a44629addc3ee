#pragma once

#include <string>

#include "platform/sqlite/SqliteTable.h"

/// Adds a range on the column beside each "[Column] LIKE 'text*'" in `condition`, so that SQLite can use the
/// column's index, which it does not do for an overridden LIKE. The result selects the same rows. A
/// comparison is left alone if its column does not hold text, its pattern is invalid or begins with a
/// wildcard, or it is part of anything more complex than AND, OR, NOT and brackets.
std::string WithLikeRanges(const SqliteTable& table, const std::string& condition);
