#include "platform/qt/DialogParent.h"

#include <QApplication>
#include <QWidget>

QWidget* DialogParent(QWidget* mainWindow) {
  if (QWidget* modal = QApplication::activeModalWidget()) {
    return modal;
  }
  if (QWidget* active = QApplication::activeWindow()) {
    return active;
  }
  return mainWindow != nullptr && mainWindow->isVisible() ? mainWindow : nullptr;
}
