#include "ui/DialogParent.h"

#include <QApplication>

QWidget* DialogParent::Window() const {
  if (QWidget* modal = QApplication::activeModalWidget()) {
    return modal;
  }
  if (QWidget* active = QApplication::activeWindow()) {
    return active;
  }
  return !mainWindow_.isNull() && mainWindow_->isVisible() ? mainWindow_.data() : nullptr;
}
