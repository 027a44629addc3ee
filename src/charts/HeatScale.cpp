#include "charts/HeatScale.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <numbers>

namespace {

// CIE L*a*b* with the white of sRGB screens.
constexpr double WhiteX = 0.95047;
constexpr double WhiteZ = 1.08883;
constexpr double Bend = 6.0 / 29;  ///< below its third power the curve of lightness is a straight line

double Uncurved(double value) {
  return value > Bend ? value * value * value : 3 * Bend * Bend * (value - 4.0 / 29);
}

std::uint8_t ScreenPart(double light) {
  const double inside = std::clamp(light, 0.0, 1.0);
  const double part = inside <= 0.0031308 ? 12.92 * inside : 1.055 * std::pow(inside, 1 / 2.4) - 0.055;
  return static_cast<std::uint8_t>(std::lround(255 * part));
}

Rgb ScreenColour(double lightness, double a, double b) {
  const double y = (lightness + 16) / 116;
  const double bigX = WhiteX * Uncurved(y + a / 500);
  const double bigY = Uncurved(y);
  const double bigZ = WhiteZ * Uncurved(y - b / 200);
  return {ScreenPart(3.2406 * bigX - 1.5372 * bigY - 0.4986 * bigZ),
          ScreenPart(-0.9689 * bigX + 1.8758 * bigY + 0.0415 * bigZ),
          ScreenPart(0.0557 * bigX - 0.2040 * bigY + 1.0570 * bigZ)};
}

constexpr int Steps = 256;

std::array<Rgb, Steps> MakeScale() {
  std::array<Rgb, Steps> scale{};
  for (int step = 0; step < Steps; ++step) {
    const double share = static_cast<double>(step) / (Steps - 1);
    const double hue = (90 - 130 * share) * std::numbers::pi / 180;
    const double chroma = 25 + 45 * std::sin(std::numbers::pi * share);
    scale[static_cast<std::size_t>(step)] =
        ScreenColour(93 - 73 * share, chroma * std::cos(hue), chroma * std::sin(hue));
  }
  return scale;
}

}  // namespace

Rgb HeatColour(double share) {
  static const std::array<Rgb, Steps> scale = MakeScale();
  return scale[static_cast<std::size_t>(std::lround(std::clamp(share, 0.0, 1.0) * (Steps - 1)))];
}

double LightnessOf(const Rgb& colour) {
  const auto light = [](std::uint8_t part) {
    const double share = part / 255.0;
    return share <= 0.04045 ? share / 12.92 : std::pow((share + 0.055) / 1.055, 2.4);
  };
  const double y = 0.2126 * light(colour.Red) + 0.7152 * light(colour.Green) + 0.0722 * light(colour.Blue);
  return y > Bend * Bend * Bend ? 116 * std::cbrt(y) - 16 : y * 116 / (3 * Bend * Bend);
}
