#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <string>
#include <utility>

#include "platform/Database.h"

class SqliteConnection;

/// What a transaction has written, so that the file can be asked whether it holds it. That is in the file as
/// a whole or not at all, so of a long one the first rows are enough.
class WrittenRows {
 public:
  void Clear() {
    rows_.clear();
    allTold_ = true;
  }

  /// The row `key` of `table` is there now, and holds what later calls of Set tell. Returns false, and then
  /// there is nothing to set, if it is not among the first rows.
  bool Write(const std::string& table, std::int64_t key);
  void Set(const std::string& table, std::int64_t key, const std::string& column, const Value& value);
  void Delete(const std::string& table, std::int64_t key);

  /// Rows were written that are not known one by one.
  void WriteUntold() { allTold_ = false; }
  /// False after WriteUntold: then AreIn does not say everything.
  bool AreAllTold() const { return allTold_; }

  /// True if the file holds every row as it was last written. Throws RuntimeError if it cannot be read.
  bool AreIn(SqliteConnection& connection) const;

 private:
  struct Row {
    bool Deleted = false;
    std::map<std::string, Value> Columns;  ///< by name, as far as they were written
  };
  using Place = std::pair<std::string, std::int64_t>;  ///< table and key

  static constexpr std::size_t MostRows = 1000;

  bool IsWatched(const Place& place) const { return rows_.size() < MostRows || rows_.contains(place); }
  static bool IsIn(SqliteConnection& connection, const Place& place, const Row& row);

  std::map<Place, Row> rows_;
  bool allTold_ = true;
};
