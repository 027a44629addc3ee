#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "platform/sqlite/SqliteConnection.h"

/// Looks through a database file that nobody else uses, for some milliseconds in each step: every row can be
/// read with all that it holds, and every index has each row once, under its values.
class StepwiseCheck {
 public:
  /// Throws RuntimeError as DatabaseEngine::OpenDatabase does.
  explicit StepwiseCheck(const std::string& path);

  /// True once all was looked through. Throws RuntimeError 3343 for a damaged file.
  bool Step();

 private:
  /// A query for the rows of a table or for the entries of an index.
  struct Walk {
    std::string Sql;
    bool OfIndex = false;  ///< its first column tells whether the table has that row
  };

  void ListWalks();
  void ListWalksOf(const std::string& table);
  /// Looks at the next row of the present walk. False at its end.
  bool NextRow();
  void EndWalk();

  SqliteConnection connection_;
  std::vector<Walk> walks_;  ///< each table, then its indexes
  std::size_t walk_ = 0;
  SqliteStatement rows_;
  std::int64_t rowsSeen_ = 0;  ///< in this walk
  std::int64_t rowsOfTable_ = 0;
};
