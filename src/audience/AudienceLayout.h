#pragma once

/// How a list of standings is laid out on a screen that people read from some way off. All lengths are pixels
/// of the screen unless they say otherwise.

/// Capitals that stand under a smaller angle than this, in minutes of arc, cannot be read from that far.
inline constexpr double LegibleMinutes = 16;

/// How many winners stand in larger letters, where there is room.
inline constexpr int MostLargeWinners = 3;

/// Height of capitals in millimetres that are seen under this angle at a distance in metres.
double CapitalMillimetres(double metres, double minutes = LegibleMinutes);

/// Size of a pixel of a screen with this diagonal.
double MillimetresPerPixel(double diagonalInches, int width, int height);

/// The area that the board covers, and from where it is read.
struct AudiencePlace {
  int Width = 0;
  int Height = 0;
  double MillimetresPerPixel = 0;
  double Metres = 0;  ///< to the last of those who read it
};

/// What is to be laid out. Widths are those of the widest text of its kind, in heights of a capital.
struct AudienceContents {
  int Players = 0;
  int Teams = 0;      ///< that have a total
  double Place = 0;   ///< the place's number
  double Gun = 0;     ///< short name of a gun: "R95"
  double Name = 0;    ///< public name
  double Points = 0;  ///< soldiering
  double Total = 0;   ///< of a team
};

struct AudienceLayout {
  double Capital = 0;  ///< height of the capitals of all rows but the winners'
  double Pitch = 0;    ///< from one row to the next
  double Margin = 0;   ///< around the page
  int TotalLines = 0;  ///< lines with totals of teams, below the heading
  int TotalsPerLine = 0;
  double TotalWidth = 0;  ///< of a team's badge, total and the gap behind it
  int Columns = 1;
  int Rows = 0;            ///< of a column, on all pages but the first
  int Winners = 0;         ///< large rows across the first page
  double WinnerScale = 1;  ///< how much larger they are
  int FirstRows = 0;       ///< of a column on the first page, below the winners
  int RowPages = 1;        ///< with different rows
  int Pages = 1;           ///< the same rows again with other totals where not all totals fit on one
  bool Names = true;       ///< false: there is room for guns alone
  double Squeeze = 1;      ///< width of the letters against their usual one
  double Minutes = 0;      ///< of arc under which a capital is seen
};

/// Letters are legible from the place, and larger where that takes no further page; smaller only in a window
/// so small that not even heading, total and one row would fit. Two columns where both fit and save a page.
/// All teams' totals stand on each page where a row is left besides; else they take turns.
AudienceLayout LayOut(const AudiencePlace& place, const AudienceContents& contents);

/// A run of players in the order of their places, counted from 0.
struct AudienceRows {
  int First = 0;
  int Count = 0;
};

/// The rows of page `page`, counted from 0 to `Pages` - 1; where it shows the first rows, the winners come
/// first.
AudienceRows RowsOfPage(const AudienceLayout& layout, int players, int page);

/// Which team's total stands first on a page, counted from 0: where not all fit, they take turns.
int FirstTotalOfPage(const AudienceLayout& layout, int teams, int page);
