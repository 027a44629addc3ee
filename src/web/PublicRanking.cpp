#include "web/PublicRanking.h"

#include <cmath>
#include <map>
#include <utility>

namespace {

RankedLine LineOf(const RankedPlace& place, std::string name) {
  const RankedFigures& figures = place.Figures;
  return {.Place = place.Place,
          .Name = std::move(name),
          .Games = figures.Games,
          .Soldiering = std::llround(figures.Sum),
          .Best = std::llround(figures.Best.value_or(0)),
          .Accuracy = figures.Accuracy};
}

}  // namespace

std::vector<RankedLine> RankedLines(const PublicRanking& ranking,
                                    const std::function<std::string(const NameHolder&)>& nameShown) {
  std::map<std::int32_t, std::string> names;
  std::vector<RankedFigures> figures;
  for (const RankedHolder& member : ranking.Members) {
    if (std::string name = nameShown(member.Holder); !name.empty()) {
      names[member.Figures.Member] = std::move(name);
      figures.push_back(member.Figures);
    }
  }
  std::vector<RankedLine> lines;
  for (const RankedPlace& place : PlacedBy(RankedBy::Sum, figures, 1)) {
    if (lines.size() < MostRanked) {
      lines.push_back(LineOf(place, names[place.Figures.Member]));
    }
  }
  return lines;
}
