#pragma once

#include <cstddef>
#include <cstdint>

#include "sim/onewire/MemoryButton.h"
#include "sim/onewire/RomId.h"

namespace sim {

/// A device on a 1-Wire bus, time slot by time slot: the ROM commands read, match, skip and search. It does
/// not respond to any other command. What is sent to it once selected goes to its memory, if it has one.
class OneWireDevice {
 public:
  /// Deaf until the first reset pulse. `memory`, if there is one, must outlive the device.
  explicit OneWireDevice(const RomId& rom, MemoryButton* memory = nullptr) : rom_(rom), memory_(memory) {}

  const RomId& Rom() const { return rom_; }

  /// A reset pulse has passed: the next eight slots carry a ROM command.
  void Reset();
  /// Loses contact until the next reset pulse.
  void LoseContact() { state_ = State::Deaf; }

  /// Whether the device leaves the line high in the coming slot.
  bool Releases() const;
  /// The slot has passed with `level` on the line.
  void Slot(bool level);

  /// Whether the device has been selected, so that what follows is addressed to it.
  bool IsSelected() const { return state_ == State::Selected; }

  /// Bits of its ROM number that the device has put on the line since the reset pulse, 0 to 64.
  std::size_t RomBitsGiven() const { return romBitsGiven_; }

  /// True once after the device has been taken from the reader in the middle of an exchange.
  bool TakeRemoval() { return memory_ != nullptr && memory_->TakeRemoval(); }

 private:
  enum class State { Deaf, Command, SearchBit, SearchComplement, SearchSelect, Match, Read, Selected };

  bool RomBit() const;
  void Obey(std::uint8_t command);
  void NextBit(State next);

  RomId rom_;
  MemoryButton* memory_;
  State state_ = State::Deaf;
  std::size_t bit_ = 0;
  unsigned command_ = 0;
  std::size_t romBitsGiven_ = 0;
};

}  // namespace sim
