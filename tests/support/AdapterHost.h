#pragma once

#include <string>

#include "tests/support/RawHost.h"

namespace sim {

/// A host that speaks to a 1-wire adapter byte by byte.
class AdapterHost : public RawHost {
 public:
  /// Opens the device and calibrates the chip with a first byte, which has no answer.
  explicit AdapterHost(const std::string& path) : RawHost(path) { Write({0xC1}); }

  /// Writes `bytes` and reads `count` answers.
  Bytes Ask(const Bytes& bytes, std::size_t count) {
    Write(bytes);
    return Read(count);
  }

  /// A reset and one search pass. Returns the answers to the reset, the search command and the 16 bytes.
  Bytes Search(const Bytes& directions) {
    Bytes bytes{0xC1, 0xE1, 0xF0, 0xE3, 0xB1, 0xE1};
    bytes.insert(bytes.end(), directions.begin(), directions.end());
    bytes.insert(bytes.end(), {0xE3, 0xA1});
    return Ask(bytes, 18);
  }
};

}  // namespace sim
