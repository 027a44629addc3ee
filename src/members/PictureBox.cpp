#include "members/PictureBox.h"

#include <QBuffer>
#include <QImageReader>
#include <QPainter>
#include <algorithm>

#include "members/PictureEnd.h"

namespace {

/// Larger photos are scaled down while being read, which takes a fraction of the time and memory.
constexpr QSize LargestPicture(1600, 1600);

/// Draws a head and shoulders in place of a missing photo.
void DrawSilhouette(QPainter& painter, const QRect& place, const QColor& colour) {
  const double unit = std::min(place.width(), place.height()) / 10.0;
  const QPointF centre = QRectF(place).center();
  painter.setRenderHint(QPainter::Antialiasing);
  painter.setClipRect(QRectF(0, 0, place.width(), centre.y() + 3.2 * unit));
  painter.setPen(Qt::NoPen);
  painter.setBrush(colour);
  painter.drawEllipse(centre - QPointF(0, 1.2 * unit), 1.5 * unit, 1.7 * unit);
  painter.drawEllipse(centre + QPointF(0, 3.4 * unit), 2.8 * unit, 2.4 * unit);
}

}  // namespace

PictureBox::PictureBox(QWidget* parent) : QWidget(parent) {}

void PictureBox::Load(const std::string& bytes) {
  QByteArray content = QByteArray::fromRawData(bytes.data(), static_cast<qsizetype>(bytes.size()));
  QBuffer buffer(&content);
  QImageReader reader(&buffer);
  reader.setDecideFormatFromContent(true);
  reader.setAutoTransform(true);
  const QSize size = reader.size();
  if (size.width() > LargestPicture.width() || size.height() > LargestPicture.height()) {
    reader.setScaledSize(size.scaled(LargestPicture, Qt::KeepAspectRatio));
  }
  // In some formats Qt does not notice itself that the end is missing.
  const bool isWhole = reader.canRead() && !IsCutShort(bytes, reader.format().toStdString());
  picture_ = isWhole ? reader.read() : QImage();
  update();
}

void PictureBox::Clear() {
  picture_ = QImage();
  update();
}

void PictureBox::paintEvent(QPaintEvent* /*event*/) {
  QPainter painter(this);
  painter.fillRect(rect(), palette().color(QPalette::Base));
  painter.setPen(palette().color(QPalette::Mid));
  painter.drawRect(rect().adjusted(0, 0, -1, -1));
  if (picture_.isNull()) {
    DrawSilhouette(painter, rect(), palette().color(QPalette::AlternateBase).darker(110));
    return;
  }
  constexpr int margin = 4;
  const QRect inside = rect().adjusted(margin, margin, -margin, -margin);
  QRect place(QPoint(0, 0), picture_.size().scaled(inside.size(), Qt::KeepAspectRatio));
  place.moveCenter(inside.center());
  painter.setRenderHint(QPainter::SmoothPixmapTransform);
  painter.drawImage(place, picture_);
}
