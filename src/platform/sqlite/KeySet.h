#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <unordered_map>
#include <vector>

/// The keys of a dynaset in its order, each at most once. While they ascend, which only keys added later can
/// break, a key's position is found by binary search; otherwise through a table that the first search after
/// a change builds.
class KeySet {
 public:
  KeySet() = default;
  /// Takes keys in any order, also several times, and sorts them.
  explicit KeySet(std::vector<std::int64_t> keys);

  void Append(std::int64_t key);
  void Erase(std::size_t position);

  std::size_t Size() const { return keys_.size(); }
  std::int64_t At(std::size_t position) const { return keys_[position]; }
  bool Ascending() const { return ascending_; }

  std::optional<std::size_t> PositionOf(std::int64_t key) const;

 private:
  std::vector<std::int64_t> keys_;
  bool ascending_ = true;
  mutable std::unordered_map<std::int64_t, std::size_t> positions_;
};
