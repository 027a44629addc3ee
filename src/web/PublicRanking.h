#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "core/game/HiddenNames.h"
#include "core/game/MemberRanking.h"

/// What a member did in the games of a month, with the name that may be shown for it.
struct RankedHolder {
  NameHolder Holder = {};
  RankedFigures Figures = {};
};

/// The members who played in a month.
struct PublicRanking {
  std::string Month;  ///< "2026-11"
  std::vector<RankedHolder> Members;
};

/// A line of the ranking as a page may show it.
struct RankedLine {
  int Place = 0;  ///< 1 = first; equal ones share the place
  std::string Name = {};
  std::int64_t Games = 0;
  std::int64_t Soldiering = 0;          ///< sum
  std::int64_t Best = 0;                ///< of one game
  std::optional<double> Accuracy = {};  ///< mean of the games with one, as a fraction

  bool operator==(const RankedLine&) const = default;
};

/// How many lines a page has at most.
inline constexpr std::size_t MostRanked = 100;

/// Those whose name is shown, most points first. `nameShown` gives the name for a holder, or an empty text.
std::vector<RankedLine> RankedLines(const PublicRanking& ranking,
                                    const std::function<std::string(const NameHolder&)>& nameShown);
