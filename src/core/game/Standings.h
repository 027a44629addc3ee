#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "core/game/Game.h"
#include "core/game/PublicName.h"

/// A player's place in a game and the figures that go with it, as every screen, list and file but the board
/// itself shows them.
struct Standing {
  int Place = 0;   ///< 1 = first; consecutive, also among equals
  int Index = 0;   ///< record of the player, 1 to 224
  int Team = 0;    ///< 1 to 3
  int Number = 0;  ///< of the gun within its team, 0 to 95
  std::int32_t Soldiering = 0;
  std::optional<float> Accuracy =
      {};                        ///< fraction, 1.0 = all shots hit; none where the board shows no figure
  std::int32_t DamageDealt = 0;  ///< as on the board: hits on the own team weighted
  std::int64_t DamageTaken = 0;  ///< from all players, the own team and the player included
  std::int32_t Shots = 0;
  std::int32_t Wia = 0;
  std::int32_t Kia = 0;
  std::int32_t AmmoAdds = 0;
  std::string PublicName = {};
};

/// The active players of a game whose scores are calculated: highest soldiering first, equal ones in record
/// order, however the board is sorted. The records' `Rank` is neither read nor written.
std::vector<Standing> Standings(const Game& game, const NickNames& nickNames,
                                const GuestNames& guestNames = {});
