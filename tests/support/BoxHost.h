#pragma once

#include <chrono>
#include <thread>

#include "tests/support/RawHost.h"

namespace sim {

/// A host that writes frames to a utility box, with the pauses that a box wants.
class BoxHost : public RawHost {
 public:
  using RawHost::RawHost;

  void Send(const Bytes& bytes) {
    for (const std::uint8_t byte : bytes) {
      Write({byte});
      // Part of what is sent, not a wait for something.
      std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
  }
};

}  // namespace sim
