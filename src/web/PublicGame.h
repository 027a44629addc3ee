#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "core/game/Game.h"
#include "core/game/PublicName.h"

/// What everybody in the hall may know of a game. Pages are made of this and of nothing else: there is no
/// place here for first and last names, buttons or numbers of members.

/// Damage that a player dealt to, or took from, another gun.
struct PublicHit {
  int Gun = 0;              ///< record of the gun, 1 to 224
  std::int32_t Amount = 0;  ///< above 0

  bool operator==(const PublicHit&) const = default;
};

struct PublicPlayer {
  int Place = 0;          ///< 1 = first
  int Gun = 0;            ///< record of the gun, 1 to 224
  std::string Name = {};  ///< empty where the gun alone is shown
  std::int32_t Soldiering = 0;
  std::optional<float> Accuracy = {};  ///< fraction, 1.0 = all shots hit; none where the board shows none
  std::int32_t DamageDealt = 0;
  std::int64_t DamageTaken = 0;
  std::int32_t Shots = 0;
  std::int32_t Wia = 0;
  std::int32_t Kia = 0;
  std::int32_t AmmoAdds = 0;
  std::vector<PublicHit> HitsGiven = {};  ///< most damage first
  std::vector<PublicHit> HitsTaken = {};

  bool operator==(const PublicPlayer&) const = default;
};

struct PublicGame {
  int Number = 0;         ///< counts the games of an evening, from 1
  std::string Time = {};  ///< when it was played, as the pages show it
  std::vector<PublicPlayer> Players = {};
  std::array<std::int64_t, TeamCount> TeamTotals{};  ///< sums of soldiering; index 0 is team 1

  bool operator==(const PublicGame&) const = default;
};

/// Which names a page may show.
struct ShownNames {
  bool Shown = false;  ///< guns only, until the operator switches names on
  NickNames OfMembers;
  GuestNames OfGuests;
  std::function<bool(int index)> Hidden;  ///< true for the record of a player whose name is taken off
};

/// The game as it may be shown; its scores are calculated. `time` is cut like a name.
PublicGame PublicGameOf(const Game& game, int number, std::string_view time, const ShownNames& names);

/// Team of a gun, 1 to 3.
int TeamOfGun(int gun);
