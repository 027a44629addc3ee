#include "web/PublicRanking.h"

#include <algorithm>
#include <utility>

std::vector<RankedLine> RankedLines(const PublicRanking& ranking,
                                    const std::function<std::string(const NameHolder&)>& nameShown) {
  std::vector<RankedLine> lines;
  for (const RankedHolder& member : ranking.Members) {
    if (std::string name = nameShown(member.Holder); !name.empty()) {
      lines.push_back({.Name = std::move(name),
                       .Games = member.Games,
                       .Soldiering = member.Soldiering,
                       .Best = member.Best,
                       .Accuracy = member.Accuracy});
    }
  }
  std::ranges::stable_sort(lines, std::greater(), &RankedLine::Soldiering);
  for (std::size_t at = 0; at < lines.size(); ++at) {
    const bool isEqual = at > 0 && lines[at].Soldiering == lines[at - 1].Soldiering;
    lines[at].Place = isEqual ? lines[at - 1].Place : static_cast<int>(at) + 1;
  }
  if (lines.size() > MostRanked) {
    lines.resize(MostRanked);
  }
  return lines;
}
