#pragma once

#include <cstddef>
#include <functional>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "sim/onewire/MemoryButton.h"
#include "sim/onewire/MemoryTrouble.h"
#include "sim/onewire/OneWireDevice.h"

namespace sim {

struct OneWireBusSettings {
  std::optional<RomId> OwnDevice{};  ///< soldered to the bus
  bool Shorted = false;              ///< data line shorted to ground
  /// Buttons lose contact after this many bits of a ROM number, 1 to 64, until the next reset pulse.
  std::optional<std::size_t> ContactLostAfterBits{};
  MemoryTroubleSettings Trouble{};
  std::function<void(const std::string&)> Tell{};  ///< told what the memories of buttons do, in words
};

/// The data line with everything connected to it. It is high only while nobody pulls it low.
class OneWireBus {
 public:
  enum class Presence { Shorted, Present, Absent };

  explicit OneWireBus(OneWireBusSettings settings = {});
  OneWireBus(const OneWireBus&) = delete;
  OneWireBus& operator=(const OneWireBus&) = delete;

  /// Sends a reset pulse and returns what responds.
  Presence Reset();
  /// One time slot, in which the master releases the line (`level` is true, also for reading) or pulls it
  /// low. Returns the level that everyone sees.
  bool Slot(bool level);

  /// Puts a button on the bus; it takes part from the next reset pulse on. No effect on one already there.
  void Touch(const RomId& rom);
  /// False if no such button is on the bus.
  bool Leave(const RomId& rom);
  void LeaveAll();

  /// The memory of a button, at the reader or not: 512 bytes in family 0x06, 128 in family 0x08. nullptr for
  /// other families.
  MemoryButton* MemoryOf(const RomId& rom);

 private:
  OneWireBusSettings settings_;
  std::optional<OneWireDevice> own_;
  std::vector<OneWireDevice> buttons_;
  MemoryTrouble trouble_;
  std::map<RomId, MemoryButton> memories_;
};

}  // namespace sim
