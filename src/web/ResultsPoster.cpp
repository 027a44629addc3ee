#include "web/ResultsPoster.h"

#include <QBuffer>
#include <QPainter>
#include <QPdfWriter>

#include "ui/QrCode.h"
#include "ui/Text.h"

namespace {

constexpr int DotsPerInch = 300;

/// Writes a text into the band from and to these shares of the page's height, as large as fits.
void WriteBand(QPainter& painter, const QSizeF& page, double from, double to, const QString& text,
               bool bold) {
  const QRectF band(0, page.height() * from, page.width(), page.height() * (to - from));
  QFont font = painter.font();
  font.setBold(bold);
  constexpr int largest = 400;
  constexpr int least = 20;
  constexpr int step = 4;
  const auto fits = [&](int pixels) {
    font.setPixelSize(pixels);
    const QRectF needed =
        QFontMetricsF(font, painter.device()).boundingRect(band, Qt::AlignCenter | Qt::TextWordWrap, text);
    return needed.width() <= band.width() && needed.height() <= band.height();
  };
  int pixels = largest;
  while (pixels > least && !fits(pixels)) {
    pixels -= step;
  }
  font.setPixelSize(pixels);
  painter.setFont(font);
  painter.drawText(band, Qt::AlignCenter | Qt::TextWordWrap, text);
}

}  // namespace

std::string ResultsPoster(const StringTable& strings, const std::string& venue, const std::string& url) {
  QByteArray bytes;
  QBuffer buffer(&bytes);
  buffer.open(QIODevice::WriteOnly);
  QPdfWriter writer(&buffer);
  writer.setPageSize(QPageSize(QPageSize::A4));
  constexpr double margin = 18;
  writer.setPageMargins(QMarginsF(margin, margin, margin, margin), QPageLayout::Millimeter);
  writer.setResolution(DotsPerInch);
  writer.setTitle(Text(strings, OwnText::AudiencePhone));
  QPainter painter(&writer);
  const QSizeF page(writer.width(), writer.height());
  WriteBand(painter, page, 0, 0.07, QString::fromStdString(venue), false);
  WriteBand(painter, page, 0.08, 0.2, Text(strings, OwnText::AudiencePhone), true);
  PaintQrCode(painter, QRectF(0, page.height() * 0.21, page.width(), page.height() * 0.57), url);
  WriteBand(painter, page, 0.79, 0.87, QString::fromStdString(url), true);
  WriteBand(painter, page, 0.89, 1, Text(strings, OwnText::PosterHint), false);
  painter.end();
  return bytes.toStdString();
}
