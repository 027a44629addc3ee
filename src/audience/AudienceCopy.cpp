#include "audience/AudienceCopy.h"

#include <QPainter>

AudienceCopy::AudienceCopy(AudienceStage& stage, QWidget* parent) : QWidget(parent), stage_(stage) {
  setObjectName(QStringLiteral("AudienceCopy"));
  setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Fixed);
  connect(&stage_, &AudienceStage::PictureChanged, this, qOverload<>(&QWidget::update));
}

QSize AudienceCopy::sizeHint() const {
  return {96, 54};
}

void AudienceCopy::paintEvent(QPaintEvent* /*event*/) {
  const QImage& picture = stage_.Picture();
  const double scale = devicePixelRatioF();
  const QSize size = picture.size().scaled((QSizeF(this->size()) * scale).toSize(), Qt::KeepAspectRatio);
  if (picture.cacheKey() != shown_ || small_.size() != size) {
    small_ = QPixmap::fromImage(picture.scaled(size, Qt::IgnoreAspectRatio, Qt::SmoothTransformation));
    small_.setDevicePixelRatio(scale);
    shown_ = picture.cacheKey();
  }
  const QSizeF shown = QSizeF(size) / scale;
  QPainter(this).drawPixmap(QPointF((width() - shown.width()) / 2, (height() - shown.height()) / 2), small_);
}
