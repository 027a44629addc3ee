#pragma once

#include <cstdint>

#include "platform/Sql.h"

/// How many bytes the files of all states of a game take in the archive: how long it takes to read them goes
/// with that. 0 without files. Throws RuntimeError as Sql does.
inline std::int64_t PackedBytesOf(Sql& archive, std::int64_t game) {
  return WholeNumber(archive,
                     "SELECT sum(length(data)) FROM sqlar WHERE name IN (SELECT Name FROM GameFiles "
                     "WHERE GameID = $1)",
                     {game});
}
