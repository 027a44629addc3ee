#pragma once

#include <QPushButton>
#include <QTest>
#include <QWidget>
#include <stdexcept>
#include <string>

/// The control of this name in `window`. Throws std::logic_error if there is none of that type.
template <typename Control>
Control& Find(const QObject& window, const std::string& name) {
  auto* control = window.findChild<Control*>(QString::fromStdString(name));
  if (control == nullptr) {
    throw std::logic_error("No such control: " + name);
  }
  return *control;
}

/// Presses a button with the mouse.
inline void Press(const QObject& window, const std::string& button) {
  QTest::mouseClick(&Find<QPushButton>(window, button), Qt::LeftButton);
}

/// Presses a key wherever the keyboard's focus is in `window`.
inline void Type(QWidget& window, Qt::Key key, Qt::KeyboardModifiers modifiers = {}) {
  QWidget* focus = window.focusWidget();
  QTest::keyClick(focus != nullptr ? focus : &window, key, modifiers);
}

/// Brings a window to the front, so that its controls can have the keyboard's focus.
inline void Show(QWidget& window) {
  window.show();
  window.activateWindow();
  if (!QTest::qWaitForWindowActive(&window)) {
    throw std::runtime_error("The window does not become active");
  }
}
