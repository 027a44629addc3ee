#include "app/MonthRanks.h"

#include "archive/ArchiveQueries.h"

PublicRanking MonthRanks(const MonthRankSources& sources) {
  constexpr std::size_t lengthOfMonth = 7;
  PublicRanking ranking{.Month = sources.Now.substr(0, lengthOfMonth), .Members = {}};
  const ReadScope scope(sources.DbMembers);
  // Later than every day of the month, and earlier than the next one.
  const std::string end = ranking.Month + "-32";
  for (const MemberPeriod& member : ArchiveQueries(sources.Archive).Period(ranking.Month, end)) {
    ranking.Members.push_back(
        {.Holder = {.Member = member.Member, .NickName = CleanName(sources.NickNameOf(member.Member))},
         .Games = member.Games,
         .Soldiering = member.SoldieringSum,
         .Best = member.SoldieringBest,
         .Accuracy = member.AccuracyGames > 0 ? std::optional(member.AccuracySum / member.AccuracyGames)
                                              : std::nullopt});
  }
  return ranking;
}
