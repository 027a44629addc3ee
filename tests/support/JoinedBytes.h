#pragma once

#include "tests/support/RawHost.h"

namespace sim {

/// `left` with `right` behind it.
inline Bytes operator+(Bytes left, const Bytes& right) {
  left.insert(left.end(), right.begin(), right.end());
  return left;
}

}  // namespace sim
