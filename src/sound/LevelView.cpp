#include "sound/LevelView.h"

#include <QPainter>

LevelView::LevelView(QWidget* parent) : QWidget(parent) {}

void LevelView::Show(const SoundLevels& levels) {
  levels_ = levels;
  update();
}

void LevelView::paintEvent(QPaintEvent* /*event*/) {
  constexpr double fullScale = 255;
  constexpr int markHeight = 4;
  const QColor clipColour(0xd0, 0x20, 0x20);
  QPainter painter(this);
  painter.fillRect(rect(), palette().base());
  painter.setPen(palette().color(QPalette::Mid));
  painter.drawLine(0, height() / 2, width(), height() / 2);
  const auto count = static_cast<double>(levels_.Columns.size());
  for (std::size_t i = 0; i < levels_.Columns.size(); ++i) {
    const SoundLevels::Column& column = levels_.Columns[i];
    const double left = width() * static_cast<double>(i) / count;
    const double right = width() * static_cast<double>(i + 1) / count;
    const double top = height() * (fullScale - column.Highest) / fullScale;
    const double bottom = height() * (fullScale - column.Lowest) / fullScale;
    const QRectF bar(left, top, std::max(right - left, 1.0), std::max(bottom - top, 1.0));
    painter.fillRect(bar, column.Clips ? clipColour : palette().color(QPalette::Highlight));
    if (column.Clips) {
      painter.fillRect(QRectF(bar.left(), 0, std::max(bar.width(), 2.0), markHeight), clipColour);
    }
  }
}
