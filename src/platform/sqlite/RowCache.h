#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "platform/Database.h"

/// What a recordset has read and found in groups of reads, for as long as no row of the file has changed.
/// Holds so many rows that a whole game's members fit; beyond that it starts anew.
class RowCache {
 public:
  /// To be called before each use: forgets everything that belongs to another state of the file. States are
  /// told apart by SqliteConnection::State.
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

  /// The values of a row, or nullptr when it was not read yet.
  const std::vector<Value>* Row(std::int64_t key) const {
    const auto held = rows_.find(key);
    return held == rows_.end() ? nullptr : &held->second;
  }

  /// The reference holds until the next call of another member.
  std::vector<Value>& AddRow(std::int64_t key) {
    if (rows_.size() >= MostRows) {
      rows_.clear();
    }
    return rows_[key];
  }

  /// Position of the first row with `text` in `column`, or nullptr when it was not searched yet.
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
