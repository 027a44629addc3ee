#pragma once

#include <QApplication>
#include <QFont>
#include <QGuiApplication>
#include <QScreen>
#include <algorithm>
#include <stdexcept>
#include <string>

/// The screen of this name in Screens.json.
inline QScreen& ScreenNamed(const std::string& name) {
  const QList<QScreen*> screens = QGuiApplication::screens();
  const auto screen = std::find_if(screens.begin(), screens.end(),
                                   [&](const QScreen* each) { return each->name().toStdString() == name; });
  if (screen == screens.end()) {
    throw std::logic_error("No such screen: " + name);
  }
  return **screen;
}

/// The application's font has another size as long as this lives; 0 for the desktop's own.
class FontOfSize {
 public:
  explicit FontOfSize(int points) : before_(QApplication::font()) {
    if (points != 0) {
      QFont font = before_;
      font.setPointSize(points);
      QApplication::setFont(font);
    }
  }
  ~FontOfSize() { QApplication::setFont(before_); }
  FontOfSize(const FontOfSize&) = delete;
  FontOfSize& operator=(const FontOfSize&) = delete;

 private:
  QFont before_;
};
