#pragma once

#include <functional>
#include <string>
#include <vector>

#include "core/game/HiddenNames.h"
#include "core/game/Session.h"
#include "core/game/Standings.h"

/// The total of a team that took part.
struct AudienceTotal {
  int Team = 0;  ///< 1 to 3
  std::int32_t Points = 0;
};

/// What a player may be called.
struct AudienceName {
  NameHolder Holder;
  std::string Gun;  ///< "Blue 7"
};

/// A game as the audience sees it: figures of one moment, which change with nothing.
struct AudienceResults {
  std::string Mission;  ///< empty without one
  std::string Time;     ///< date and time as the game has them
  std::vector<Standing> Players;
  std::vector<AudienceName> Names;    ///< of the players, in their order
  std::vector<AudienceTotal> Totals;  ///< highest first

  bool IsEmpty() const { return Players.empty(); }
};

/// The game on the session's board, whose scores are calculated. The session must be open.
/// Members whose rows cannot be read stand there by their guns.
AudienceResults ResultsOf(Session& session, const GuestNames& guests);

/// Gives the members among the players the nicknames that they have now; those of none that is gone. Where
/// they cannot be read, all stay as they are.
void LookUpNickNames(AudienceResults& results, Session& session);

/// Calls the players as `nameShown` says; by their guns where it gives an empty text.
void ShowNames(AudienceResults& results, const std::function<std::string(const NameHolder&)>& nameShown);

/// First letter of the team's name: "R".
std::string TeamLetter(const StringTable& strings, int team);

/// A gun where there is no room for its name: "R7".
std::string ShortGunName(const StringTable& strings, const Standing& standing);
