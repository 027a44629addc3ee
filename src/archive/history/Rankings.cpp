#include "archive/history/Rankings.h"

#include <array>
#include <charconv>
#include <map>

#include "archive/ArchiveQueries.h"
#include "core/data/FieldValue.h"
#include "core/game/PublicName.h"
#include "core/text/NumberForms.h"

namespace {

int NumberInPeriod(std::string_view digits) {
  int number = 0;
  std::from_chars(digits.data(), digits.data() + digits.size(), number);
  return number;
}

/// `number` with at least `width` digits.
std::string Digits(int number, std::size_t width) {
  std::string digits = std::to_string(number);
  return digits.insert(0, digits.size() < width ? width - digits.size() : 0, '0');
}

/// Of a period that is a year.
constexpr std::size_t YearDigits = 4;

using MembersInPeriod = std::map<std::int32_t, MemberPeriod>;

void AddPeriod(MembersInPeriod& all, const MemberPeriod& part) {
  const auto [found, isNew] = all.try_emplace(part.Member, part);
  if (isNew) {
    return;
  }
  MemberPeriod& sum = found->second;
  sum.Games += part.Games;
  sum.SoldieringSum += part.SoldieringSum;
  sum.SoldieringBest = std::max(sum.SoldieringBest, part.SoldieringBest);
  sum.AccuracySum += part.AccuracySum;
  sum.AccuracyGames += part.AccuracyGames;
}

/// The first month with a game that is not before `earliest`; empty without one.
std::string MonthFrom(Sql& archive, const std::string& earliest) {
  constexpr std::size_t length = 7;
  std::string month;
  archive.Query("SELECT min(Played) FROM Games WHERE Played >= $1", {earliest},
                [&month](const SqlRow& row) { month = row.Text(0).substr(0, length); });
  return month;
}

/// The months of a month or year; all with games where `period` is empty.
std::vector<std::string> MonthsIn(Sql& archive, const std::string& period) {
  constexpr int lastMonth = 12;
  std::vector<std::string> months;
  if (period.empty()) {
    // From one to the next in the index, however many games each has.
    for (std::string next = MonthFrom(archive, {}); !next.empty();) {
      months.push_back(next);
      const std::string later = PeriodAfter(next);
      next = later > next ? MonthFrom(archive, later) : std::string();
    }
  } else if (period.size() > YearDigits) {
    months.push_back(period);
  } else {
    for (int month = 1; month <= lastMonth; ++month) {
      months.push_back(period + "-" + Digits(month, 2));
    }
  }
  return months;
}

/// Month by month; nothing if `goOn` ended it.
std::optional<MembersInPeriod> ReadMonths(Sql& archive, const std::string& period, const RankingStep& goOn) {
  ArchiveQueries queries(archive);
  const std::vector<std::string> months = MonthsIn(archive, period);
  MembersInPeriod members;
  for (std::size_t read = 0; read < months.size(); ++read) {
    if (!goOn(static_cast<double>(read) / static_cast<double>(months.size()))) {
      return std::nullopt;
    }
    for (const MemberPeriod& member : queries.Period(months[read], PeriodAfter(months[read]))) {
      AddPeriod(members, member);
    }
  }
  return members;
}

bool WithoutStop(double /*done*/) {
  return true;
}

std::vector<RankedFigures> Lifetimes(Sql& members, const MembersInPeriod& kept) {
  std::vector<RankedFigures> figures;
  members.Query(
      "SELECT ContactID, TotalGamesPlayed, TotalSoldiering, TotalPrimaryAccuracy, PriZeroAccuracyCount "
      "FROM Members WHERE TotalGamesPlayed > 0",
      {}, [&](const SqlRow& row) {
        RankedFigures& of = figures.emplace_back();
        of.Member = static_cast<std::int32_t>(row.Integer(0));
        of.Games = static_cast<std::int64_t>(NumberOf(row[1]));
        of.Sum = NumberOf(row[2]);
        if (const double accurate = static_cast<double>(of.Games) - NumberOf(row[4]); accurate > 0) {
          of.Accuracy = NumberOf(row[3]) / accurate;
        }
        if (const auto best = kept.find(of.Member); best != kept.end()) {
          of.Best = static_cast<double>(best->second.SoldieringBest);
        }
      });
  return figures;
}

/// For more than these the table of members is read once, instead of a row for each.
constexpr std::size_t MostNamesOneByOne = 2000;

/// `row` has number, nickname, first and last name.
void TakeNames(RankedMember& member, const SqlRow& row) {
  member.PublicName = CleanName(TextOf(row[1]));
  const std::string first = TextOf(row[2]);
  const std::string last = TextOf(row[3]);
  member.FullName = first;
  member.FullName.append(first.empty() || last.empty() ? "" : " ").append(last);
}

}  // namespace

