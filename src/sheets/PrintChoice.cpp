#include "sheets/PrintChoice.h"

#include "core/game/PlayerId.h"

bool TakeEntries(const PrintEntries& entries, PrintChoice& choice) {
  choice.SheetSelection = entries.SheetSelection;
  if (entries.SheetSelection == SheetSelection::OnePlayer) {
    choice.SelectedTeam = static_cast<std::int16_t>(entries.PlayersTeamIndex + 1);
    choice.SelectedNumber = static_cast<std::int16_t>(entries.PlayerIndex);
  } else if (entries.SheetSelection == SheetSelection::Team) {
    choice.SelectedTeam = static_cast<std::int16_t>(entries.TeamIndex + 1);
  }
  if (choice.SelectedNumber > MaxPlayerNumber(choice.SelectedTeam)) {
    return false;
  }
  choice.OutputTarget = entries.ToFiles ? OutputTarget::Files : OutputTarget::Printer;
  choice.RankHidden = entries.HideRank;
  return true;
}
