#pragma once

#include <cstddef>
#include <optional>
#include <vector>

#include "sim/onewire/OneWireDevice.h"

namespace sim {

struct OneWireBusSettings {
  std::optional<RomId> OwnDevice{};  ///< soldered to the bus
  bool Shorted = false;              ///< data line and ground touch
  /// Buttons lose their contact after that many bits of a ROM number, 1 to 64, until the next reset pulse.
  std::optional<std::size_t> ContactLostAfterBits{};
};

/// The one data line with all that hangs on it. The line is high only as long as nobody pulls it low.
class OneWireBus {
 public:
  enum class Presence { Shorted, Present, Absent };

  explicit OneWireBus(OneWireBusSettings settings = {});

  /// A reset pulse, and what is on the line behind it.
  Presence Reset();
  /// One time slot in which the master releases the line (`level`, which is how it reads) or pulls it low.
  /// Returns the level that all hear.
  bool Slot(bool level);

  /// A button comes to the bus; one that is there already stays. It takes part from the next reset pulse on.
  void Touch(const RomId& rom);
  /// False when no such button was touched.
  bool Leave(const RomId& rom);
  void LeaveAll();

 private:
  OneWireBusSettings settings_;
  std::optional<OneWireDevice> own_;
  std::vector<OneWireDevice> buttons_;
};

}  // namespace sim
