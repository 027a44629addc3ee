#include "archive/past/PastSearch.h"

#include <algorithm>
#include <unordered_set>

GameFilter FilterOf(const PastSearch& search, ListedPast which, const std::string& month) {
  GameFilter filter{.From = search.From,
                    .Before = {},
                    .Mission = search.Mission,
                    .Members = search.Members,
                    .Player = search.Player,
                    .Deleted = which == ListedPast::Deleted};
  if (!search.Until.empty()) {
    filter.Before = search.Until + " 24";  // behind the last second of that day
  }
  if (which == ListedPast::Month) {
    const std::string behind = month + "-99";
    filter.From = std::max(filter.From, month);
    filter.Before = filter.Before.empty() ? behind : std::min(filter.Before, behind);
  }
  return filter;
}

std::string DayOf(const std::string& time) {
  constexpr std::size_t length = 10;
  return time.substr(0, length);
}

std::int64_t GameAfter(const std::vector<std::int64_t>& games, const std::vector<std::int64_t>& gone) {
  const std::unordered_set<std::int64_t> without(gone.begin(), gone.end());
  std::int64_t above = 0;
  std::int64_t below = 0;
  bool passed = false;
  for (const std::int64_t game : games) {
    if (without.contains(game)) {
      passed = true;
      below = 0;
    } else {
      above = game;
      below = passed && below == 0 ? game : below;
    }
  }
  return below != 0 ? below : above;
}
