#pragma once

#include <cstdint>
#include <string>
#include <vector>

/// Something of an old file that is not in the new one as it was.
struct NotTakenOver {
  enum Kind {
    Table,         ///< which the new file has no place for
    Column,        ///< likewise
    TextsOfColumn  ///< that are no numbers, where the new file takes only these; they are 0 now
  };
  Kind What;
  std::string Name;
  std::int64_t Rows = 0;  ///< of a table

  bool operator==(const NotTakenOver&) const = default;
};

/// What became of an old file.
struct OldDatabaseReport {
  /// Rows taken over.
  std::int64_t Rows = 0;
  std::vector<NotTakenOver> NotTaken;
  /// Path of the old file now.
  std::string KeptAs;
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
