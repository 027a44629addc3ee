#include <QApplication>
#include <QMainWindow>

#include "bench/FirstIdle.h"

/// The least that a program with a Qt main window can be.
int main(int argc, char** argv) {
  QApplication application(argc, argv);
  QMainWindow window;
  window.resize(1180, 760);
  window.show();
  QuitWhenUsable(window);
  return QApplication::exec();
}
