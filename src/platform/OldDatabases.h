#pragma once

#include <cstdint>
#include <string>
#include <vector>

/// Something in an old file that the new one lacks or has in another form.
struct NotTakenOver {
  enum Kind {
    Table,         ///< that the new file has no place for
    Column,        ///< likewise
    TextsOfColumn  ///< that are not numbers, in a column that is numeric in the new file; 0 there
  };
  Kind What;
  std::string Name;
  std::int64_t Rows = 0;  ///< of a table

  bool operator==(const NotTakenOver&) const = default;
};

/// What became of an old file.
struct OldDatabaseReport {
  /// Rows copied to the new file.
  std::int64_t Rows = 0;
  std::vector<NotTakenOver> NotTaken;
  /// Path where the old file was kept.
  std::string KeptAs;
};

/// Files of the database format that this program used before.
class OldDatabases {
 public:
  virtual ~OldDatabases() = default;

  /// True if the file starts like one of that format; false also if it cannot be read.
  virtual bool IsOld(const std::string& path) const = 0;

  /// Replaces the old file with a new one that has the rows of `table`; the old one is kept beside it under
  /// an unused name. `emptyDatabase` is a file with that table, whose own rows are ignored. Throws
  /// RuntimeError 3343, whose text says why, if the old file cannot be read completely; nothing has changed
  /// then.
  virtual OldDatabaseReport Convert(const std::string& path, const std::string& table,
                                    const std::string& emptyDatabase) = 0;
};
