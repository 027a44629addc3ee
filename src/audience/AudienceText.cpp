#include "audience/AudienceText.h"

#include <QFontMetricsF>
#include <QGuiApplication>
#include <QPainter>
#include <algorithm>
#include <cmath>

namespace {

constexpr int ReferencePixels = 200;

QFont FontOfPixels(int pixels, bool bold) {
  QFont font = QGuiApplication::font();
  font.setPixelSize(std::max(1, pixels));
  font.setBold(bold);
  font.setHintingPreference(QFont::PreferNoHinting);  // widths grow with the height
  return font;
}

double CapitalOf(const QFont& font) {
  return QFontMetricsF(font).capHeight();
}

}  // namespace

QFont FontWithCapitals(double capital, bool bold) {
  const double reference = CapitalOf(FontOfPixels(ReferencePixels, bold));
  int pixels = static_cast<int>(capital * ReferencePixels / reference);
  QFont font = FontOfPixels(pixels, bold);
  while (CapitalOf(font) < capital) {
    font = FontOfPixels(++pixels, bold);
  }
  return font;
}

double WidthInCapitals(const QString& text, bool bold) {
  const QFont font = FontOfPixels(ReferencePixels, bold);
  return QFontMetricsF(font).horizontalAdvance(text) / CapitalOf(font);
}

void DrawLine(QPainter& painter, const QRectF& area, const QString& text, const QFont& font,
              Qt::AlignmentFlag alignment, double least) {
  if (text.isEmpty() || area.width() <= 0) {
    return;
  }
  const QFontMetricsF metrics(font);
  QString shown = text;
  double width = metrics.horizontalAdvance(shown);
  if (width * least > area.width()) {
    shown = metrics.elidedText(text, Qt::ElideRight, area.width() / least);
    width = metrics.horizontalAdvance(shown);
  }
  const double squeeze = std::min(1.0, area.width() / width);
  const double rest = area.width() - width * squeeze;
  const double left = alignment == Qt::AlignRight ? rest : alignment == Qt::AlignHCenter ? rest / 2 : 0;
  const double baseline = area.center().y() + metrics.capHeight() / 2;
  painter.setFont(font);
  if (squeeze >= 1) {
    painter.drawText(QPointF(area.left() + left, baseline), shown);
    return;
  }
  painter.save();
  painter.translate(area.left() + left, baseline);
  painter.scale(squeeze, 1);
  painter.drawText(QPointF(0, 0), shown);
  painter.restore();
}

double CapitalFor(const QString& text, double width, double most, bool bold) {
  const double wide = WidthInCapitals(text, bold);
  constexpr double spare = 0.98;  // a font's heights are whole pixels
  return wide > 0 ? std::min(most, spare * width / wide) : most;
}
