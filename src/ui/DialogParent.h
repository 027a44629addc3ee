#pragma once

#include <QPointer>
#include <QWidget>

/// Knows the parent window for a box or dialog opened now.
class DialogParent {
 public:
  /// A property of a window that stands beside the others and is parent of none.
  static constexpr const char* StandsBeside = "standsBeside";

  void SetMainWindow(QWidget* mainWindow) { mainWindow_ = mainWindow; }

  /// The window that the operator is working in, else the main window when it is visible, else none.
  QWidget* Window() const;

 private:
  QPointer<QWidget> mainWindow_;
};
