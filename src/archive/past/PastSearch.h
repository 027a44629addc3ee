#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "archive/ArchiveQueries.h"

/// What past games are searched for; what is empty or 0 does not limit them.
struct PastSearch {
  std::string From = {};   ///< first day, "YYYY-MM-DD"
  std::string Until = {};  ///< last day, likewise
  std::string Mission = {};
  std::vector<std::int32_t> Members = {};  ///< one of whom plays
  int Player = 0;                          ///< record of a gun, 1 to 224

  bool operator==(const PastSearch&) const = default;
};

/// Which games are listed.
enum class ListedPast { Month, All, Deleted };

/// The games that fit the search; of `month` ("2026-11") only where that is asked for.
GameFilter FilterOf(const PastSearch& search, ListedPast which, const std::string& month = {});

/// The day of a local time "YYYY-MM-DD HH:MM:SS".
std::string DayOf(const std::string& time);

/// The game below the last of the `gone` ones in a list, else the one above; 0 if none is left.
std::int64_t GameAfter(const std::vector<std::int64_t>& games, const std::vector<std::int64_t>& gone);
