#pragma once

#include <cstddef>
#include <utility>

#include "tests/support/RawHost.h"

namespace sim {

/// `left` followed by `right`.
inline Bytes operator+(Bytes left, const Bytes& right) {
  left.insert(left.end(), right.begin(), right.end());
  return left;
}

/// `count` times `bytes`.
inline Bytes Repeated(std::size_t count, const Bytes& bytes) {
  Bytes all;
  for (std::size_t i = 0; i < count; ++i) {
    all = std::move(all) + bytes;
  }
  return all;
}

}  // namespace sim
