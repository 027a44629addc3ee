#include <QAction>
#include <QApplication>
#include <QElapsedTimer>
#include <QFileDialog>
#include <QLineEdit>
#include <QTimer>
#include <cstdio>

#include "app/Program.h"
#include "bench/FirstIdle.h"

namespace {

/// Loads `file` through the menu and the file dialog; milliseconds from the dialog's answer to the painted
/// board.
double LoadThroughMenu(QWidget& window, const QString& file) {
  QElapsedTimer since;
  QTimer answer;
  QObject::connect(&answer, &QTimer::timeout, &answer, [&file, &since] {
    if (auto* dialog = qobject_cast<QFileDialog*>(QApplication::activeModalWidget())) {
      dialog->findChild<QLineEdit*>(QStringLiteral("fileNameEdit"))->setText(file);
      since.start();
      QMetaObject::invokeMethod(dialog, "accept");
    }
  });
  answer.start(10);
  window.findChild<QAction*>(QStringLiteral("mnuLoadScores"))->trigger();
  QApplication::processEvents();
  return static_cast<double>(since.nsecsElapsed()) / 1e6;
}

}  // namespace

/// bench-main-window [GAME [--tell]]: starts the program, loads GAME if given, tells how many milliseconds
/// that took if asked to, and ends once the window is usable.
int main(int argc, char** argv) {
  QApplication::setAttribute(Qt::AA_DontUseNativeDialogs);
  QApplication application(argc, argv);
  Program program;
  if (!program.Start()) {
    return 1;
  }
  if (argc > 1) {
    const double milliseconds = LoadThroughMenu(program.Window(), QString::fromLocal8Bit(argv[1]));
    if (argc > 2) {
      std::printf("%.1f\n", milliseconds);
    }
  }
  QuitWhenUsable(program.Window());
  return QApplication::exec();
}
