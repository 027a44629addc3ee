#include "charts/HitBars.h"

#include <QPainter>
#include <algorithm>
#include <utility>

HitBars::HitBars(QWidget* parent) : QWidget(parent) {
  constexpr int shownAtLeast = 5;
  setMinimumHeight(shownAtLeast * (fontMetrics().height() + 4));
}

void HitBars::SetBars(std::vector<Bar> bars) {
  std::stable_sort(bars.begin(), bars.end(),
                   [](const Bar& left, const Bar& right) { return left.Amount > right.Amount; });
  bars_ = std::move(bars);
  update();
}

void HitBars::paintEvent(QPaintEvent* /*event*/) {
  if (bars_.empty()) {
    return;
  }
  QPainter painter(this);
  painter.setRenderHint(QPainter::Antialiasing);
  const int pitch = fontMetrics().height() + 4;
  const auto count = std::min(bars_.size(), static_cast<std::size_t>(std::max(height() / pitch, 1)));
  int nameWidth = 0;
  for (std::size_t i = 0; i < count; ++i) {
    nameWidth = std::max(nameWidth, fontMetrics().horizontalAdvance(bars_[i].Name));
  }
  const int amountWidth = fontMetrics().horizontalAdvance(QString::number(bars_.front().Amount)) + 12;
  const int room = std::max(width() - nameWidth - 8 - amountWidth, 1);
  for (std::size_t i = 0; i < count; ++i) {
    const Bar& bar = bars_[i];
    const int top = static_cast<int>(i) * pitch;
    const int length =
        std::max(static_cast<int>(static_cast<double>(bar.Amount) / bars_.front().Amount * room), 2);
    painter.setPen(palette().color(QPalette::WindowText));
    painter.drawText(QRect(0, top, nameWidth, pitch), Qt::AlignLeft | Qt::AlignVCenter, bar.Name);
    painter.drawText(QRect(nameWidth + 8 + length + 6, top, amountWidth, pitch),
                     Qt::AlignLeft | Qt::AlignVCenter, QString::number(bar.Amount));
    painter.setPen(Qt::NoPen);
    painter.setBrush(bar.Colour);
    painter.drawRoundedRect(QRect(nameWidth + 8, top + 2, length, pitch - 5), 3, 3);
  }
}
