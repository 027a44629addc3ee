#include "app/ChartPlayers.h"

#include <string>
#include <utility>

ChartPlayer PlayerOfChart(const Game& game, int index, const NickNames& nickNames,
                          const GuestNames& guestNames, const HiddenNames& hidden) {
  std::string name = game.DisplayName(index);
  if (const std::string shown = hidden.NameShown(HolderOf(game, index, nickNames, guestNames));
      !shown.empty()) {
    name.append(" (").append(shown).append(")");
  }
  return {index, std::move(name)};
}
