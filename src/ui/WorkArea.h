#pragma once

#include <QObject>
#include <QSize>

class QScreen;

/// Largest size of a window on `screen`, without its frame: what panels of the desktop leave. In the
/// toolkit's units, which are pixels divided by the desktop's scale factor.
QSize RoomOn(const QScreen& screen);

/// The same of a work area of this size.
QSize RoomIn(const QSize& area);

/// Fits each window of the application to its screen before it is first shown, once installed as the
/// application's event filter. A dialog that needs more room scrolls, with its row of buttons staying in
/// view; the main window scrolls below its menu bar; and no window is too narrow for its title.
class WorkArea : public QObject {
 public:
  using QObject::QObject;

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;
};
