#include "ui/QrCode.h"

#include <qrencode.h>

#include <QPainter>
#include <algorithm>
#include <cmath>
#include <cstdint>
#include <memory>

namespace {

constexpr int QuietModules = 4;  ///< on each side

}  // namespace

QImage QrCode(const std::string& text) {
  const std::unique_ptr<QRcode, decltype(&QRcode_free)> code(
      text.empty() ? nullptr : QRcode_encodeString(text.c_str(), 0, QR_ECLEVEL_M, QR_MODE_8, 1),
      &QRcode_free);
  if (!code) {
    return {};
  }
  const int size = code->width + 2 * QuietModules;
  QImage picture(size, size, QImage::Format_RGB32);
  picture.fill(Qt::white);
  for (int row = 0; row < code->width; ++row) {
    for (int column = 0; column < code->width; ++column) {
      const std::uint8_t module = code->data[row * code->width + column];
      if ((module & 1U) != 0) {
        picture.setPixel(QuietModules + column, QuietModules + row, qRgb(0, 0, 0));
      }
    }
  }
  return picture;
}

void PaintQrCode(QPainter& painter, const QRectF& area, const std::string& text) {
  const QImage code = QrCode(text);
  if (code.isNull()) {
    return;
  }
  const double most = std::min(area.width(), area.height());
  const double whole = std::floor(most / code.width());
  const double side = whole >= 1 ? whole * code.width() : most;
  const QPointF corner = area.center() - QPointF(side / 2, side / 2);
  const bool wasSmooth = painter.testRenderHint(QPainter::SmoothPixmapTransform);
  painter.setRenderHint(QPainter::SmoothPixmapTransform, false);
  painter.drawImage(QRectF(std::round(corner.x()), std::round(corner.y()), side, side), code);
  painter.setRenderHint(QPainter::SmoothPixmapTransform, wasSmooth);
}
