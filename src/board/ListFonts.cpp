#include "board/ListFonts.h"

#include <QFontMetricsF>

QFont Grown(QFont font, double growth) {
  font.setPointSizeF(font.pointSizeF() * growth);
  return font;
}

QFont CaptionFont(const QFont& font, double size) {
  QFont captions = Grown(font, size);
  captions.setBold(true);
  return captions;
}

double CapitalsOf(QFont font) {
  constexpr int large = 200;
  font.setPixelSize(large);
  return QFontMetricsF(font).capHeight() / large;
}
