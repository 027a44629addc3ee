#pragma once

#include <cstdint>
#include <string>

#include "core/game/DallasId.h"
#include "core/game/OneBased.h"
#include "core/game/PlayerId.h"
#include "core/text/StringTable.h"

/// One gun's game. The score analysis computes the "calculated" fields from the others.
struct Player {
  /// Damage this player took from player q; self-hits included.
  OneBased<std::int32_t, PlayerCount> HitByPlayer;
  std::int32_t ShotCount = 0;
  /// Calculated: damage dealt, own-team damage weighted by the friendly fire factor.
  std::int32_t TotalDamage = 0;
  /// Calculated: damage dealt, unweighted.
  std::int32_t AbsoluteDamage = 0;
  std::int32_t Soldiering = 0;  ///< calculated
  std::int32_t HealCount = 0;   ///< times healed ("W.I.A.")
  std::int32_t AmmoAddCount = 0;
  std::int32_t AdminKillCount = 0;
  std::int32_t RespawnCount = 0;
  std::int32_t RemainingHealth = 0;
  std::int32_t RemainingClips = 0;
  std::int32_t RemainingAmmo = 0;
  std::int32_t DeathCount = 0;       ///< "K.I.A."
  std::int32_t SecondaryDamage = 0;  ///< damage of one hit of the secondary weapon
  std::int32_t PrimaryDamage = 0;    ///< damage of one hit of the primary weapon
  float Accuracy = 0;                ///< calculated: fraction, 1.0 = all shots hit
  std::int32_t RunCounter = 0;       ///< the gun's running time in minutes
  bool Active = false;               ///< took part in the game
  std::int16_t Rank = 0;             ///< place on the board, 1 = first
  /// Membership button, 16 upper-case hexadecimal digits.
  std::string DallasID = NoDallasId;
  std::int32_t MemberIndex = 0;  ///< `ContactID` of the member, 0 = none
  bool Committed = false;        ///< this game was added to the member's totals
  std::int32_t BonusPoints = 0;
  std::int32_t ExplosiveDamage = 0;
  std::int32_t RadiationDamage = 0;
  std::int32_t StunCount = 0;
  std::uint8_t PowerCheatFlag = 0;

  /// Empties the record, except `AbsoluteDamage` and `Accuracy`, which the score analysis rewrites.
  void Clear();
};

/// The team that plays one of the mission's objective sets A, B, C, and what it achieved.
struct ObjectiveTeam {
  std::string Name;  ///< one of `TeamNames`
  bool PrimaryAchieved = false;
  bool SecondaryAchieved = false;
};

/// The game on the board. The table of players is always complete; those who took no part are not `Active`.
struct Game {
  explicit Game(const StringTable& strings);

  OneBased<Player, PlayerCount> Players;
  OneBased<std::string, TeamCount> TeamNames;
  /// Calculated: sum of `Soldiering` of a team's active players.
  OneBased<std::int32_t, TeamCount> TeamTotals;
  OneBased<ObjectiveTeam, TeamCount> ObjectiveTeams;
  /// Date and time in the locale's short form, or the text from a loaded file.
  std::string GameDate;
  /// True once a frame was decoded or a file loaded.
  bool DataPresent = false;

  /// Clears the players and the date. Team names and objective results stay for the next game.
  void Clear();

  /// Team name of the player at record `index`.
  const std::string& TeamName(int index) const { return TeamNames(TeamFromId(IdFromIndex(index))); }

  /// Display name of that player: "Blue  7".
  std::string DisplayName(int index) const { return PlayerName(TeamName(index), IdFromIndex(index)); }
};
