#include "audience/AudienceLayout.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

constexpr double MillimetresPerInch = 25.4;

// In heights of a capital.
constexpr double ColumnGap = 1.2;
constexpr double TotalSign = 1.9;  ///< the team's badge and the gap behind it
constexpr double TotalGap = 1.2;
constexpr double LeastTotalGap = 0.6;
constexpr double LeastTotalSqueeze = 0.8;
constexpr double WidthBesidesTexts = 3.4;  ///< of a row: the badge and gaps
constexpr double GapsWithoutNames = 0.6;
constexpr double ShortestName = 5;
constexpr double UsefulName = 9;  ///< what a name gets at least where there are two columns

constexpr double LeastSqueeze = 0.6;
constexpr double LeastSqueezeWithNames = 0.8;

constexpr int HeadingLines = 1;
constexpr int FewestLines = 3;  ///< heading, total, one row

/// Distances between lines, in heights of a capital.
struct Spacing {
  double Pitch;
  double Margin;
};
constexpr Spacing Roomy{1.75, 0.6};
constexpr Spacing Tight{1.35, 0.08};
constexpr int FewestRoomyLines = 6;

constexpr double LargestGrowth = 2;
constexpr double GrowthStep = 0.0625;

int LinesIn(double height, const Spacing& spacing) {
  return static_cast<int>((height - 2 * spacing.Margin) / spacing.Pitch);
}

int DividedUp(int count, int by) {
  return (count + by - 1) / by;
}

double NamedRow(const AudienceContents& contents, double name) {
  return contents.Place + contents.Points + WidthBesidesTexts + name;
}

double UnnamedRow(const AudienceContents& contents) {
  return contents.Place + contents.Gun + contents.Points + GapsWithoutNames;
}

double LeastNamedRow(const AudienceContents& contents) {
  return NamedRow(contents, std::min(contents.Name, ShortestName));
}

/// Largest capital with which a page holds what it must.
double LargestCapital(const AudiencePlace& place, const AudienceContents& contents) {
  const double byHeight = place.Height / (FewestLines * Tight.Pitch + 2 * Tight.Margin);
  const double byWidth = place.Width / (LeastSqueeze * UnnamedRow(contents) + 2 * Tight.Margin);
  return std::min(byHeight, byWidth);
}

/// Gives the first page its large rows: three winners, or fewer where the others would have no row left.
void PlaceWinners(AudienceLayout& layout, double rowLines, double width, const AudienceContents& contents) {
  constexpr double largest = 1.6;
  constexpr double smallest = 1.25;
  layout.FirstRows = layout.Rows;
  if (!layout.Names) {
    return;
  }
  const double wide = width / LeastNamedRow(contents);
  for (int winners = std::min(MostLargeWinners, contents.Players); winners > 0; --winners) {
    const int others = contents.Players > winners ? 1 : 0;
    const double scale = std::min({largest, wide, (rowLines - others) / winners});
    if (scale >= smallest) {
      layout.Winners = winners;
      layout.WinnerScale = scale;
      layout.FirstRows = static_cast<int>(rowLines - winners * scale + 1e-9);
      return;
    }
  }
}

/// Puts the totals below the heading: all of them where a row is left, else in turns.
void PlaceTotals(AudienceLayout& layout, int lines, double width, const AudienceContents& contents) {
  const double least = TotalSign + LeastTotalSqueeze * contents.Total + LeastTotalGap;
  const double usual = TotalSign + contents.Total + TotalGap;
  layout.TotalsPerLine = std::clamp(static_cast<int>((width + LeastTotalGap) / least), 1, 3);
  layout.TotalWidth = layout.Capital * std::min(usual, (width + LeastTotalGap) / layout.TotalsPerLine);
  const int needed = DividedUp(contents.Teams, layout.TotalsPerLine);
  const bool isRowLeft = HeadingLines + needed < lines;
  layout.TotalLines = isRowLeft ? needed : std::max(1, (lines - HeadingLines) / 2);
}

int TotalsOnPage(const AudienceLayout& layout, const AudienceContents& contents) {
  return std::min(contents.Teams, layout.TotalLines * layout.TotalsPerLine);
}

/// Counts the pages that show all rows and all totals.
void CountPages(AudienceLayout& layout, const AudienceContents& contents) {
  const int onFirst = layout.Winners + layout.Columns * layout.FirstRows;
  layout.RowPages = 1 + DividedUp(std::max(0, contents.Players - onFirst), layout.Columns * layout.Rows);
  const int turnsOfTotals = DividedUp(contents.Teams, std::max(1, TotalsOnPage(layout, contents)));
  layout.Pages = layout.RowPages * DividedUp(std::max(1, turnsOfTotals), layout.RowPages);
}

