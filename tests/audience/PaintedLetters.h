#pragma once

#include <QImage>
#include <algorithm>
#include <map>

#include "tests/support/Contrast.h"

/// What a hall needs to read letters from afar.
inline constexpr double LeastContrastForTheHall = 7;

/// What stands on a painted ground. Edges of letters are softened, so not all of their pixels are legible.
struct PaintedLetters {
  int Pixels = 0;   ///< that differ from the commonest colour, which is the ground
  int Legible = 0;  ///< of these, with the contrast that a hall needs
  QRgb Ground = 0;
};

inline PaintedLetters LettersIn(const QImage& picture, const QRect& area) {
  std::map<QRgb, int> colours;
  for (int y = area.top(); y <= area.bottom(); ++y) {
    for (int x = area.left(); x <= area.right(); ++x) {
      ++colours[picture.pixel(x, y)];
    }
  }
  const auto fewer = [](const auto& one, const auto& other) { return one.second < other.second; };
  PaintedLetters letters;
  letters.Ground = std::max_element(colours.begin(), colours.end(), fewer)->first;
  for (const auto& [colour, count] : colours) {
    if (colour != letters.Ground) {
      letters.Pixels += count;
      letters.Legible += Contrast(colour, letters.Ground) >= LeastContrastForTheHall ? count : 0;
    }
  }
  return letters;
}

/// The smallest area that holds all pixels of this colour within another.
inline QRect AreaOfColour(const QImage& picture, const QRect& within, QRgb colour) {
  QRect area;
  for (int y = within.top(); y <= within.bottom(); ++y) {
    for (int x = within.left(); x <= within.right(); ++x) {
      if (picture.pixel(x, y) == colour) {
        area |= QRect(x, y, 1, 1);
      }
    }
  }
  return area;
}
