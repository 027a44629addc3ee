#pragma once

#include <QApplication>
#include <QPalette>
#include <QWidget>
#include <algorithm>
#include <cmath>
#include <map>

/// What the accessibility guidelines of the Web ask of text.
inline constexpr double LeastContrast = 4.5;

/// Contrast of two colours as those guidelines reckon it: 1 for equal ones, 21 for black and white.
inline double Contrast(QRgb one, QRgb other) {
  const auto luminance = [](QRgb colour) {
    const auto part = [](int value) {
      const double share = value / 255.0;
      return share <= 0.04045 ? share / 12.92 : std::pow((share + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * part(qRed(colour)) + 0.7152 * part(qGreen(colour)) + 0.0722 * part(qBlue(colour));
  };
  const auto [darker, lighter] = std::minmax({luminance(one), luminance(other)});
  return (lighter + 0.05) / (darker + 0.05);
}

/// Contrast of the letters painted in `area` of a control: that of the commonest colour there to the one that
/// differs most from it.
inline double PaintedContrast(QWidget& control, const QRect& area) {
  const QImage picture = control.grab(area).toImage();
  std::map<QRgb, int> pixels;
  for (int y = 0; y < picture.height(); ++y) {
    for (int x = 0; x < picture.width(); ++x) {
      ++pixels[picture.pixel(x, y)];
    }
  }
  const auto fewer = [](const auto& one, const auto& other) { return one.second < other.second; };
  const QRgb behind = std::max_element(pixels.begin(), pixels.end(), fewer)->first;
  double most = 1;
  for (const auto& [colour, count] : pixels) {
    most = std::max(most, Contrast(colour, behind));
  }
  return most;
}

inline double PaintedContrast(QWidget& control) {
  return PaintedContrast(control, control.rect());
}

/// A dark desktop while this lives.
class DarkDesktop {
 public:
  DarkDesktop() {
    QPalette dark(QColor(45, 45, 45));
    dark.setColor(QPalette::Base, QColor(30, 30, 30));
    QApplication::setPalette(dark);
  }
  ~DarkDesktop() { QApplication::setPalette(before_); }
  DarkDesktop(const DarkDesktop&) = delete;
  DarkDesktop& operator=(const DarkDesktop&) = delete;

 private:
  const QPalette before_ = QApplication::palette();
};
