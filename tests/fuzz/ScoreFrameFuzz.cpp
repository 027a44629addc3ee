#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "core/game/ScoreFrame.h"
#include "tests/fakes/FakeClock.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

bool HasNoScores(const Player& player) {
  const bool noHits = std::all_of(player.HitByPlayer.begin(), player.HitByPlayer.end(),
                                  [](std::int32_t amount) { return amount == 0; });
  return noHits && !player.Active && player.ShotCount == 0 && player.HealCount == 0 &&
         player.AmmoAddCount == 0 && player.AdminKillCount == 0 && player.DeathCount == 0 &&
         player.RespawnCount == 0 && player.ExplosiveDamage == 0 && player.RadiationDamage == 0 &&
         player.StunCount == 0 && player.RemainingHealth == 0 && player.RemainingClips == 0 &&
         player.RemainingAmmo == 0 && player.SecondaryDamage == 0 && player.PrimaryDamage == 0 &&
         player.RunCounter == 0 && player.PowerCheatFlag == 0 && player.DallasID == NoDallasId;
}

bool IsWord(std::int32_t value) {
  return value >= 0 && value <= 32767;
}

bool IsInRange(const Player& player) {
  constexpr std::int32_t most = 255 * 32767;
  return std::all_of(player.HitByPlayer.begin(), player.HitByPlayer.end(),
                     [](std::int32_t amount) { return amount >= 0 && amount <= most; }) &&
         IsWord(player.ShotCount) && IsWord(player.StunCount) && IsWord(player.RemainingHealth) &&
         IsWord(player.RunCounter) && player.DallasID.size() == 16 &&
         player.DallasID.find_first_not_of("0123456789ABCDEF") == std::string::npos;
}

}  // namespace

/// The bytes are the start of the receive buffer; the rest of it is zero.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static const StringTable strings(Language::English);
  static Game game(strings);
  game.Clear();
  ReceiveBuffer buffer{};
  std::copy_n(data, std::min(size, buffer.size()), buffer.begin());
  const int index = IndexFromId(buffer[4]);
  AnalyseData(buffer, game, FakeClock());
  Require(game.DataPresent && !game.GameDate.empty());
  Require(std::all_of(buffer.begin(), buffer.end(), [](std::uint8_t byte) { return byte == 0; }));
  for (int i = 1; i <= PlayerCount; ++i) {
    const Player& player = game.Players(i);
    Require(i == index ? player.Active && IsInRange(player) : HasNoScores(player));
  }
  return 0;
}
