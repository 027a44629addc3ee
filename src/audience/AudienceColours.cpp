#include "audience/AudienceColours.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "ui/TeamColours.h"

namespace {

constexpr double LeastContrastOfLetters = 7.2;  // rounding to whole colours included

/// As the accessibility guidelines of the Web reckon it.
double LuminanceOf(const QColor& colour) {
  const auto part = [](double share) {
    return share <= 0.04045 ? share / 12.92 : std::pow((share + 0.055) / 1.055, 2.4);
  };
  return 0.2126 * part(colour.redF()) + 0.7152 * part(colour.greenF()) + 0.0722 * part(colour.blueF());
}

QColor LighterBy(const QColor& colour, double share) {
  const auto mix = [share](int part) { return static_cast<int>(part + (255 - part) * share); };
  return {mix(colour.red()), mix(colour.green()), mix(colour.blue())};
}

/// The team's colour with as little white as makes letters on its rows legible.
QColor LegibleColour(int team) {
  const QColor own = TeamColour(team);
  const QColor row = AudienceColours::Row(team);
  constexpr int steps = 50;
  for (int step = 0; step < steps; ++step) {
    const QColor lighter = LighterBy(own, static_cast<double>(step) / steps);
    if (std::min(AudienceColours::Contrast(lighter, row),
                 AudienceColours::Contrast(lighter, AudienceColours::BadgeLetters())) >=
        LeastContrastOfLetters) {
      return lighter;
    }
  }
  return Qt::white;
}

}  // namespace

namespace AudienceColours {

QColor Page() {
  return {0x0c, 0x10, 0x18};
}

QColor Letters() {
  return Qt::white;
}

QColor QuietLetters() {
  return {0xc6, 0xce, 0xdc};
}

QColor Row(int team) {
  constexpr double tint = 0.2;
  return TeamTint(team, Page(), tint);
}

QColor Team(int team) {
  static const std::array<QColor, 3> colours = {LegibleColour(1), LegibleColour(2), LegibleColour(3)};
  return colours.at(static_cast<std::size_t>(team - 1));
}

QColor BadgeLetters() {
  return Page();
}

double Contrast(const QColor& one, const QColor& other) {
  const double first = LuminanceOf(one);
  const double second = LuminanceOf(other);
  constexpr double glare = 0.05;
  return (std::max(first, second) + glare) / (std::min(first, second) + glare);
}

}  // namespace AudienceColours
