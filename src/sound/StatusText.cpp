#include "sound/StatusText.h"

#include <QPainter>
#include <QStyle>
#include <cmath>

namespace {

/// More than any path has. A text of megabytes would take too long, and not fit the screen.
constexpr qsizetype MostShown = 8000;
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
  constexpr int endless = 1 << 24;
  const QRect needed =
      fontMetrics().boundingRect(QRect(0, 0, std::max(width, 1), endless), Wrapped, text().left(MostShown));
  return std::max(needed.height(), fontMetrics().height());
}

void StatusText::paintEvent(QPaintEvent* /*event*/) {
  QPainter painter(this);
  style()->drawItemText(&painter, rect(), Wrapped, palette(), isEnabled(), text().left(MostShown),
                        foregroundRole());
}
