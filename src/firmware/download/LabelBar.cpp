#include "firmware/download/LabelBar.h"

#include <algorithm>

LabelBar::LabelBar(QWidget* parent) : QLabel(parent) {
  setAutoFillBackground(true);
  setBackgroundRole(QPalette::Mid);
  setMinimumHeight(14);
}

void LabelBar::SetShare(double share) {
  share_ = std::clamp(share, 0.0, 1.0);
  setAccessibleName(QString::number(share_ * 100, 'f', 0) + QStringLiteral(" %"));
  PlaceForeground();
}

void LabelBar::resizeEvent(QResizeEvent* event) {
  QLabel::resizeEvent(event);
  PlaceForeground();
}

void LabelBar::PlaceForeground() {
  auto* foreground = findChild<QLabel*>();
  foreground->setGeometry(0, 0, static_cast<int>(share_ * width()), height());
}
