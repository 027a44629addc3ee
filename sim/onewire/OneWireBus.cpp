#include "sim/onewire/OneWireBus.h"

#include <algorithm>

namespace sim {

OneWireBus::OneWireBus(OneWireBusSettings settings) : settings_(settings) {
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
  return heard;
}

void OneWireBus::Touch(const RomId& rom) {
  if (std::none_of(buttons_.begin(), buttons_.end(),
                   [&](const OneWireDevice& button) { return button.Rom() == rom; })) {
    buttons_.emplace_back(rom);
  }
}

bool OneWireBus::Leave(const RomId& rom) {
  return std::erase_if(buttons_, [&](const OneWireDevice& button) { return button.Rom() == rom; }) > 0;
}

void OneWireBus::LeaveAll() {
  buttons_.clear();
}

}  // namespace sim
