#pragma once

#include <optional>

/// How the places of a chart follow one another.
enum class ChartOrder { Across, Down };

/// Where a key (Qt::Key) leads from place `from` of `count`, which is at least 1: the arrow keys of that
/// order to the next ones, Page Up and Page Down ten further, Home and End to the ends, beyond which nothing
/// leads. Nothing for any other key.
std::optional<int> PlaceByKey(int key, int from, int count, ChartOrder order);
