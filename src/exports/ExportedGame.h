#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "core/game/Game.h"
#include "core/game/Standings.h"

/// What a member is called in the members' table.
struct FullName {
  std::string First;
  std::string Last;
};

/// The name of the member with this `ContactID`; empty if there is no such member.
using FullNames = std::function<FullName(std::int32_t contactId)>;

/// One game as exports take it, with its scores calculated. Valid while the game is.
struct ExportedGame {
  const ::Game& Game;
  std::string Received;  ///< when it came in, "YYYY-MM-DD HH:MM:SS"; empty if nobody knows
  std::string Mission;
  std::vector<Standing> Standings;
  FullNames FullNameOf = {};  ///< asked only where the operator wants full names
};

/// What an export tells of a person beyond the public name.
struct PersonalData {
  bool FullNames = false;
  bool MemberNumbers = false;
  bool Buttons = false;

  bool operator==(const PersonalData&) const = default;
};

/// The public name of the player at record `index`, also of one who took no part: the gun.
std::string NameInGame(const ExportedGame& game, int index);

/// The full name of the player's member; empty without a member, or if nobody can tell.
FullName FullNameIn(const ExportedGame& game, int index);

/// Damage that one player did to another.
struct ExportedHit {
  int Shooter;  ///< record, 1 to 224
  int Victim;   ///< likewise
  std::int32_t Damage;
};

/// Every cell of the game's hits that is not 0, by shooter and then by victim; those who took no part
/// included.
std::vector<ExportedHit> HitsOf(const Game& game);
