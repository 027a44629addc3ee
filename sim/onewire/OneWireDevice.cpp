#include "sim/onewire/OneWireDevice.h"

namespace sim {
namespace {

constexpr std::size_t RomBits = 64;
constexpr std::uint8_t ReadRom = 0x33;
constexpr std::uint8_t MatchRom = 0x55;
constexpr std::uint8_t SkipRom = 0xCC;
constexpr std::uint8_t SearchRom = 0xF0;

}  // namespace

void OneWireDevice::Reset() {
  state_ = State::Command;
  bit_ = 0;
  command_ = 0;
  romBitsGiven_ = 0;
  if (memory_ != nullptr) {
    memory_->Reset();
  }
}

bool OneWireDevice::Releases() const {
  switch (state_) {
    case State::SearchBit:
    case State::Read:
      return RomBit();
    case State::SearchComplement:
      return !RomBit();
    case State::Selected:
      return memory_ == nullptr || memory_->Releases();
    case State::Deaf:
    case State::Command:
    case State::SearchSelect:
    case State::Match:
      break;
  }
  return true;
}

void OneWireDevice::Slot(bool level) {
  switch (state_) {
    case State::Deaf:
      break;
    case State::Selected:
      if (memory_ != nullptr) {
        memory_->Slot(level);
      }
      break;
    case State::Command:
      command_ |= (level ? 1U : 0U) << bit_;
      if (++bit_ == 8) {
        Obey(static_cast<std::uint8_t>(command_));
      }
      break;
    case State::SearchBit:
      ++romBitsGiven_;
      state_ = State::SearchComplement;
      break;
    case State::SearchComplement:
      state_ = State::SearchSelect;
      break;
    case State::SearchSelect:
      level == RomBit() ? NextBit(State::SearchBit) : LoseContact();
      break;
    case State::Match:
      level == RomBit() ? NextBit(State::Match) : LoseContact();
      break;
    case State::Read:
      ++romBitsGiven_;
      NextBit(State::Read);
      break;
  }
}

bool OneWireDevice::RomBit() const {
  return (rom_[bit_ / 8] >> (bit_ % 8) & 1U) != 0;
}

void OneWireDevice::Obey(std::uint8_t command) {
  bit_ = 0;
  switch (command) {
    case ReadRom:
      state_ = State::Read;
      break;
    case MatchRom:
      state_ = State::Match;
      break;
    case SkipRom:
      state_ = State::Selected;
      break;
    case SearchRom:
      state_ = State::SearchBit;
      break;
    default:
      state_ = State::Deaf;
      break;
  }
}

void OneWireDevice::NextBit(State next) {
  state_ = ++bit_ == RomBits ? State::Selected : next;
}

}  // namespace sim
