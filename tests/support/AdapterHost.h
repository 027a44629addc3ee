#pragma once

#include <string>

#include "tests/support/RawHost.h"

namespace sim {

/// A host that speaks to a 1-wire adapter in bytes.
class AdapterHost : public RawHost {
 public:
  /// Opens the device, calibrates the chip with its first byte and waits for nothing.
  explicit AdapterHost(const std::string& path) : RawHost(path) { Write({0xC1}); }

  /// Writes `bytes` and reads `count` answers.
  Bytes Ask(const Bytes& bytes, std::size_t count) {
    Write(bytes);
    return Read(count);
  }

  /// A reset and a pass of a search: the answers to both, to the search command and to the 16 bytes.
  Bytes Search(const Bytes& directions) {
    Bytes bytes{0xC1, 0xE1, 0xF0, 0xE3, 0xB1, 0xE1};
    bytes.insert(bytes.end(), directions.begin(), directions.end());
    bytes.insert(bytes.end(), {0xE3, 0xA1});
    return Ask(bytes, 18);
  }
};

}  // namespace sim
