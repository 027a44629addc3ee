#pragma once

#include <QPointer>
#include <QWidget>

#include "platform/MessageBoxes.h"

class QtMessageBoxes : public MessageBoxes {
 public:
  /// Window that boxes belong to while no window of the program is active.
  void SetMainWindow(QWidget* mainWindow) { mainWindow_ = mainWindow; }

  BoxAnswer Show(const std::string& text, const std::string& title, BoxIcon icon,
                 BoxButtons buttons = BoxButtons::Ok) override;

 private:
  QPointer<QWidget> mainWindow_;
};
