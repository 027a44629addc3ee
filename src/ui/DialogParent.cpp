#include "ui/DialogParent.h"

#include <QApplication>

QWidget* DialogParent::Window() const {
  if (QWidget* modal = QApplication::activeModalWidget()) {
    return modal;
  }
  QWidget* active = QApplication::activeWindow();
  if (active != nullptr && !active->property(StandsBeside).toBool()) {
    return active;
  }
  return !mainWindow_.isNull() && mainWindow_->isVisible() ? mainWindow_.data() : nullptr;
}
