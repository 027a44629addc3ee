#pragma once

#include <cstdint>

/// Which sheets to make.
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

/// What the operator last chose to print; kept between uses of the window.
struct PrintChoice {
  std::int16_t SheetSelection = SheetSelection::Nothing;
  bool RankHidden = false;
  std::int16_t OutputTarget = 0;    ///< 0 until the first valid choice
  std::int16_t SelectedTeam = 0;    ///< 1 to 3
  std::int16_t SelectedNumber = 0;  ///< 0 to 95
};

/// The contents of the window's controls when OK is pressed.
struct PrintEntries {
  std::int16_t SheetSelection;  ///< of the checked option button
  int PlayersTeamIndex;         ///< of `TeamID`, from 0
  int PlayerIndex;              ///< of `PlayerID`, from 0
  int TeamIndex;                ///< of `TeamID2`, from 0
  bool ToFiles;
  bool HideRank;
};

/// Copies the entries into `choice`. If the player's number is too high for the team, returns false and
/// leaves output target and rank unchanged, though the selection is still copied. The check runs for every
/// selection; where team and number are not used, it sees the values left by earlier uses.
bool TakeEntries(const PrintEntries& entries, PrintChoice& choice);
