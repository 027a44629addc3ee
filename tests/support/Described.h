#pragma once

#include <gtest/gtest.h>

#include <iomanip>
#include <sstream>
#include <string>

#include "core/game/Game.h"

/// Every field of a player, one per line, so that a failed comparison names those that differ.
inline std::string Described(const Player& player) {
  std::ostringstream out;
  out << std::setprecision(9);
  out << "ShotCount " << player.ShotCount << "\nTotalDamage " << player.TotalDamage << "\nAbsoluteDamage "
      << player.AbsoluteDamage << "\nSoldiering " << player.Soldiering << "\nHealCount " << player.HealCount
      << "\nAmmoAddCount " << player.AmmoAddCount << "\nAdminKillCount " << player.AdminKillCount
      << "\nRespawnCount " << player.RespawnCount << "\nRemainingHealth " << player.RemainingHealth
      << "\nRemainingClips " << player.RemainingClips << "\nRemainingAmmo " << player.RemainingAmmo
      << "\nDeathCount " << player.DeathCount << "\nSecondaryDamage " << player.SecondaryDamage
      << "\nPrimaryDamage " << player.PrimaryDamage << "\nAccuracy " << player.Accuracy << "\nRunCounter "
      << player.RunCounter << "\nActive " << player.Active << "\nRank " << player.Rank << "\nDallasID "
      << player.DallasID << "\nMemberIndex " << player.MemberIndex << "\nCommitted " << player.Committed
      << "\nBonusPoints " << player.BonusPoints << "\nExplosiveDamage " << player.ExplosiveDamage
      << "\nRadiationDamage " << player.RadiationDamage << "\nStunCount " << player.StunCount
      << "\nPowerCheatFlag " << int{player.PowerCheatFlag} << '\n';
  for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
    if (player.HitByPlayer(shooter) != 0) {
      out << "HitByPlayer(" << shooter << ") " << player.HitByPlayer(shooter) << '\n';
    }
  }
  return out.str();
}

/// The header and the team tables.
inline std::string DescribedHeader(const Game& game) {
  std::ostringstream out;
  out << "GameDate " << game.GameDate << "\nDataPresent " << game.DataPresent << '\n';
  for (int team = 1; team <= TeamCount; ++team) {
    const ObjectiveTeam& objective = game.ObjectiveTeams(team);
    out << "Team " << game.TeamNames(team) << ' ' << game.TeamTotals(team) << "\nObjectiveTeam "
        << objective.Name << ' ' << objective.PrimaryAchieved << ' ' << objective.SecondaryAchieved << '\n';
  }
  return out.str();
}

/// Expects two games to be the same in all 224 records; reports only the first record that differs.
inline void ExpectSameGame(const Game& game, const Game& expected) {
  EXPECT_EQ(DescribedHeader(game), DescribedHeader(expected));
  for (int index = 1; index <= PlayerCount; ++index) {
    ASSERT_EQ(Described(game.Players(index)), Described(expected.Players(index))) << "player " << index;
  }
}
