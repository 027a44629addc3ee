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

std::map<std::int32_t, double> BestsOfAllKept(Sql& archive) {
  std::map<std::int32_t, double> bests;
  for (const MemberPeriod& member : ArchiveQueries(archive).Period({}, {})) {
    bests[member.Member] = static_cast<double>(member.SoldieringBest);
  }
  return bests;
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
  constexpr std::size_t yearDigits = 4;
  constexpr int lastMonth = 12;
  const int year = NumberInPeriod(std::string_view(period).substr(0, yearDigits));
  if (period.size() <= yearDigits) {
    return Digits(year + 1, yearDigits);
  }
  const int month = NumberInPeriod(std::string_view(period).substr(yearDigits + 1));
  return month < lastMonth ? Digits(year, yearDigits) + "-" + Digits(month + 1, 2)
                           : Digits(year + 1, yearDigits) + "-01";
}

std::vector<RankedFigures> FiguresOfPeriod(Sql& archive, const std::string& period) {
  std::vector<RankedFigures> figures;
  for (const MemberPeriod& member : ArchiveQueries(archive).Period(period, PeriodAfter(period))) {
    RankedFigures& of = figures.emplace_back();
    of.Member = member.Member;
    of.Games = member.Games;
    of.Sum = static_cast<double>(member.SoldieringSum);
    of.Best = static_cast<double>(member.SoldieringBest);
    if (member.AccuracyGames > 0) {
      of.Accuracy = member.AccuracySum / member.AccuracyGames;
    }
  }
  return figures;
}

std::vector<RankedFigures> FiguresOfLifetime(Sql& members, Sql* archive) {
  const std::map<std::int32_t, double> bests =
      archive != nullptr ? BestsOfAllKept(*archive) : std::map<std::int32_t, double>();
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
        if (const auto best = bests.find(of.Member); best != bests.end()) {
          of.Best = best->second;
        }
      });
  return figures;
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
