#include "core/game/Standings.h"

#include <algorithm>
#include <functional>
#include <numeric>

#include "core/game/PlayerId.h"

namespace {

Standing StandingOf(const Game& game, int index) {
  const Player& player = game.Players(index);
  const std::uint8_t id = IdFromIndex(index);
  Standing standing{.Index = index,
                    .Team = TeamFromId(id),
                    .Number = PlayerNumberFromId(id),
                    .Soldiering = player.Soldiering,
                    .DamageDealt = player.TotalDamage,
                    .Shots = player.ShotCount,
                    .Wia = player.HealCount,
                    .Kia = player.DeathCount,
                    .AmmoAdds = player.AmmoAddCount};
  standing.DamageTaken =
      std::accumulate(player.HitByPlayer.begin(), player.HitByPlayer.end(), std::int64_t{0});
  if (player.PrimaryDamage != 0 && player.ShotCount > 0) {
    standing.Accuracy = player.Accuracy;
  }
  return standing;
}

}  // namespace

std::vector<Standing> Standings(const Game& game, const NickNames& nickNames, const GuestNames& guestNames) {
  std::vector<Standing> standings;
  for (int index = 1; index <= PlayerCount; ++index) {
    if (game.Players(index).Active) {
      standings.push_back(StandingOf(game, index));
    }
  }
  std::ranges::stable_sort(standings, std::greater(), &Standing::Soldiering);
  int place = 0;
  for (Standing& standing : standings) {
    standing.Place = ++place;
    standing.PublicName = PublicName(game, standing.Index, nickNames, guestNames);
  }
  return standings;
}
