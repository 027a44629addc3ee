#include "archive/FigureDigests.h"

#include "core/game/WordDigest.h"

std::uint64_t RawDigest(const Player& player) {
  WordDigest digest;
  for (const std::int32_t figure :
       {player.ShotCount, player.HealCount, player.AmmoAddCount, player.AdminKillCount, player.RespawnCount,
        player.DeathCount, player.RunCounter, player.ExplosiveDamage, player.RadiationDamage,
        player.StunCount}) {
    digest.Add(figure);
  }
  for (const std::int32_t damage : player.HitByPlayer) {
    digest.Add(damage);
  }
  return digest.Value();
}

std::uint64_t FiguresDigest(const Game& game) {
  WordDigest digest;
  for (const Player& player : game.Players) {
    if (player.Active) {
      digest.Add(player.TotalDamage);
      digest.Add(player.AbsoluteDamage);
      digest.Add(player.Soldiering);
    }
  }
  return digest.Value();
}
