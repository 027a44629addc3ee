#pragma once

#include <QPointer>
#include <QWidget>

/// Knows the window that a box or dialog opened now belongs to.
class DialogParent {
 public:
  void SetMainWindow(QWidget* mainWindow) { mainWindow_ = mainWindow; }

  /// The window that the operator is working in, else the main window when it is visible, else none.
  QWidget* Window() const;

 private:
  QPointer<QWidget> mainWindow_;
};