AudienceLayout LayOutSpaced(const Spacing& spacing, double capital, int columns, const AudiencePlace& place,
                            const AudienceContents& contents) {
  AudienceLayout layout;
  const double width = place.Width / capital - 2 * spacing.Margin;
  layout.Capital = capital;
  layout.Margin = spacing.Margin * capital;
  layout.Columns = columns;
  const double column = (width - (columns - 1) * ColumnGap) / columns;
  layout.Squeeze = std::min(1.0, column / LeastNamedRow(contents));
  layout.Names = layout.Squeeze >= LeastSqueezeWithNames;
  if (!layout.Names) {
    layout.Squeeze = std::min(1.0, column / UnnamedRow(contents));
  }
  const int lines = std::max(FewestLines, LinesIn(place.Height / capital, spacing));
  layout.Pitch = (place.Height - 2 * layout.Margin) / lines;  // no strip stays empty
  PlaceTotals(layout, lines, width, contents);
  layout.Rows = std::max(1, lines - HeadingLines - layout.TotalLines);
  PlaceWinners(layout, layout.Rows, width, contents);
  CountPages(layout, contents);
  return layout;
}

/// Roomy unless the totals of the teams would then take more than a line and a quarter of the page.
AudienceLayout LayOutWith(double capital, int columns, const AudiencePlace& place,
                          const AudienceContents& contents) {
  const int lines = LinesIn(place.Height / capital, Roomy);
  if (lines >= FewestRoomyLines) {
    AudienceLayout roomy = LayOutSpaced(Roomy, capital, columns, place, contents);
    if (roomy.TotalLines <= std::max(1, lines / 4)) {
      return roomy;
    }
  }
  return LayOutSpaced(Tight, capital, columns, place, contents);
}

bool FitsTwice(double capital, const AudiencePlace& place, const AudienceContents& contents) {
  const double width = place.Width / capital - 2 * Roomy.Margin;
  return (width - ColumnGap) / 2 >= NamedRow(contents, std::min(contents.Name, UsefulName));
}

/// With two columns where they fit and save a page.
AudienceLayout BestWith(double capital, const AudiencePlace& place, const AudienceContents& contents) {
  const AudienceLayout one = LayOutWith(capital, 1, place, contents);
  if (one.Pages == 1 || !FitsTwice(capital, place, contents)) {
    return one;
  }
  const AudienceLayout two = LayOutWith(capital, 2, place, contents);
  return two.Pages < one.Pages ? two : one;
}

/// True if names are not shortened: letters that need not be larger must not cost them.
bool ShowsWholeNames(const AudienceLayout& layout, const AudiencePlace& place,
                     const AudienceContents& contents) {
  const double width = (place.Width - 2 * layout.Margin) / layout.Capital;
  const double column = (width - (layout.Columns - 1) * ColumnGap) / layout.Columns;
  return column >= NamedRow(contents, contents.Name) &&
         width >= layout.WinnerScale * NamedRow(contents, contents.Name);
}

}  // namespace

double CapitalMillimetres(double metres, double minutes) {
  constexpr double minutesOfHalfCircle = 180 * 60;
  constexpr double millimetresPerMetre = 1000;
  return metres * millimetresPerMetre * std::tan(minutes * std::numbers::pi / minutesOfHalfCircle);
}

double MillimetresPerPixel(double diagonalInches, int width, int height) {
  return diagonalInches * MillimetresPerInch / std::hypot(width, height);
}

AudienceLayout LayOut(const AudiencePlace& place, const AudienceContents& contents) {
  const double legible = CapitalMillimetres(place.Metres) / place.MillimetresPerPixel;
  const double capital = std::min(legible, LargestCapital(place, contents));
  AudienceLayout best = BestWith(capital, place, contents);
  const long steps = std::lround((LargestGrowth - 1) / GrowthStep);
  for (long step = steps; step > 0; --step) {
    const double larger = (1 + static_cast<double>(step) * GrowthStep) * capital;
    if (LinesIn(place.Height / larger, Roomy) < FewestRoomyLines) {
      continue;
    }
    const AudienceLayout grown = BestWith(larger, place, contents);
    if (grown.Pages <= best.Pages && grown.Winners >= best.Winners &&
        TotalsOnPage(grown, contents) >= TotalsOnPage(best, contents) &&
        ShowsWholeNames(grown, place, contents)) {
      best = grown;
      break;
    }
  }
  best.Minutes = LegibleMinutes * best.Capital / legible;
  return best;
}

AudienceRows RowsOfPage(const AudienceLayout& layout, int players, int page) {
  const int onFirst = layout.Winners + layout.Columns * layout.FirstRows;
  const int rowPage = page % layout.RowPages;
  if (rowPage == 0) {
    return {0, std::min(players, onFirst)};
  }
  const int onPage = layout.Columns * layout.Rows;
  const int first = std::min(players, onFirst + (rowPage - 1) * onPage);
  return {first, std::min(players - first, onPage)};
}

int FirstTotalOfPage(const AudienceLayout& layout, int teams, int page) {
  const int shown = layout.TotalLines * layout.TotalsPerLine;
  return teams == 0 || shown >= teams ? 0 : page * shown % teams;
}
