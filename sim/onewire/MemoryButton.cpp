#include "sim/onewire/MemoryButton.h"

#include <string_view>
#include <utility>

namespace sim {
namespace {

constexpr std::uint8_t WriteScratchpad = 0x0F;
constexpr std::uint8_t ReadScratchpad = 0xAA;
constexpr std::uint8_t CopyScratchpad = 0x55;
constexpr std::uint8_t ReadMemory = 0xF0;

constexpr std::uint8_t OffsetMask = 0x1F;
constexpr std::uint8_t PartialByte = 0x20;
constexpr std::uint8_t Overflow = 0x40;
constexpr std::uint8_t AuthorisationAccepted = 0x80;

constexpr std::uint8_t Nothing = 0xFF;

bool Writes(std::uint8_t command) {
  return command == WriteScratchpad || command == ReadScratchpad || command == CopyScratchpad;
}

template <class Bytes>
std::string Hex(const Bytes& bytes) {
  constexpr std::string_view digits = "0123456789ABCDEF";
  std::string text;
  for (const std::uint8_t byte : bytes) {
    text += ' ';
    text += digits[byte >> 4U];
    text += digits[byte & 15U];
  }
  return text;
}

}  // namespace

MemoryButton::MemoryButton(std::size_t bytes, MemoryTrouble& trouble,
                           std::function<void(const std::string&)> tell)
    : memory_(bytes, 0xFF), trouble_(trouble), tell_(std::move(tell)) {}

// Bits that do not make up a byte stay in the scratchpad, but are marked.
void MemoryButton::Reset() {
  if (state_ == State::Data && bit_ != 0) {
    if (offset_ < scratchpad_.size()) {
      const unsigned untouched = scratchpad_.at(offset_) & (0xFFU << bit_);
      scratchpad_.at(offset_) = static_cast<std::uint8_t>(untouched | byte_);
      registers_[2] = static_cast<std::uint8_t>(offset_);
    }
    registers_[2] |= PartialByte;
  }
  state_ = State::Command;
  count_ = 0;
  bit_ = 0;
  byte_ = 0;
}

bool MemoryButton::Releases() const {
  return Gives() ? (byte_ >> bit_ & 1U) != 0 : state_ != State::Copied;
}

void MemoryButton::Slot(bool level) {
  if (state_ == State::Copied || state_ == State::Deaf) {
    return;
  }
  const bool gives = Gives();
  if (!gives) {
    byte_ |= (level ? 1U : 0U) << bit_;
  }
  if (++bit_ < 8) {
    return;
  }
  bit_ = 0;
  gives ? Given() : Take(static_cast<std::uint8_t>(std::exchange(byte_, 0)));
}

bool MemoryButton::TakeRemoval() {
  return std::exchange(removed_, false);
}

void MemoryButton::Take(std::uint8_t byte) {
  const bool writes = Writes(state_ == State::Command ? byte : command_);
  const std::uint8_t heard = writes ? trouble_.ThroughWrite(byte) : byte;
  const bool ends = writes && trouble_.EndsWrite();
  switch (state_) {
    case State::Command:
      Obey(heard);
      break;
    case State::Address:
      TakeAddress(heard);
      break;
    case State::Data:
      TakeData(heard);
      break;
    case State::Authorisation:
      TakeAuthorisation(heard);
      break;
    case State::ReadScratchpad:
    case State::ReadMemory:
    case State::Copied:
    case State::Deaf:
      break;
  }
  if (ends) {
    Leave();
  }
}

void MemoryButton::Obey(std::uint8_t command) {
  command_ = command;
  switch (command) {
    case WriteScratchpad:
    case ReadMemory:
      state_ = State::Address;
      break;
    case ReadScratchpad:
      state_ = State::ReadScratchpad;
      byte_ = trouble_.ThroughWrite(NextOfScratchpad());
      break;
    case CopyScratchpad:
      state_ = State::Authorisation;
      break;
    default:
      state_ = State::Deaf;
      Tell("does not know the command" + Hex(std::array{command}));
      break;
  }
}

void MemoryButton::TakeAddress(std::uint8_t byte) {
  registers_.at(count_) = byte;
  if (++count_ < 2) {
    return;
  }
  count_ = 0;
  if (command_ == ReadMemory) {
    state_ = State::ReadMemory;
    byte_ = trouble_.ThroughRead(NextOfMemory());
    return;
  }
  state_ = State::Data;
  offset_ = registers_[0] & OffsetMask;
  registers_[2] = static_cast<std::uint8_t>(offset_);
}

void MemoryButton::TakeData(std::uint8_t byte) {
  if (offset_ == scratchpad_.size()) {
    registers_[2] |= Overflow;
    return;
  }
  scratchpad_.at(offset_) = byte;
  registers_[2] = static_cast<std::uint8_t>(offset_);
  ++offset_;
}

void MemoryButton::TakeAuthorisation(std::uint8_t byte) {
  authorisation_.at(count_) = byte;
  if (++count_ < authorisation_.size()) {
    return;
  }
  if (authorisation_ != registers_) {
    state_ = State::Deaf;
    Tell("refuses to copy for" + Hex(authorisation_) + ", its registers are" + Hex(registers_));
  } else if (trouble_.ForbidsCopy()) {
    state_ = State::Deaf;
    Tell("is write-protected");
  } else {
    Copy();
  }
}

void MemoryButton::Copy() {
  state_ = State::Copied;
  registers_[2] |= AuthorisationAccepted;
  const std::size_t address = registers_[0] + std::size_t{registers_[1]} * 256;
  const std::size_t first = registers_[0] & OffsetMask;
  const std::size_t last = registers_[2] & OffsetMask;
  const std::size_t wanted = last < first ? 0 : last - first + 1;
  const std::size_t copied = trouble_.Copied(wanted);
  for (std::size_t i = 0; i < copied && address + i < memory_.size(); ++i) {
    memory_.at(address + i) = scratchpad_.at(first + i);
  }
  Tell("copied " + std::to_string(copied) + " bytes to" + Hex(std::array{registers_[1], registers_[0]}));
  if (copied < wanted) {
    Leave();
  }
}

// The byte that was given has gone; the next one is made ready.
void MemoryButton::Given() {
  ++count_;
  const bool ofMemory = state_ == State::ReadMemory;
  if (ofMemory ? trouble_.EndsRead() : trouble_.EndsWrite()) {
    Leave();
  } else {
    byte_ = ofMemory ? trouble_.ThroughRead(NextOfMemory()) : trouble_.ThroughWrite(NextOfScratchpad());
  }
}

std::uint8_t MemoryButton::NextOfScratchpad() const {
  if (count_ < registers_.size()) {
    return registers_.at(count_);
  }
  const std::size_t offset = (registers_[0] & OffsetMask) + count_ - registers_.size();
  return offset < scratchpad_.size() ? scratchpad_.at(offset) : Nothing;
}

std::uint8_t MemoryButton::NextOfMemory() const {
  const std::size_t address = registers_[0] + std::size_t{registers_[1]} * 256 + count_;
  return address < memory_.size() ? memory_.at(address) : Nothing;
}

void MemoryButton::Leave() {
  state_ = State::Deaf;
  removed_ = true;
  Tell("was taken from the reader");
}

void MemoryButton::Tell(const std::string& what) const {
  if (tell_) {
    tell_(what);
  }
}

}  // namespace sim
