#pragma once

#include <cstdint>
#include <string>

#include "core/data/IniReader.h"

/// Where nicknames and guest names are shown.
enum class NamesShown {
  OnBoard,         ///< on the board for the audience, and in lists on paper
  OnBoardAndPage,  ///< there and on the pages
  Nowhere          ///< guns only
};

/// What the operator has set for the results page.
struct PageSetup {
  bool On = false;
  std::string Address = {};   ///< at which it is served; empty for that of the default route
  std::uint16_t Port = 8080;  ///< 1024 to 65535; the next free one is taken where it is not free
  NamesShown Names = NamesShown::OnBoard;
  int Games = 10;          ///< of this evening, 1 to 30
  bool WithBoard = false;  ///< a new game appears once the board shows it
  bool Ranking = false;    ///< that of the month is shown

  bool operator==(const PageSetup&) const = default;
};

namespace PageLimits {
inline constexpr int LeastPort = 1024;
inline constexpr int MostPort = 65535;
inline constexpr int LeastGames = 1;
inline constexpr int MostGames = 30;
}  // namespace PageLimits

/// Numbers outside their ranges and what is no number count as the default.
PageSetup ReadPageSetup(const IniReader& ini);

/// Writes what differs between the two.
void WritePageSetup(IniReader& ini, const PageSetup& before, const PageSetup& now);
