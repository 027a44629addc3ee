#pragma once

#include <QFontMetricsF>
#include <QHash>
#include <QString>
#include <array>

/// Widths of texts relative to the size of their letters, fast enough to measure all cells of a board after
/// each calculation. Kerning is left out; figures have none.
class TextWidths {
 public:
  explicit TextWidths(const QFont& font);

  /// Width of a text in letters of size 1.
  double Of(const QString& text);

 private:
  double OfCharacter(QChar character);

  QFontMetricsF metrics_;
  std::array<double, 128> ascii_{};
  QHash<char16_t, double> others_;
};
