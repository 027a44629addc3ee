#pragma once

#include <cstdint>
#include <string>
#include <vector>

/// What became of an old file.
struct OldDatabaseReport {
  std::int64_t Rows = 0;  ///< rows taken over
  std::vector<std::string>
      NotTaken;        ///< tables and columns that the new file has no place for, and changed values
  std::string KeptAs;  ///< path of the old file now
};

/// Files of the database format that this program used before.
class OldDatabases {
 public:
  virtual ~OldDatabases() = default;

  /// True when the file begins as one of that format does; false also when it cannot be read.
  virtual bool IsOld(const std::string& path) const = 0;

  /// Puts a new file with the rows of `table` in the place of the old one, which is kept beside it under a
  /// name that nothing has. `emptyDatabase` is a file with that table, whose rows do not count. Throws
  /// RuntimeError 3343 whose text says why when the old file cannot be read whole; nothing has changed then.
  virtual OldDatabaseReport Convert(const std::string& path, const std::string& table,
                                    const std::string& emptyDatabase) = 0;
};
