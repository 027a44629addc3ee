#include "devices/radio/GunSearch.h"

#include <string>

#include "core/game/PlayerId.h"
#include "core/text/Filled.h"
#include "core/text/NumberForms.h"

GunSearch::GunSearch(RadioLink& link, EventPump& events, const StringTable& strings, GunTable& guns,
                     RadioDisplay& display)
    : link_(link), events_(events), strings_(strings), guns_(guns), display_(display) {}

void GunSearch::SearchGuns(std::int16_t maxPlayerId) {
  constexpr int passes = 2;
  for (GunEntry& gun : guns_) {
    gun.Present = false;
  }
  link_.OpenXBeePort();
  display_.SetStatus("Searching...");
  display_.ClearGunList();
  display_.SetPlayersFound(playersFound_);
  for (int pass = 0; pass < passes; ++pass) {
    for (int index = 0; index < maxPlayerId && !link_.Stopped(); ++index) {
      const int playerId = FirstGunId + index;
      display_.SetProgress(
          Filled(strings_.Text(OwnText::SearchProgress),
                 {std::to_string(pass + 1), std::to_string(passes), std::to_string(playerId)}),
          pass * maxPlayerId + index, passes * maxPlayerId);
      Ask(static_cast<std::uint8_t>(playerId));
    }
  }
  display_.SetStatus("Idle");
  link_.XBee_CloseCommPort();
}

void GunSearch::Ask(std::uint8_t playerId) {
  events_.DoEvents();
  while (link_.TakeFrame()) {
    TakeAnswer();  // arrived along with another answer, and must not end the next gun's slot
  }
  link_.SendGunPacket(playerId, BroadcastAddress, 0, 0, GunPacketType::Search);
  if (link_.WaitForFrame(false)) {
    TakeAnswer();
  }
}

void GunSearch::TakeAnswer() {
  const GunPacket answer = ReadGunPacket(link_.Frame());
  if (answer.Type != GunPacketType::SearchAnswer) {
    return;
  }
  const std::uint8_t playerId = answer.PlayerId;
  GunEntry& gun = guns_[ByteOf(playerId - FirstGunId)];
  if (gun.Present) {
    return;
  }
  gun.Firmware = Str(answer.Payload[0]) + "." + Str(answer.Payload[1]);
  gun.Battery = answer.Payload[2];
  gun.WeaponType = answer.Payload[3];
  gun.PlayerID = playerId;
  gun.PlayerName = PlayerName(TeamNameFromNumber(strings_, TeamFromId(playerId)), playerId);
  gun.Present = true;
  gun.Address = link_.Frame().SourceAddress;
  gun.ScoreStatus = ScoreStatus::Pending;
  display_.SetPlayersFound(++playersFound_);
  display_.RefreshGunList();
}
