#pragma once

#include <optional>
#include <ostream>
#include <utility>
#include <vector>

#include "sim/line/Device.h"

namespace sim {

/// The plainest device: it sends every byte back.
class EchoDevice : public Device {
 public:
  explicit EchoDevice(std::vector<LineSettings> understood = {{.Baud = 19200}}, std::ostream* log = nullptr)
      : Device({.LogName = "echo", .Understood = std::move(understood), .LinePace = Pace::Fast, .Log = log}) {
  }

 private:
  void Run() {
    while (const std::optional<std::uint8_t> byte = Line().ReadByte()) {
      Log().FromHost(*byte);
      Line().Write({&*byte, 1});
      Log().ToHost({&*byte, 1});
    }
  }

  Serving serving_{*this, [this] { Run(); }};
};

}  // namespace sim
