#pragma once

#include <string>

#include "core/game/PublicName.h"
#include "platform/Database.h"
#include "web/PublicRanking.h"

/// Where the games of a month are, and what its members are called.
struct MonthRankSources {
  Sql& Archive;
  std::string Now;  ///< local time, "YYYY-MM-DD HH:MM:SS"
  Database& DbMembers;
  NickNames NickNameOf;
};

/// What the members did in the games of this month that the archive has. Throws RuntimeError as databases do.
PublicRanking MonthRanks(const MonthRankSources& sources);
