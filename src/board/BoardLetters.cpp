#include "board/BoardLetters.h"

#include <algorithm>

namespace {

constexpr int LetterStep = 10;

}  // namespace

int RowHeight(int room, int rows, int leastRow) {
  return std::max(rows > 0 ? room / rows : room, leastRow);
}

double CapitalHeight(int rowHeight, int leastRow, double leastCapitals) {
  constexpr double mostOfRow = 0.53;
  constexpr double ofWhatIsAdded = 0.7;
  const double most = rowHeight * mostOfRow;
  const double grown = leastCapitals + (rowHeight - leastRow) * ofWhatIsAdded;
  const double wanted = most >= ReadableCapitals ? std::max(grown, ReadableCapitals) : grown;
  return std::max(std::min(wanted, most), leastCapitals);
}

bool TeamsStandBeside(int width, int height, int leastLetters) {
  constexpr int leastWidth = 62;  // in letters: all columns of both lists
  constexpr double leastRatio = 1.65;
  return width >= leastWidth * leastLetters && width >= leastRatio * height;
}

double GrowthThatFits(const std::function<double(double growth)>& widthAt, double room, double most) {
  if (most <= 1 || widthAt(most) <= room) {
    return std::max(most, 1.0);
  }
  constexpr double precision = 0.005;
  double fits = 1;
  double tooMuch = most;
  while (tooMuch - fits > precision) {
    const double middle = (fits + tooMuch) / 2;
    (widthAt(middle) <= room ? fits : tooMuch) = middle;
  }
  return fits;
}

int LargerPercent(int percent) {
  return std::min(percent + LetterStep, LargestPercent);
}

int SmallerPercent(int percent) {
  return std::max(percent - LetterStep, SmallestPercent);
}
