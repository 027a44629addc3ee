#include "audience/AudienceLayout.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

namespace {

/// A wide screen of 1080 lines.
AudiencePlace PlaceOf(double inches, double metres) {
  constexpr int width = 1920;
  constexpr int height = 1080;
  return {width, height, MillimetresPerPixel(inches, width, height), metres};
}

AudienceContents ContentsOf(int players) {
  return {.Players = players,
          .Teams = std::min(players, 3),
          .Place = players > 99  ? 2.8
                   : players > 9 ? 1.9
                                 : 1,
          .Gun = 3,
          .Name = 16,
          .Points = 4.5,
          .Total = 5};
}

struct Hall {
  double Inches;
  double Metres;
};

/// Screens of 24 to 86 inches, read from 2 to 15 m.
std::vector<Hall> Halls() {
  std::vector<Hall> halls;
  for (const double inches : {24.0, 32.0, 43.0, 55.0, 65.0, 75.0, 86.0}) {
    for (const double metres : {2.0, 3.5, 5.0, 7.5, 10.0, 12.0, 15.0}) {
      halls.push_back({inches, metres});
    }
  }
  return halls;
}

/// Calls `look` with the layout of every number of players in every hall.
template <typename Look>
void InEachHall(Look look) {
  for (const Hall& hall : Halls()) {
    const AudiencePlace place = PlaceOf(hall.Inches, hall.Metres);
    for (int players = 1; players <= 224; ++players) {
      SCOPED_TRACE(std::to_string(players) + " players, " + std::to_string(hall.Inches) + " inches, " +
                   std::to_string(hall.Metres) + " m");
      look(place, ContentsOf(players), LayOut(place, ContentsOf(players)));
    }
  }
}

TEST(CapitalMillimetres, AreThoseOfSixteenMinutesOfArc) {
  EXPECT_NEAR(CapitalMillimetres(10), 46.5, 0.05);
  EXPECT_NEAR(CapitalMillimetres(2), 9.3, 0.05);
  EXPECT_NEAR(CapitalMillimetres(10, 32), 93.1, 0.05);
}

TEST(MillimetresPerPixel, FollowFromDiagonalAndResolution) {
  EXPECT_NEAR(MillimetresPerPixel(55, 3840, 2160), 0.317, 0.001);
  EXPECT_NEAR(MillimetresPerPixel(55, 1920, 1080), 0.634, 0.001);
}

TEST(AudienceLayout, HasLegibleLettersInEachHall) {
  InEachHall([](const AudiencePlace& place, const AudienceContents&, const AudienceLayout& layout) {
    EXPECT_GE(layout.Minutes, LegibleMinutes - 1e-6);
    EXPECT_GE(layout.Capital * place.MillimetresPerPixel, CapitalMillimetres(place.Metres) - 1e-6);
  });
}

TEST(AudienceLayout, ShowsEachPlayerOnce) {
  InEachHall([](const AudiencePlace&, const AudienceContents& contents, const AudienceLayout& layout) {
    int next = 0;
    for (int page = 0; page < layout.RowPages; ++page) {
      const AudienceRows rows = RowsOfPage(layout, contents.Players, page);
      EXPECT_EQ(rows.First, next);
      EXPECT_GT(rows.Count, 0);
      next += rows.Count;
    }
    EXPECT_EQ(next, contents.Players);
  });
}

TEST(AudienceLayout, StaysOnTheScreen) {
  InEachHall([](const AudiencePlace& place, const AudienceContents&, const AudienceLayout& layout) {
    const double above = 2 * layout.Margin + (1 + layout.TotalLines) * layout.Pitch;
    const double winners = layout.Winners * layout.WinnerScale * layout.Pitch;
    EXPECT_LE(above + layout.Rows * layout.Pitch, place.Height + 1e-6);
    EXPECT_LE(above + winners + layout.FirstRows * layout.Pitch, place.Height + 1e-6);
    EXPECT_GE(layout.Squeeze, 0.6 - 1e-6);
  });
}

TEST(AudienceLayout, ShowsEachTeamsTotalOnceThePagesHaveTurned) {
  InEachHall([](const AudiencePlace&, const AudienceContents& contents, const AudienceLayout& layout) {
    const int shown = std::min(contents.Teams, layout.TotalLines * layout.TotalsPerLine);
    EXPECT_GE(shown, 1);
    std::vector<int> seen(3, 0);
    for (int page = 0; page < layout.Pages; ++page) {
      const int first = FirstTotalOfPage(layout, contents.Teams, page);
      for (int i = 0; i < shown; ++i) {
        ++seen.at(static_cast<std::size_t>((first + i) % contents.Teams));
      }
    }
    for (int team = 0; team < contents.Teams; ++team) {
      EXPECT_GE(seen.at(static_cast<std::size_t>(team)), 1);
    }
  });
}

TEST(AudienceLayout, LeavesATotalOutOnlyWhereNoRowWouldBeLeft) {
  InEachHall([](const AudiencePlace&, const AudienceContents& contents, const AudienceLayout& layout) {
    if (layout.TotalLines * layout.TotalsPerLine < contents.Teams) {
      EXPECT_LT(layout.Rows, 3);
      EXPECT_LE(layout.TotalLines, 2);
    }
  });
}

TEST(AudienceLayout, ShowsTheSameRowsAgainWhereOnlyTotalsAreLeft) {
  int found = 0;
  InEachHall([&](const AudiencePlace&, const AudienceContents& contents, const AudienceLayout& layout) {
    for (int page = layout.RowPages; page < layout.Pages; ++page) {
      ++found;
      const AudienceRows first = RowsOfPage(layout, contents.Players, page - layout.RowPages);
      const AudienceRows again = RowsOfPage(layout, contents.Players, page);
      EXPECT_EQ(again.First, first.First);
      EXPECT_EQ(again.Count, first.Count);
    }
  });
  EXPECT_GT(found, 0);
}

TEST(AudienceLayout, ShowsAllTotalsOnEachPageWhereAHallIsUsual) {
  for (const Hall& hall : {Hall{55, 5}, Hall{55, 8}, Hall{75, 10}, Hall{43, 4}}) {
    const AudienceLayout layout = LayOut(PlaceOf(hall.Inches, hall.Metres), ContentsOf(40));
    EXPECT_GE(layout.TotalLines * layout.TotalsPerLine, 3) << hall.Inches << " inches, " << hall.Metres;
    EXPECT_TRUE(layout.Names);
    EXPECT_EQ(layout.Winners, 3);
    EXPECT_GT(layout.WinnerScale, 1.2);
  }
}

TEST(AudienceLayout, HasRoomForLargeWinnersUpToAQuarterOfTheInchesInMetres) {
  const AudienceContents evening{
      .Players = 40, .Teams = 3, .Place = 2, .Gun = 3, .Name = 8, .Points = 4, .Total = 5};
  for (const double inches : {24.0, 32.0, 43.0, 55.0, 65.0, 75.0, 86.0}) {
    EXPECT_EQ(LayOut(PlaceOf(inches, inches / 4.1), evening).Winners, 3) << inches;
    EXPECT_EQ(LayOut(PlaceOf(inches, inches / 3.7), evening).Winners, 0) << inches;
  }
}

TEST(AudienceLayout, GrowsWhereThatTakesNoFurtherPage) {
  const AudienceLayout few = LayOut(PlaceOf(55, 5), ContentsOf(6));
  EXPECT_EQ(few.Pages, 1);
  EXPECT_GT(few.Minutes, LegibleMinutes * 1.2);
  const AudienceLayout many = LayOut(PlaceOf(55, 5), ContentsOf(224));
  EXPECT_LT(many.Minutes, few.Minutes);
}

TEST(AudienceLayout, TakesTwoColumnsOnlyWhereTheySaveAPage) {
  const AudienceLayout near = LayOut(PlaceOf(86, 4), ContentsOf(60));
  EXPECT_EQ(near.Columns, 2);
  EXPECT_EQ(LayOut(PlaceOf(86, 4), ContentsOf(5)).Columns, 1);
  EXPECT_EQ(LayOut(PlaceOf(32, 10), ContentsOf(60)).Columns, 1);
}

TEST(AudienceLayout, HasNoMorePagesOnALargerScreen) {
  for (const int players : {12, 40, 224}) {
    int before = 1000;
    for (const double inches : {24.0, 32.0, 43.0, 55.0, 65.0, 75.0, 86.0}) {
      const int pages = LayOut(PlaceOf(inches, 8), ContentsOf(players)).Pages;
      EXPECT_LE(pages, before) << players << " players, " << inches << " inches";
      before = pages;
    }
  }
}

TEST(AudienceLayout, NamesGunsAloneWhereNamesHaveNoRoom) {
  EXPECT_FALSE(LayOut(PlaceOf(24, 15), ContentsOf(40)).Names);
  EXPECT_TRUE(LayOut(PlaceOf(24, 3), ContentsOf(40)).Names);
}

TEST(AudienceLayout, TellsThatLettersAreTooSmallInATinyWindow) {
  AudiencePlace place = PlaceOf(24, 10);
  place.Width = 300;
  place.Height = 200;
  const AudienceLayout layout = LayOut(place, ContentsOf(40));
  EXPECT_LT(layout.Minutes, LegibleMinutes);
  EXPECT_GE(layout.Rows, 1);
  EXPECT_LE(2 * layout.Margin + (1 + layout.TotalLines + layout.Rows) * layout.Pitch, place.Height + 1e-6);
}

}  // namespace
