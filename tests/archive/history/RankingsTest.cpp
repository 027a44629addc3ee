#include "archive/history/Rankings.h"

#include <gmock/gmock.h>

#include "exports/Csv.h"
#include "tests/archive/history/HistoryVenue.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

RankedFigures FiguresOf(std::int32_t member, std::int64_t games, double sum, std::optional<double> best = {},
                        std::optional<double> accuracy = {}) {
  return {.Member = member, .Games = games, .Sum = sum, .Best = best, .Accuracy = accuracy};
}

/// "place:member" of each row.
std::vector<std::string> PlacesOf(const std::vector<RankedMember>& ranked) {
  std::vector<std::string> places;
  for (const RankedMember& member : ranked) {
    places.push_back(std::to_string(member.Place) + ":" + std::to_string(member.Figures.Member));
  }
  return places;
}

class FourFigures : public testing::Test {
 protected:
  std::vector<std::string> By(RankedBy by, std::int64_t least = 1) const {
    return PlacesOf(Ranked(figures, by, least));
  }

  const std::vector<RankedFigures> figures = {FiguresOf(4, 10, 300, 90, 0.2), FiguresOf(3, 2, 300, 200, 0.2),
                                              FiguresOf(2, 2, -10, -1), FiguresOf(1, 3, 301, 90, 0.1)};
};

TEST_F(FourFigures, AreRankedByEachOfThem) {
  EXPECT_THAT(By(RankedBy::Sum), ElementsAre("1:1", "2:4", "2:3", "4:2"));
  EXPECT_THAT(By(RankedBy::Mean), ElementsAre("1:3", "2:1", "3:4", "4:2"));
  EXPECT_THAT(By(RankedBy::Best), ElementsAre("1:3", "2:4", "2:1", "4:2"));
  EXPECT_THAT(By(RankedBy::Accuracy), ElementsAre("1:4", "1:3", "3:1"));
  EXPECT_THAT(By(RankedBy::Games), ElementsAre("1:4", "2:1", "3:3", "3:2"));
}

TEST_F(FourFigures, NeedTheLeastNumberOfGames) {
  EXPECT_THAT(By(RankedBy::Mean, 3), ElementsAre("1:1", "2:4"));
  EXPECT_THAT(By(RankedBy::Mean, 11), IsEmpty());
}

TEST(Rankings, OfEqualOnesAreInTheOrderOfNumbers) {
  EXPECT_THAT(
      PlacesOf(Ranked({FiguresOf(9, 1, 5), FiguresOf(7, 1, 5), FiguresOf(8, 1, 5)}, RankedBy::Sum, 1)),
      ElementsAre("1:7", "1:8", "1:9"));
}

TEST(Rankings, KnowTheMonthOrYearThatFollows) {
  EXPECT_EQ(PeriodAfter("2026-09"), "2026-10");
  EXPECT_EQ(PeriodAfter("2026-12"), "2027-01");
  EXPECT_EQ(PeriodAfter("2026"), "2027");
}

class RankedVenue : public testing::Test, protected HistoryVenue {
 protected:
  RankedVenue() {
    Keep("2026-10-31 23:59:59", 100);
    Keep("2026-11-01 00:00:00", 30);
    Keep("2026-12-31 23:59:59", 20);
    Keep("2027-01-01 00:00:00", 1000);
    InMembers(
        "UPDATE Members SET TotalGamesPlayed = 20, TotalSoldiering = 5000, TotalPrimaryAccuracy = 4.5, "
        "PriZeroAccuracyCount = 2 WHERE ContactID = 5");
  }

  std::vector<RankedMember> Of(const std::string& period, RankedBy by = RankedBy::Sum) {
    std::vector<RankedMember> ranked = Ranked(FiguresOfPeriod(ArchiveSql(), period), by, 1);
    NameRanked(ranked, *MembersDatabase);
    return ranked;
  }
};

TEST_F(RankedVenue, RanksAMonthAndAYear) {
  const std::vector<RankedMember> november = Of("2026-11");
  ASSERT_EQ(november.size(), 2U);
  EXPECT_EQ(november[0].Figures.Member, 6);
  EXPECT_EQ(november[0].Figures.Sum, 40);
  EXPECT_EQ(november[1].Figures.Sum, 30);
  const std::vector<RankedMember> year = Of("2026");
  EXPECT_EQ(year[0].Figures.Member, 5);
  EXPECT_EQ(year[0].Figures.Games, 3);
  EXPECT_EQ(year[0].Figures.Sum, 150);
  EXPECT_EQ(year[0].Figures.Best, 100);
  EXPECT_EQ(year[0].Figures.Accuracy, 0.25);
  EXPECT_EQ(year[1].Figures.Accuracy, std::nullopt);
}

