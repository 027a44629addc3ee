#include "audience/AudienceText.h"

#include <QFontMetricsF>
#include <QGuiApplication>
#include <QPainter>
#include <algorithm>
#include <cmath>
#include <utility>

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

namespace {

/// Pieces that must stay whole: words with the blank behind them, parts of an address, single Chinese
/// letters.
QStringList Pieces(const QString& text) {
  constexpr char16_t firstIdeograph = 0x2E80;
  QStringList pieces;
  QString piece;
  for (qsizetype i = 0; i < text.size(); ++i) {
    const QChar letter = text[i];
    if (letter == u':' && !piece.isEmpty() && i + 1 < text.size() && text[i + 1].isDigit()) {
      pieces.append(std::exchange(piece, QString()));  // a port stays with its colon
    }
    piece.append(letter);
    const bool ends = letter.isSpace() || letter == u'/' || letter == u'.' || letter >= QChar(firstIdeograph);
    const bool goesOn = i + 1 < text.size() && text[i + 1] == letter;  // the second of "//"
    if (ends && !goesOn) {
      pieces.append(std::exchange(piece, QString()));
    }
  }
  if (!piece.isEmpty()) {
    pieces.append(piece);
  }
  return pieces;
}

/// Fills lines one after the other, none wider than `width` but where a piece alone is.
QStringList LinesNoWiderThan(double width, const QStringList& pieces, const QFontMetricsF& metrics) {
  QStringList lines;
  QString line;
  for (const QString& piece : pieces) {
    QString longer = line;
    longer.append(piece);
    if (!line.isEmpty() && metrics.horizontalAdvance(longer.trimmed()) > width) {
      lines.append(line.trimmed());
      longer = piece;
    }
    line = longer;
  }
  lines.append(line.trimmed());
  return lines;
}

}  // namespace

QStringList BrokenInto(const QString& text, int lines, bool bold) {
  constexpr double step = 1.04;
  const QString whole = text.trimmed();
  if (lines > 1) {
    const QStringList pieces = Pieces(whole);
    const QFontMetricsF metrics(FontOfPixels(ReferencePixels, bold));
    const double most = metrics.horizontalAdvance(whole);
    double width = most / lines;
    QStringList broken = LinesNoWiderThan(width, pieces, metrics);
    while (width < most && broken.size() > lines) {
      width *= step;
      broken = LinesNoWiderThan(width, pieces, metrics);
    }
    if (broken.size() <= lines) {
      return broken;
    }
  }
  return {whole};
}

double WidestInCapitals(const QStringList& lines, bool bold) {
  double widest = 0;
  for (const QString& line : lines) {
    widest = std::max(widest, WidthInCapitals(line, bold));
  }
  return widest;
}

TextBlock BlockFor(const QString& text, const QSizeF& area, double legible, double most, bool bold) {
  constexpr int mostLines = 4;
  constexpr double spare = 0.98;  // a font's heights are whole pixels
  TextBlock best;
  for (int count = 1; count <= mostLines; ++count) {
    QStringList lines = BrokenInto(text, count, bold);
    const double byWidth = spare * area.width() / std::max(WidestInCapitals(lines, bold), 1e-9);
    const double byHeight = spare * area.height() / (BrokenPitch * static_cast<double>(lines.size()));
    const double capital = std::min({byWidth, byHeight, most});
    if (best.Lines.isEmpty() || capital > best.Capital) {
      best = {std::move(lines), capital};
    }
    if (best.Capital >= legible) {
      break;
    }
  }
  return best;
}

void DrawBlock(QPainter& painter, const QRectF& area, const TextBlock& block, bool bold) {
  const QFont font = FontWithCapitals(block.Capital, bold);
  const double pitch = BrokenPitch * block.Capital;
  double top = area.center().y() - pitch * static_cast<double>(block.Lines.size()) / 2;
  for (const QString& line : block.Lines) {
    DrawLine(painter, QRectF(area.left(), top, area.width(), pitch), line, font, Qt::AlignHCenter);
    top += pitch;
  }
}
