#include "app/MonthRanks.h"

#include "archive/history/Rankings.h"

PublicRanking MonthRanks(const MonthRankSources& sources) {
  constexpr std::size_t lengthOfMonth = 7;
  PublicRanking ranking{.Month = sources.Now.substr(0, lengthOfMonth), .Members = {}};
  const ReadScope scope(sources.DbMembers);
  for (const RankedFigures& figures : FiguresOfPeriod(sources.Archive, ranking.Month)) {
    ranking.Members.push_back(
        {.Holder = {.Member = figures.Member, .NickName = CleanName(sources.NickNameOf(figures.Member))},
         .Figures = figures});
  }
  return ranking;
}
