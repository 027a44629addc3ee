#include "members/PictureBox.h"

#include <QBuffer>
#include <QImageReader>
#include <QPainter>

namespace {

/// Photos of more dots than a screen shows are read smaller, which takes a fraction of the time and memory.
constexpr QSize LargestPicture(1600, 1600);

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
  picture_ = reader.read();
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
    return;
  }
  constexpr int margin = 4;
  const QRect inside = rect().adjusted(margin, margin, -margin, -margin);
  QRect place(QPoint(0, 0), picture_.size().scaled(inside.size(), Qt::KeepAspectRatio));
  place.moveCenter(inside.center());
  painter.setRenderHint(QPainter::SmoothPixmapTransform);
  painter.drawImage(place, picture_);
}
