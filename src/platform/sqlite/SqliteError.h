#pragma once

#include <string>

#include "platform/RuntimeError.h"

struct sqlite3;

/// Our LIKE's result for an invalid pattern: a private extended code of SQLITE_ERROR.
inline constexpr int SqliteInvalidPattern = 1 | (93 << 8);

/// The last error of `database`, whose file is `path`, by the database layer's numbers: 3022 duplicate key,
/// 3026 disk full, 3027 read-only, 3043 disk error, 3050 locked, 3051 cannot be opened, 3314 value missing,
/// 3317 validation rule, 3343 damaged or not a database, 3421 wrong type, 93 invalid LIKE pattern, 3000
/// anything else. Throws std::bad_alloc if SQLite ran out of memory. `systemError` is the errno behind it
/// where SQLite does not keep it: it does for statements, but not for COMMIT.
RuntimeError SqliteError(sqlite3* database, const std::string& path, int systemError = 0);

/// RuntimeError 3051: the file at `path` cannot be opened.
RuntimeError CannotOpen(const std::string& path);

/// RuntimeError 3343: the file at `path` is not a database, or is damaged.
RuntimeError UnrecognizedFormat(const std::string& path);

/// RuntimeError 3026 or 3043: the file at `path` could not be flushed, for the reason `systemError`.
RuntimeError FlushError(const std::string& path, int systemError);
