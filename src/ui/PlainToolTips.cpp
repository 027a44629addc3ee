#include "ui/PlainToolTips.h"

#include <QApplication>
#include <QEvent>
#include <QLabel>

PlainToolTips::PlainToolTips() {
  qApp->installEventFilter(this);
}

bool PlainToolTips::eventFilter(QObject* watched, QEvent* event) {
  // The toolkit polishes its label before it gives it the first text and measures that.
  if (event->type() == QEvent::Polish && watched->inherits("QTipLabel")) {
    static_cast<QLabel*>(watched)->setTextFormat(Qt::PlainText);
  }
  return QObject::eventFilter(watched, event);
}
