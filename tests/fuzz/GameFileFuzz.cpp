#include <array>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <memory>
#include <optional>
#include <string>

#include "core/gamefile/GameFile.h"
#include "core/text/TextEncoding.h"
#include "platform/RuntimeError.h"

namespace {

const StringTable Strings(Language::English);

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

struct Loaded {
  std::unique_ptr<Game> Contents = std::make_unique<Game>(Strings);
  std::string Mission;
  int MissionCalls = 0;
};

/// Reads `bytes` as a game; nullopt if they are refused or fail with one of the three expected errors.
std::optional<Loaded> Read(const std::string& bytes) {
  Loaded loaded;
  const auto selectMission = [&loaded](const std::string& mission) {
    loaded.Mission = mission;
    ++loaded.MissionCalls;
  };
  try {
    if (ReadGameFile(bytes, *loaded.Contents, selectMission)) {
      return loaded;
    }
    Require(loaded.MissionCalls == 0);
  } catch (const RuntimeError& error) {
    Require(error.Number() == 6 || error.Number() == 9 || error.Number() == 13);
  }
  return std::nullopt;
}

void RequireSame(const Player& player, const Player& again) {
  const auto fields = [](const Player& one) {
    return std::to_array<std::int32_t>({one.ShotCount,       one.TotalDamage,      one.Soldiering,
                                        one.HealCount,       one.AmmoAddCount,     one.AdminKillCount,
                                        one.RespawnCount,    one.RemainingHealth,  one.RemainingClips,
                                        one.RemainingAmmo,   one.DeathCount,       one.SecondaryDamage,
                                        one.PrimaryDamage,   one.RunCounter,       one.Rank,
                                        one.MemberIndex,     one.BonusPoints,      one.ExplosiveDamage,
                                        one.RadiationDamage, one.StunCount,        one.PowerCheatFlag,
                                        one.Active ? 1 : 0,  one.Committed ? 1 : 0});
  };
  Require(fields(player) == fields(again));
  Require(player.DallasID == again.DallasID);
  for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
    const std::int32_t amount = player.HitByPlayer(shooter);
    Require(again.HitByPlayer(shooter) == (amount > 0 ? amount : 0));
  }
}

}  // namespace

/// Whatever the bytes, they are a game, not a game, or one of the three expected errors. A game that was read
/// survives being saved and loaded.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::optional<Loaded> first = Read(std::string(reinterpret_cast<const char*>(data), size));
  if (!first) {
    return 0;
  }
  Require(first->MissionCalls == 1);
  const std::string saved = WriteGameFile(*first->Contents, first->Mission);
  Require(IsUtf8(saved));
  const std::optional<Loaded> second = Read(saved);
  Require(second.has_value());
  Require(second->Mission == first->Mission);
  Require(second->Contents->GameDate == first->Contents->GameDate);
  for (int set = 1; set <= TeamCount; ++set) {
    const ObjectiveTeam& team = first->Contents->ObjectiveTeams(set);
    const ObjectiveTeam& again = second->Contents->ObjectiveTeams(set);
    Require(again.Name == team.Name);
    Require(again.PrimaryAchieved == team.PrimaryAchieved &&
            again.SecondaryAchieved == team.SecondaryAchieved);
  }
  for (int index = 1; index <= PlayerCount; ++index) {
    const Player& player = first->Contents->Players(index);
    const Player& again = second->Contents->Players(index);
    Require(again.Active == player.Active);
    if (player.Active) {
      RequireSame(player, again);
    }
  }
  // The first save rounds accuracies to 7 digits; after that nothing changes any more.
  const std::string savedAgain = WriteGameFile(*second->Contents, second->Mission);
  const std::optional<Loaded> third = Read(savedAgain);
  Require(third && WriteGameFile(*third->Contents, third->Mission) == savedAgain);
  return 0;
}
