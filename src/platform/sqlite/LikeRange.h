#pragma once

#include <string>
#include <vector>

#include "platform/sqlite/SqliteTable.h"

/// Adds a range on the column beside each "[Column] LIKE 'text*'" in `condition`, so that SQLite can use the
/// column's index, which it does not do for an overridden LIKE. The result selects the same rows. A
/// comparison is left alone if its column does not hold text, its pattern is invalid or begins with a
/// wildcard, or it is part of anything more complex than AND, OR, NOT and brackets.
std::string WithLikeRanges(const SqliteTable& table, const std::string& condition);

/// The terms of a condition that is nothing but such comparisons joined by OR, each with its range: SQLite
/// finds their rows one after the other in less time than it takes to join them. Empty for any other
/// condition, and if a comparison has no range.
std::vector<std::string> LikeAlternatives(const SqliteTable& table, const std::string& condition);
