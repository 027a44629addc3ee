#include "ui/QrCode.h"

#include <qrencode.h>

#include <QPainter>
#include <QPainterPath>
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
  const double module = whole >= 1 ? whole : most / code.width();
  const double side = module * code.width();
  const QPointF corner(std::round(area.center().x() - side / 2), std::round(area.center().y() - side / 2));
  // One shape: pictures lose their edges on paper, and single squares show the joints between them.
  QPainterPath modules;
  modules.setFillRule(Qt::WindingFill);
  for (int row = 0; row < code.height(); ++row) {
    for (int column = 0; column < code.width(); ++column) {
      if (code.pixelColor(column, row) == Qt::black) {
        modules.addRect(corner.x() + column * module, corner.y() + row * module, module, module);
      }
    }
  }
  const bool wasSmooth = painter.testRenderHint(QPainter::Antialiasing);
  painter.setRenderHint(QPainter::Antialiasing, false);
  painter.fillRect(QRectF(corner, QSizeF(side, side)), Qt::white);
  painter.fillPath(modules, Qt::black);
  painter.setRenderHint(QPainter::Antialiasing, wasSmooth);
}
