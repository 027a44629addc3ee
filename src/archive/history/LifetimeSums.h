#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "archive/ArchiveQueries.h"
#include "core/text/StringTable.h"
#include "platform/Sql.h"

/// How many games, and their soldiering.
struct GameSums {
  std::int64_t Games = 0;
  double Soldiering = 0;

  bool operator==(const GameSums&) const = default;
};

/// What is known about the difference between a member's lifetime figures and the kept games.
struct LifetimeSums {
  std::optional<GameSums> Lifetime;  ///< of the member table; none for who is no member any more
  GameSums Committed;                ///< kept, not deleted
  GameSums Uncommitted;              ///< kept, not deleted
  GameSums DeletedCommitted;         ///< deleted from the archive, which still has them
};

/// Reads what `games`, all that are kept of a member, do not tell. Throws RuntimeError as Sql does.
LifetimeSums ReadLifetimeSums(const std::vector<MemberGame>& games, std::int32_t member, Sql& archive,
                              Sql& members);

/// For the operator: whether the lifetime figures and the kept games agree, and what is certain about the
/// reasons where they do not. A sentence or two a line.
std::vector<std::string> LifetimeTexts(const LifetimeSums& sums, const StringTable& strings);
