#pragma once

#include <chrono>

#include "tests/devices/radio/HealthyGun.h"
#include "tests/support/Venue.h"

/// The gun Red 1 at the far end of a venue's line: it answers the search, and commands unless it is silent.
class AnsweringRed1 {
 public:
  explicit AnsweringRed1(Venue& venue) : venue_(venue) {}

  /// Takes a byte from the line.
  void Hear(std::uint8_t byte) {
    sent_.push_back(byte);
    if (sent_.size() < 3 || sent_.size() < sent_[2] + 4U) {
      return;
    }
    const Bytes packet(sent_.begin() + 14, sent_.end() - 1);
    sent_.clear();
    constexpr std::uint8_t red1 = 33;
    constexpr std::uint8_t search = 6;
    if (packet[1] == red1 && (packet[4] == search || !IsSilent)) {
      venue_.Events.At(std::chrono::milliseconds(5),
                       [this, packet] { venue_.Port.Receive(Received(red1, AnswerTo(packet))); });
    }
  }

  bool IsSilent = false;

 private:
  Venue& venue_;
  Bytes sent_;
};
