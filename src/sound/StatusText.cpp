#include "sound/StatusText.h"

#include <QPainter>
#include <QStyle>
#include <cmath>

namespace {

constexpr int Wrapped = Qt::AlignLeft | Qt::AlignTop | Qt::TextWrapAnywhere;

}  // namespace

StatusText::StatusText(QWidget* parent) : QLabel(parent) {
  setTextFormat(Qt::PlainText);
  setWordWrap(true);
}

QSize StatusText::sizeHint() const {
  return minimumSizeHint();
}

QSize StatusText::minimumSizeHint() const {
  return {fontMetrics().averageCharWidth() * 20, fontMetrics().height()};
}

int StatusText::heightForWidth(int width) const {
  // More than any path has; a text of megabytes would take as long.
  constexpr qsizetype most = 8000;
  constexpr int endless = 1 << 24;
  const QRect needed =
      fontMetrics().boundingRect(QRect(0, 0, std::max(width, 1), endless), Wrapped, text().left(most));
  return std::max(needed.height(), fontMetrics().height());
}

void StatusText::paintEvent(QPaintEvent* /*event*/) {
  QPainter painter(this);
  style()->drawItemText(&painter, rect(), Wrapped, palette(), isEnabled(), text(), foregroundRole());
}
