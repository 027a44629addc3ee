#include "ui/PlainToolTips.h"

#include <QApplication>
#include <QEvent>
#include <QLabel>
#include <QScreen>

namespace {

/// The toolkit shows a plain text on one line, though it be wider than the screen. Reuses its label, and then
/// sets it back to one line.
void Wrap(QLabel& tip) {
  const int most = tip.screen()->availableGeometry().width() / 2;
  if (tip.width() > most) {
    tip.setWordWrap(true);
    tip.resize(most, tip.heightForWidth(most));
  }
}

}  // namespace

PlainToolTips::PlainToolTips() {
  qApp->installEventFilter(this);
}

bool PlainToolTips::eventFilter(QObject* watched, QEvent* event) {
  switch (event->type()) {
    case QEvent::Polish:
    case QEvent::Show:
    case QEvent::Resize:
      break;
    default:
      return false;
  }
  if (!watched->inherits("QTipLabel")) {
    return false;
  }
  auto& tip = *static_cast<QLabel*>(watched);
  if (event->type() == QEvent::Polish) {
    // The toolkit polishes its label before it gives it the first text and measures that.
    tip.setTextFormat(Qt::PlainText);
  } else {
    Wrap(tip);
  }
  return false;
}
