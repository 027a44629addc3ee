#include "sim/onewire/OneWireBus.h"

#include <algorithm>
#include <utility>

namespace sim {
namespace {

std::size_t MemoryBytes(std::uint8_t family) {
  constexpr std::uint8_t large = 0x06;
  constexpr std::uint8_t small = 0x08;
  return family == large ? 512 : family == small ? 128 : 0;
}

}  // namespace

OneWireBus::OneWireBus(OneWireBusSettings settings)
    : settings_(std::move(settings)), trouble_(settings_.Trouble) {
  if (settings_.OwnDevice) {
    own_.emplace(*settings_.OwnDevice);
  }
}

OneWireBus::Presence OneWireBus::Reset() {
  if (settings_.Shorted) {
    return Presence::Shorted;
  }
  if (own_) {
    own_->Reset();
  }
  for (OneWireDevice& button : buttons_) {
    button.Reset();
  }
  return own_ || !buttons_.empty() ? Presence::Present : Presence::Absent;
}

bool OneWireBus::Slot(bool level) {
  if (settings_.Shorted) {
    return false;
  }
  const bool heard = level && (!own_ || own_->Releases()) &&
                     std::all_of(buttons_.begin(), buttons_.end(),
                                 [](const OneWireDevice& button) { return button.Releases(); });
  if (own_) {
    own_->Slot(heard);
  }
  for (OneWireDevice& button : buttons_) {
    button.Slot(heard);
    if (settings_.ContactLostAfterBits && button.RomBitsGiven() >= *settings_.ContactLostAfterBits) {
      button.LoseContact();
    }
  }
  std::erase_if(buttons_, [](OneWireDevice& button) { return button.TakeRemoval(); });
  return heard;
}

void OneWireBus::Touch(const RomId& rom) {
  if (std::none_of(buttons_.begin(), buttons_.end(),
                   [&](const OneWireDevice& button) { return button.Rom() == rom; })) {
    buttons_.emplace_back(rom, MemoryOf(rom));
  }
}

bool OneWireBus::Leave(const RomId& rom) {
  return std::erase_if(buttons_, [&](const OneWireDevice& button) { return button.Rom() == rom; }) > 0;
}

void OneWireBus::LeaveAll() {
  buttons_.clear();
}

MemoryButton* OneWireBus::MemoryOf(const RomId& rom) {
  const std::size_t bytes = MemoryBytes(rom[0]);
  if (bytes == 0) {
    return nullptr;
  }
  const auto tell = [this, rom](const std::string& what) {
    if (settings_.Tell) {
      settings_.Tell("button " + RomIdText(rom) + ' ' + what);
    }
  };
  return &memories_.try_emplace(rom, bytes, trouble_, tell).first->second;
}

}  // namespace sim
