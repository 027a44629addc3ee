#include "members/PictureBox.h"

#include <QPainter>

#include "members/PictureReader.h"
#include "members/Silhouette.h"

namespace {

constexpr QSize LargestPicture(1600, 1600);

}  // namespace

PictureBox::PictureBox(QWidget* parent) : QWidget(parent) {}

void PictureBox::Load(const std::string& bytes) {
  picture_ = ReadPicture(bytes, LargestPicture);
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
