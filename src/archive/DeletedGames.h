#pragma once

#include <string>

/// For how many days a deleted game can be brought back.
inline constexpr int DaysOfDeletedGames = 30;

/// A game that was deleted before this local time cannot be brought back any more. Both times are
/// "YYYY-MM-DD HH:MM:SS". Empty, which is before all times, if `now` is no such text.
std::string LastTimeOfRemoved(const std::string& now);
