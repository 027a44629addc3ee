#include <gmock/gmock.h>

#include "web/Pages.h"
#include "web/ResultsPages.h"

namespace {

using namespace std::chrono_literals;
using testing::Contains;
using testing::ElementsAre;
using testing::Field;
using testing::HasSubstr;
using testing::Key;
using testing::Not;

std::string NickNameOf(const NameHolder& holder) {
  return holder.NickName;
}

RankedHolder Ranked(std::int32_t member, const std::string& name, std::int64_t points) {
  const auto sum = static_cast<double>(points);
  return {.Holder = {.Member = member, .NickName = name},
          .Figures = {.Member = member, .Games = 2, .Sum = sum, .Best = sum - 1}};
}

std::vector<std::pair<int, std::string>> PlacesOf(const std::vector<RankedLine>& lines) {
  std::vector<std::pair<int, std::string>> places;
  for (const RankedLine& line : lines) {
    places.emplace_back(line.Place, line.Name);
  }
  return places;
}

TEST(RankedLines, ArePlacedByPointsWithEqualOnesTogether) {
  const PublicRanking ranking{"2026-11",
                              {Ranked(1, "Low", -3), Ranked(2, "High", 90), Ranked(3, "A", 50),
                               Ranked(4, "B", 50), Ranked(5, "C", 40)}};
  EXPECT_THAT(PlacesOf(RankedLines(ranking, NickNameOf)),
              ElementsAre(std::pair(1, "High"), std::pair(2, "A"), std::pair(2, "B"), std::pair(4, "C"),
                          std::pair(5, "Low")));
}

TEST(RankedLines, LeaveOutWhoHasNoNameToShow) {
  const PublicRanking ranking{"2026-11", {Ranked(1, "", 90), Ranked(2, "Mole", 50), Ranked(3, "Hidden", 40)}};
  const auto shown = [](const NameHolder& holder) { return holder.Member == 3 ? "" : holder.NickName; };
  EXPECT_THAT(PlacesOf(RankedLines(ranking, shown)), ElementsAre(std::pair(1, "Mole")));
}

TEST(RankedLines, AreNotMoreThanAPageHolds) {
  PublicRanking ranking{"2026-11", {}};
  for (int member = 1; member <= 300; ++member) {
    ranking.Members.push_back(Ranked(member, "M" + std::to_string(member), member));
  }
  const std::vector<RankedLine> lines = RankedLines(ranking, NickNameOf);
  ASSERT_EQ(lines.size(), MostRanked);
  EXPECT_EQ(lines.front().Name, "M300");
}

class RankingOnThePages : public testing::TestWithParam<Language> {
 protected:
  std::string Path() const { return GetParam() == Language::English ? "/en/month" : "/zh/month"; }
  std::string Front() const { return pages.Pages().at(FrontPath(GetParam())); }
  void Rank(const std::string& name) {
    RankedLine line{.Place = 1, .Name = name, .Games = 3, .Soldiering = 700, .Best = 300, .Accuracy = 0.456};
    pages.SetRanking(ResultsPages::MonthRanking{"2026-11", {line}});
  }

  ResultsPages pages{Language::English};
};

TEST_P(RankingOnThePages, IsThereOnlyWhereItIsWanted) {
  EXPECT_THAT(pages.Pages(), Not(Contains(Key(Path()))));
  EXPECT_THAT(Front(), Not(HasSubstr(Path())));
  Rank("Mole");
  EXPECT_THAT(Front(), HasSubstr("href=\"" + Path() + "\""));
  const std::string page = pages.Pages().at(Path());
  for (const char* text : {"2026-11", "Mole", "<td>3", "<td>700", "<td>300", "<td>46%"}) {
    EXPECT_THAT(page, HasSubstr(text));
  }
  pages.TakeChanges();
  pages.SetRanking(std::nullopt);
  EXPECT_THAT(pages.Pages(), Not(Contains(Key(Path()))));
  EXPECT_THAT(pages.TakeChanges(), Contains(Field(&PageFrame::Path, Path())));
  EXPECT_THAT(Front(), Not(HasSubstr(Path())));
}

TEST_P(RankingOnThePages, EscapesNames) {
  Rank("<b>\"&");
  EXPECT_THAT(pages.Pages().at(Path()), HasSubstr("&lt;b&gt;&quot;&amp;"));
}

TEST_P(RankingOnThePages, ChangesNothingWhereItIsTheSame) {
  Rank("Mole");
  pages.TakeChanges();
  Rank("Mole");
  EXPECT_TRUE(pages.TakeChanges().empty());
}

INSTANTIATE_TEST_SUITE_P(Languages, RankingOnThePages,
                         testing::Values(Language::English, Language::SimplifiedChinese));

}  // namespace
