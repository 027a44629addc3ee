#include <QApplication>
#include <QMainWindow>

#include "bench/FirstIdle.h"

/// The smallest program with a Qt main window, for comparison.
int main(int argc, char** argv) {
  QApplication application(argc, argv);
  QMainWindow window;
  window.resize(1180, 760);
  window.show();
  QuitWhenUsable(window);
  return QApplication::exec();
}
