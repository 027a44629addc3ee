#pragma once

#include <cstdint>
#include <functional>
#include <span>

#include "core/game/Game.h"
#include "core/game/ScoreFrame.h"
#include "core/text/StringTable.h"
#include "devices/radio/GunTable.h"
#include "devices/radio/RadioDisplay.h"
#include "devices/radio/RadioLink.h"
#include "platform/Clock.h"
#include "platform/EventPump.h"

/// Fetches the scores of every listed gun that is pending or failed, and adds them to the game. Uses the
/// commands 1 (size), 2 (read a block) and 3 (close the transfer), each sent to one gun and answered by it.
class ScoreFetch {
 public:
  /// `beforeGun` hears the record of each gun right before its scores are added.
  ScoreFetch(RadioLink& link, EventPump& events, const Clock& clock, const StringTable& strings, Game& game,
             GunTable& guns, RadioDisplay& display, std::function<void(int)> beforeGun = {});

  /// Throws RuntimeError 6 for a gun that reports 0 bytes, or needs a block that begins beyond byte 255; 9
  /// for an answer that is too long for its buffer. That gun then stays "in progress".
  void GetScores();

 private:
  void FetchGun(int index);
  void Attempt(GunEntry& gun, std::uint8_t playerId);
  /// Sends a command; true if an answer to a command came, which is then in `answer_`.
  bool Command(const GunEntry& gun, std::uint8_t playerId, std::span<const std::uint8_t> payload);
  /// Returns the number of bytes received.
  int FetchBlocks(const GunEntry& gun, std::uint8_t playerId, int total);
  /// Copies a block into the buffer at the offset it states. Returns its length.
  int TakeBlock();

  RadioLink& link_;
  EventPump& events_;
  const Clock& clock_;
  const StringTable& strings_;
  Game& game_;
  GunTable& guns_;
  RadioDisplay& display_;
  const std::function<void(int)> beforeGun_;
  GunPacket answer_{};
  ReceiveBuffer buffer_{};
};
