#include "platform/sqlite/KeySet.h"

#include <algorithm>
#include <utility>

KeySet::KeySet(std::vector<std::int64_t> keys) : keys_(std::move(keys)) {
  if (!std::is_sorted(keys_.begin(), keys_.end())) {
    std::sort(keys_.begin(), keys_.end());
  }
  keys_.erase(std::unique(keys_.begin(), keys_.end()), keys_.end());
}

void KeySet::Append(std::int64_t key) {
  ascending_ = ascending_ && (keys_.empty() || keys_.back() < key);
  keys_.push_back(key);
  positions_.clear();
}

void KeySet::Erase(std::size_t position) {
  keys_.erase(keys_.begin() + static_cast<std::ptrdiff_t>(position));
  positions_.clear();
}

std::optional<std::size_t> KeySet::PositionOf(std::int64_t key) const {
  if (ascending_) {
    const auto found = std::lower_bound(keys_.begin(), keys_.end(), key);
    if (found == keys_.end() || *found != key) {
      return std::nullopt;
    }
    return static_cast<std::size_t>(found - keys_.begin());
  }
  if (positions_.empty()) {
    positions_.reserve(keys_.size());
    for (std::size_t i = 0; i < keys_.size(); ++i) {
      positions_.emplace(keys_[i], i);
    }
  }
  const auto found = positions_.find(key);
  return found == positions_.end() ? std::nullopt : std::optional(found->second);
}
