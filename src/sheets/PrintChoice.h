#pragma once

#include <cstdint>

/// Which sheets are wanted.
namespace SheetSelection {
inline constexpr std::int16_t Nothing = 0;
inline constexpr std::int16_t OnePlayer = 1;
inline constexpr std::int16_t Team = 500;
inline constexpr std::int16_t All = 1000;  ///< all 224 records, also those that took no part
inline constexpr std::int16_t Active = 1001;
}  // namespace SheetSelection

namespace OutputTarget {
inline constexpr std::int16_t Printer = 1;
inline constexpr std::int16_t Files = 2;
}  // namespace OutputTarget

/// What the operator wants printed; kept from one use of the window to the next.
struct PrintChoice {
  std::int16_t SheetSelection = SheetSelection::Nothing;
  bool RankHidden = false;
  std::int16_t OutputTarget = 0;    ///< 0 until the first valid choice
  std::int16_t SelectedTeam = 0;    ///< 1 to 3
  std::int16_t SelectedNumber = 0;  ///< 0 to 95
};

/// What stands in the window's controls when OK is pressed.
struct PrintEntries {
  std::int16_t SheetSelection;  ///< of the option button that is set
  int PlayersTeamIndex;         ///< of `TeamID`, from 0
  int PlayerIndex;              ///< of `PlayerID`, from 0
  int TeamIndex;                ///< of `TeamID2`, from 0
  bool ToFiles;
  bool HideRank;
};

/// Takes over what was entered. Returns false, and leaves output and rank as they were, when the player's
/// number is too high for the team; the selection stands even so. The test is made for every selection, with
/// the team and number that earlier uses left.
bool TakeEntries(const PrintEntries& entries, PrintChoice& choice);
