#include "ui/FocusTips.h"

#include <QFocusEvent>
#include <QTimer>
#include <QToolTip>
#include <QWidget>

void FocusTips::Add(QWidget& control) {
  control.installEventFilter(this);
}

bool FocusTips::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::FocusIn) {
    const auto reason = static_cast<QFocusEvent*>(event)->reason();
    if (reason != Qt::ActiveWindowFocusReason && reason != Qt::PopupFocusReason) {
      // Each change of the focus hides the tip, so it comes when this one is over.
      auto* control = static_cast<QWidget*>(watched);
      QTimer::singleShot(0, control, [control] {
        if (control->hasFocus()) {
          QToolTip::showText(control->mapToGlobal(QPoint(0, control->height())), control->toolTip(), control);
        }
      });
    }
  }
  return QObject::eventFilter(watched, event);
}
