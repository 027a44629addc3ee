#pragma once

#include <cstdint>

#include "core/text/StringTable.h"
#include "devices/radio/GunTable.h"
#include "devices/radio/RadioDisplay.h"
#include "devices/radio/RadioLink.h"
#include "platform/EventPump.h"

/// Asks every id in turn, twice, and lists the guns that answer. Any gun may answer at any time: its answer
/// identifies it, not the id that was asked.
class GunSearch {
 public:
  GunSearch(RadioLink& link, EventPump& events, const StringTable& strings, GunTable& guns,
            RadioDisplay& display);

  /// Searches the ids from 32 to `maxPlayerId` + 31. Throws RuntimeError 6 for an answer with an id below 32,
  /// 9 for one that is too long for its buffer.
  void SearchGuns(std::int16_t maxPlayerId);

 private:
  void Ask(std::uint8_t playerId);
  void TakeAnswer();

  RadioLink& link_;
  EventPump& events_;
  const StringTable& strings_;
  GunTable& guns_;
  RadioDisplay& display_;
  std::uint8_t playersFound_ = 0;
};