std::vector<RankedMember> Ranked(const std::vector<RankedFigures>& figures, RankedBy by,
                                 std::int64_t leastGames) {
  std::vector<RankedMember> ranked;
  for (const RankedPlace& place : PlacedBy(by, figures, leastGames)) {
    ranked.push_back({.Place = place.Place, .Figures = place.Figures});
  }
  return ranked;
}

std::string PeriodAfter(const std::string& period) {
  constexpr int lastMonth = 12;
  const int year = NumberInPeriod(std::string_view(period).substr(0, YearDigits));
  if (period.size() <= YearDigits) {
    return Digits(year + 1, YearDigits);
  }
  const int month = NumberInPeriod(std::string_view(period).substr(YearDigits + 1));
  return month < lastMonth ? Digits(year, YearDigits) + "-" + Digits(month + 1, 2)
                           : Digits(year + 1, YearDigits) + "-01";
}

std::optional<std::vector<RankedFigures>> FiguresInSteps(Sql& archive, const std::string& period,
                                                         const RankingStep& goOn) {
  const std::optional<MembersInPeriod> members = ReadMonths(archive, period, goOn);
  if (!members) {
    return std::nullopt;
  }
  std::vector<RankedFigures> figures;
  for (const auto& [number, member] : *members) {
    RankedFigures& of = figures.emplace_back();
    of.Member = number;
    of.Games = member.Games;
    of.Sum = static_cast<double>(member.SoldieringSum);
    of.Best = static_cast<double>(member.SoldieringBest);
    if (member.AccuracyGames > 0) {
      of.Accuracy = member.AccuracySum / member.AccuracyGames;
    }
  }
  return figures;
}

std::vector<RankedFigures> FiguresOfPeriod(Sql& archive, const std::string& period) {
  return *FiguresInSteps(archive, period, WithoutStop);
}

std::optional<std::vector<RankedFigures>> LifetimeInSteps(Sql& members, Sql& archive,
                                                          const RankingStep& goOn) {
  const std::optional<MembersInPeriod> kept = ReadMonths(archive, {}, goOn);
  return kept ? std::optional(Lifetimes(members, *kept)) : std::nullopt;
}

std::vector<RankedFigures> FiguresOfLifetime(Sql& members, Sql* archive) {
  return archive != nullptr ? *LifetimeInSteps(members, *archive, WithoutStop) : Lifetimes(members, {});
}

void NameRanked(std::vector<RankedMember>& ranked, Database& members, const HidesName& hidesName) {
  std::map<std::int64_t, RankedMember*> unnamed;
  for (RankedMember& member : ranked) {
    if (!hidesName || !hidesName(member.Figures.Member)) {
      unnamed[member.Figures.Member] = &member;
    }
  }
  const std::string columns = "SELECT ContactID, NickName, FirstName, LastName FROM Members";
  const auto take = [&unnamed](const SqlRow& row) {
    if (const auto found = unnamed.find(row.Integer(0)); found != unnamed.end()) {
      TakeNames(*found->second, row);
    }
  };
  if (unnamed.size() > MostNamesOneByOne) {
    members.Statements().Query(columns, {}, take);
    return;
  }
  const ReadScope scope(members);
  const std::string one = columns + " WHERE ContactID = $1";
  for (const auto& [number, member] : unnamed) {
    members.Statements().Query(one, {number}, take);
  }
}

std::vector<std::string> RankingTexts(const RankedMember& member, const StringTable& strings) {
  const RankedFigures& figures = member.Figures;
  return {std::to_string(member.Place),
          member.PublicName.empty() ? strings.Text(OwnText::NoPublicName) : member.PublicName,
          std::to_string(figures.Games),
          PlainDecimal(figures.Sum),
          FormatFixed(figures.Mean(), 1),
          figures.Best ? PlainDecimal(*figures.Best) : std::string(),
          figures.Accuracy ? FormatPercent(*figures.Accuracy) : std::string()};
}