TEST_F(RankedVenue, ReadsAYearAndAllTimeInStepsThatCanBeStopped) {
  std::vector<double> parts;
  const auto all = [&parts](double done) {
    parts.push_back(done);
    return true;
  };
  EXPECT_EQ(FiguresInSteps(ArchiveSql(), "2026", all)->size(), 2U);
  EXPECT_EQ(parts.size(), 12U);
  EXPECT_EQ(parts.front(), 0);
  EXPECT_TRUE(std::is_sorted(parts.begin(), parts.end()));
  parts.clear();
  EXPECT_EQ(FiguresInSteps(ArchiveSql(), "2026-11", all)->size(), 2U);
  EXPECT_EQ(parts.size(), 1U);
  parts.clear();
  EXPECT_EQ(LifetimeInSteps(MembersSql(), ArchiveSql(), all)->at(0).Best, 1000);
  EXPECT_EQ(parts.size(), 4U);
  const auto half = [](double done) { return done < 0.5; };
  EXPECT_FALSE(FiguresInSteps(ArchiveSql(), "2026", half).has_value());
  EXPECT_FALSE(LifetimeInSteps(MembersSql(), ArchiveSql(), half).has_value());
}

TEST_F(RankedVenue, RanksAllTimeByTheLifetimeFigures) {
  const std::vector<RankedFigures> all = FiguresOfLifetime(MembersSql(), nullptr);
  ASSERT_EQ(all.size(), 1U);
  EXPECT_EQ(all[0].Games, 20);
  EXPECT_EQ(all[0].Mean(), 250);
  EXPECT_EQ(all[0].Accuracy, 0.25);
  EXPECT_EQ(all[0].Best, std::nullopt);
  EXPECT_EQ(FiguresOfLifetime(MembersSql(), &ArchiveSql()).at(0).Best, 1000);
}

TEST_F(RankedVenue, ShowsPublicNamesOnly) {
  const std::vector<RankedMember> november = Of("2026-11");
  EXPECT_EQ(november[1].PublicName, "Mole");
  EXPECT_EQ(november[1].FullName, "Bo Ray");
  EXPECT_EQ(november[0].PublicName, "");
  EXPECT_THAT(RankingTexts(november[1], Strings),
              ElementsAre("2", "Mole", "1", "30", "30.0", "30", "25.00%"));
  EXPECT_THAT(RankingTexts(november[0], Strings),
              ElementsAre("1", "(no nickname)", "1", "40", "40.0", "40", ""));
}

TEST_F(RankedVenue, ShowsNoNameOfWhoHidesIt) {
  std::vector<RankedMember> ranked = Ranked(FiguresOfPeriod(ArchiveSql(), "2026-11"), RankedBy::Sum, 1);
  NameRanked(ranked, *MembersDatabase, [](std::int32_t member) { return member == 5; });
  EXPECT_EQ(ranked[1].PublicName + ranked[1].FullName, "");
  EXPECT_EQ(ranked[0].FullName, "Cy Fox");
}

TEST_F(RankedVenue, NamesManyMembersLikeFew) {
  std::vector<RankedFigures> figures = FiguresOfPeriod(ArchiveSql(), "2026-11");
  for (std::int32_t number = 100; number < 2200; ++number) {
    figures.push_back(FiguresOf(number, 1, 1));
  }
  std::vector<RankedMember> ranked = Ranked(figures, RankedBy::Sum, 1);
  NameRanked(ranked, *MembersDatabase);
  EXPECT_EQ(ranked[0].FullName, "Cy Fox");
  EXPECT_EQ(ranked[1].PublicName, "Mole");
  EXPECT_EQ(ranked[2].PublicName, "");
}

TEST_F(RankedVenue, IsATableForOtherPrograms) {
  const std::string csv = RankingCsv(Of("2026-11"), false, Strings);
  EXPECT_EQ(csv,
            "\xEF\xBB\xBFPlace,Player,Games,Sum,Mean,Best,Accuracy\r\n"
            "1,\"\",1,40,40,40,\r\n2,Mole,1,30,30,30,0.25\r\n");
  const std::string named = RankingCsv(Of("2026-11"), true, Strings);
  EXPECT_THAT(named, HasSubstr("Place,Player,Name,Games"));
  EXPECT_THAT(named, HasSubstr("2,Mole,Bo Ray,1,30"));
}

TEST_F(RankedVenue, IsAPageWithNamesMadeHarmless) {
  InMembers("UPDATE Members SET NickName = '<b>&Mole' WHERE ContactID = 5");
  const std::string page = RankingPage("Rankings 2026-11", Of("2026-11"), false, Strings);
  EXPECT_THAT(page, HasSubstr("Rankings 2026-11"));
  EXPECT_THAT(page, HasSubstr("&lt;b&gt;&amp;Mole"));
  EXPECT_THAT(page, Not(HasSubstr("Ray")));
  EXPECT_THAT(RankingPage("Rankings", Of("2026-11"), true, Strings), HasSubstr("Bo Ray"));
}

}  // namespace
