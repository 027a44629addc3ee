#pragma once

#include <cstdint>
#include <set>
#include <string>

#include "core/game/Game.h"

/// Whom to take out of past games.
struct GamePersons {
  std::set<std::int32_t> Numbers = {};      ///< of members
  std::set<std::string> GuestButtons = {};  ///< of players without a member number
  bool TakesButtons = false;                ///< from the players with these numbers too

  bool AreNone() const { return Numbers.empty() && GuestButtons.empty(); }

  /// True if a player with this member number (0 without one) and button is one of them.
  bool Include(std::int32_t number, const std::string& button) const {
    return number != 0 ? Numbers.contains(number) : GuestButtons.contains(button);
  }

  /// What to take from such a player: the number, and the button where that goes too.
  void TakeFrom(Player& player) const;
  /// Does so with all players of the game who are one of them; false if there is none.
  bool TakeFrom(Game& game) const;
};
