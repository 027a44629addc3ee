#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "sim/onewire/MemoryTrouble.h"

namespace sim {

/// The memory of a button, time slot by time slot, from the selection of the button on: the functions of the
/// DS1992 and DS1993 with their 32-byte scratchpad, as in the data sheet. It is battery-backed, so memory and
/// scratchpad outlast a touch. A copy is over at once.
class MemoryButton {
 public:
  /// `tell`, if given, is called with what is done or refused, in words. `trouble` must outlive the button.
  MemoryButton(std::size_t bytes, MemoryTrouble& trouble, std::function<void(const std::string&)> tell = {});

  /// Addressed from 0; all bytes are 0xFF at first.
  std::vector<std::uint8_t>& Memory() { return memory_; }

  /// A reset pulse has passed: once the button is selected, a function command is due.
  void Reset();
  /// Whether the button leaves the line high in the coming slot.
  bool Releases() const;
  /// The slot has passed with `level` on the line.
  void Slot(bool level);

  /// True once after the button has been taken from the reader.
  bool TakeRemoval();

 private:
  enum class State { Command, Address, Data, ReadScratchpad, Authorisation, Copied, ReadMemory, Deaf };

  bool Gives() const { return state_ == State::ReadScratchpad || state_ == State::ReadMemory; }
  void Take(std::uint8_t byte);
  void Obey(std::uint8_t command);
  void TakeAddress(std::uint8_t byte);
  void TakeData(std::uint8_t byte);
  void TakeAuthorisation(std::uint8_t byte);
  void Copy();
  void Given();
  std::uint8_t NextOfScratchpad() const;
  std::uint8_t NextOfMemory() const;
  void Leave();
  void Tell(const std::string& what) const;

  std::vector<std::uint8_t> memory_;
  MemoryTrouble& trouble_;
  std::function<void(const std::string&)> tell_;

  std::array<std::uint8_t, 32> scratchpad_{};
  /// The registers TA1, TA2 and E/S: target address, and ending offset with status.
  std::array<std::uint8_t, 3> registers_{};

  State state_ = State::Deaf;
  std::uint8_t command_ = 0;
  std::size_t count_ = 0;   // bytes of the address, the authorisation or what is read
  std::size_t offset_ = 0;  // in the scratchpad, where the next data byte goes
  std::array<std::uint8_t, 3> authorisation_{};
  unsigned bit_ = 0;
  unsigned byte_ = 0;  // being taken or given
  bool removed_ = false;
};

}  // namespace sim
