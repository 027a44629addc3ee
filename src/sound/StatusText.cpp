#include "sound/StatusText.h"

#include <QFontInfo>
#include <QPainter>
#include <QStyle>
#include <cmath>

namespace {

/// More than any path has. A text of megabytes would take too long, and not fit the screen.
constexpr qsizetype MostShown = 8000;
/// Of a large font. More would take too much room.
constexpr int MostLines = 2;
/// Of the window's own font. What does not fit is left to whoever asks for the text, and to the list of
/// files.
constexpr int MostPlainLines = 5;
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

int StatusText::NeededHeight(const QFont& font, int width) const {
  constexpr int endless = 1 << 24;
  const QFontMetrics metrics(font);
  const QRect needed =
      metrics.boundingRect(QRect(0, 0, std::max(width, 1), endless), Wrapped, text().left(MostShown));
  return std::max(needed.height(), metrics.height());
}

QFont StatusText::FontFor(int width) const {
  const bool fits = NeededHeight(font(), width) <= MostLines * fontMetrics().lineSpacing();
  if (fits || parentWidget() == nullptr) {
    return font();
  }
  // A painter takes from the widget's own font what is not set here.
  const QFont& around = parentWidget()->font();
  QFont plain = font();
  plain.setBold(around.bold());
  plain.setPixelSize(QFontInfo(around).pixelSize());
  return plain;
}

int StatusText::heightForWidth(int width) const {
  const QFont shown = FontFor(width);
  return std::min(NeededHeight(shown, width), MostPlainLines * QFontMetrics(shown).lineSpacing());
}

void StatusText::paintEvent(QPaintEvent* /*event*/) {
  QPainter painter(this);
  painter.setFont(FontFor(width()));
  style()->drawItemText(&painter, rect(), Wrapped, palette(), isEnabled(), text().left(MostShown),
                        foregroundRole());
}
