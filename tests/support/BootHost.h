#pragma once

#include <string>
#include <vector>

#include "tests/support/BootLiterals.h"
#include "tests/support/RawHost.h"

namespace sim {

/// A host that speaks to boot code in letters.
class BootHost : public RawHost {
 public:
  using RawHost::RawHost;

  std::string Hear(std::size_t count) {
    const Bytes bytes = Read(count);
    return {bytes.begin(), bytes.end()};
  }

  /// Sends `bytes` and reads the letter that answers them.
  std::string Ask(const Bytes& bytes) {
    Write(bytes);
    return Hear(1);
  }
  /// Likewise with one after the other.
  std::string AskAll(const std::vector<Bytes>& pieces) {
    std::string answers;
    for (const Bytes& piece : pieces) {
      answers += Ask(piece);
    }
    return answers;
  }
  /// Likewise with letter after letter.
  std::string Say(const std::string& letters) {
    std::string answers;
    for (const char letter : letters) {
      answers += Ask(Bytes{static_cast<std::uint8_t>(letter)});
    }
    return answers;
  }

  /// From X to B.
  std::string Begin() { return Say("XPB"); }
};

}  // namespace sim
