#include "sim/onewire/MemoryTrouble.h"

namespace sim {
namespace {

constexpr std::uint8_t DisturbedBit = 0x10;

}  // namespace

std::uint8_t MemoryTrouble::ThroughRead(std::uint8_t byte) const {
  const bool disturbed = settings_.What == Kind::DisturbedRead && read_ + 1 == settings_.Place;
  return disturbed ? byte ^ DisturbedBit : byte;
}

bool MemoryTrouble::EndsRead() {
  return ++read_ == settings_.Place && settings_.What == Kind::RemovedInRead;
}

std::uint8_t MemoryTrouble::ThroughWrite(std::uint8_t byte) const {
  const bool disturbed = settings_.What == Kind::DisturbedWrite && written_ + 1 == settings_.Place;
  return disturbed ? byte ^ DisturbedBit : byte;
}

bool MemoryTrouble::EndsWrite() {
  return ++written_ == settings_.Place && settings_.What == Kind::RemovedInWrite;
}

std::size_t MemoryTrouble::Copied(std::size_t count) {
  if (settings_.What != Kind::TornCopy || torn_ || settings_.Place >= count) {
    return count;
  }
  torn_ = true;
  return settings_.Place;
}

}  // namespace sim
