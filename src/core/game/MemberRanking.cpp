#include "core/game/MemberRanking.h"

#include <algorithm>
#include <tuple>

namespace {

std::optional<double> RankValue(const RankedFigures& figures, RankedBy by) {
  switch (by) {
    case RankedBy::Sum:
      return figures.Sum;
    case RankedBy::Mean:
      return figures.Mean();
    case RankedBy::Best:
      return figures.Best;
    case RankedBy::Accuracy:
      return figures.Accuracy;
    case RankedBy::Games:
      break;
  }
  return static_cast<double>(figures.Games);
}

}  // namespace

std::vector<RankedPlace> PlacedBy(RankedBy by, const std::vector<RankedFigures>& figures,
                                  std::int64_t leastGames) {
  std::vector<RankedPlace> ranked;
  for (const RankedFigures& each : figures) {
    if (each.Games >= leastGames && RankValue(each, by)) {
      ranked.push_back({.Figures = each});
    }
  }
  const auto order = [by](const RankedPlace& place) {
    const RankedFigures& of = place.Figures;
    return std::tuple(-*RankValue(of, by), -of.Games, -of.Sum, of.Member);
  };
  std::sort(ranked.begin(), ranked.end(), [&order](const RankedPlace& left, const RankedPlace& right) {
    return order(left) < order(right);
  });
  for (std::size_t i = 0; i < ranked.size(); ++i) {
    const bool isEqual = i > 0 && *RankValue(ranked[i].Figures, by) == *RankValue(ranked[i - 1].Figures, by);
    ranked[i].Place = isEqual ? ranked[i - 1].Place : static_cast<int>(i) + 1;
  }
  return ranked;
}
