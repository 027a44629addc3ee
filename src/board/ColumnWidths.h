#pragma once

#include <vector>

/// Divides `width` among columns by their `shares`. A column whose share is less than its `least` gets that
/// at the cost of the others; if all together need more, so does the list. What remains then goes to the
/// columns that want more than they have, as far as the others can spare it. 0 wants nothing.
std::vector<int> ColumnWidths(int width, const std::vector<double>& shares, const std::vector<int>& least,
                              const std::vector<int>& wanted);
