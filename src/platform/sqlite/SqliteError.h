#pragma once

#include <string>

#include "platform/RuntimeError.h"

struct sqlite3;

/// What our own LIKE reports for a pattern that is none: a private extension of SQLITE_ERROR.
inline constexpr int SqliteInvalidPattern = 1 | (93 << 8);

/// The last failure of `database`, whose file is `path`, in the numbers of the database layer: 3022 duplicate
/// key, 3026 disk full, 3027 read-only, 3043 disk error, 3050 locked, 3051 cannot be opened, 3314 value
/// missing, 3317 validation rule, 3343 damaged or no database, 3421 wrong type, 93 invalid LIKE pattern, 3000
/// anything else. Throws std::bad_alloc when it was want of memory.
RuntimeError SqliteError(sqlite3* database, const std::string& path);

/// The file at `path` is no database, or damaged.
RuntimeError UnrecognizedFormat(const std::string& path);
