#pragma once

#include <functional>

// How the board uses the room that it has. Lengths are in the toolkit's pixels.

/// Height of capitals that can be read two metres away on a screen of 24 inches (16 minutes of arc).
inline constexpr double ReadableCapitals = 33;

/// Rows for which there is room before the letters become smaller.
inline constexpr int RowsInLargeLetters = 12;

/// Height of a row such that `rows` rows fill `room`. It is never less than `leastRow`; then the list
/// scrolls.
int RowHeight(int room, int rows, int leastRow);

/// Height of the capitals in a row of this height, with room for a smaller line above them. In the least row
/// they have their least height; they can be read two metres away as soon as the row has room for that.
double CapitalHeight(int rowHeight, int leastRow, double leastCapitals);

/// True where the list of teams stands beside that of the players: on a wide board that has room for both.
/// `leastLetters` is the size of the smallest letters.
bool TeamsStandBeside(int width, int height, int leastLetters);

/// The largest growth of the letters, from 1 to `most`, at which what needs `widthAt(growth)` has room; 1
/// where nothing has. The width must not become less with the growth.
double GrowthThatFits(const std::function<double(double growth)>& widthAt, double room, double most);

/// The operator's wish: percent of the size that the board would choose.
inline constexpr int UsualPercent = 100;
inline constexpr int SmallestPercent = 30;
inline constexpr int LargestPercent = 300;
int LargerPercent(int percent);
int SmallerPercent(int percent);
