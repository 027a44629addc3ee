#include "board/TextWidths.h"

#include <QFont>

namespace {

constexpr int MeasuredSize = 100;  ///< pixels; large, so that nothing is lost by rounding
constexpr double NotMeasured = -1;

QFontMetricsF MetricsOf(QFont font) {
  font.setPixelSize(MeasuredSize);
  return QFontMetricsF(font);
}

}  // namespace

TextWidths::TextWidths(const QFont& font) : metrics_(MetricsOf(font)) {
  ascii_.fill(NotMeasured);
}

double TextWidths::Of(const QString& text) {
  double width = 0;
  for (const QChar character : text) {
    width += OfCharacter(character);
  }
  return width / MeasuredSize;
}

double TextWidths::OfCharacter(QChar character) {
  const char16_t code = character.unicode();
  if (code < ascii_.size()) {
    double& width = ascii_[code];
    if (width == NotMeasured) {
      width = metrics_.horizontalAdvance(character);
    }
    return width;
  }
  auto found = others_.constFind(code);
  if (found == others_.constEnd()) {
    found = others_.insert(code, metrics_.horizontalAdvance(character));
  }
  return *found;
}
