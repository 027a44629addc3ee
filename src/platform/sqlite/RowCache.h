#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "platform/Database.h"

/// The rows that a recordset has read and looked up in groups of reads, valid until a row of the file
/// changes. Large enough for the members of a whole game; when full it is emptied.
class RowCache {
 public:
  /// Call before each use, with SqliteConnection::State: forgets everything read in another state of the
  /// file.
  void Enter(std::uint64_t state) {
    if (state_ != state) {
      Clear();
      state_ = state;
    }
  }

  void Clear() {
    rows_.clear();
    found_.clear();
  }

  /// The values of a row, or nullptr if it is not cached.
  const std::vector<Value>* Row(std::int64_t key) const {
    const auto held = rows_.find(key);
    return held == rows_.end() ? nullptr : &held->second;
  }

  /// The reference is valid until the next call on this object.
  std::vector<Value>& AddRow(std::int64_t key) {
    if (rows_.size() >= MostRows) {
      rows_.clear();
    }
    return rows_[key];
  }

  /// Position of the first row with `text` in `column` (nullopt: no such row), or nullptr if not cached.
  const std::optional<std::size_t>* Found(std::size_t column, const std::string& text) const {
    const auto ofColumn = found_.find(column);
    if (ofColumn == found_.end()) {
      return nullptr;
    }
    const auto held = ofColumn->second.find(text);
    return held == ofColumn->second.end() ? nullptr : &held->second;
  }

  void AddFound(std::size_t column, const std::string& text, std::optional<std::size_t> position) {
    auto& ofColumn = found_[column];
    if (ofColumn.size() >= MostRows) {
      ofColumn.clear();
    }
    ofColumn.emplace(text, position);
  }

 private:
  static constexpr std::size_t MostRows = 1024;

  std::uint64_t state_ = 0;
  std::unordered_map<std::int64_t, std::vector<Value>> rows_;
  std::map<std::size_t, std::unordered_map<std::string, std::optional<std::size_t>>> found_;
};
