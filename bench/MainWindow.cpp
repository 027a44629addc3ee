#include <QAction>
#include <QApplication>
#include <QFileDialog>
#include <QLineEdit>
#include <QTimer>

#include "app/Program.h"
#include "bench/FirstIdle.h"

namespace {

/// Loads `file` through the menu and the file dialog.
void LoadThroughMenu(QWidget& window, const QString& file) {
  QTimer answer;
  QObject::connect(&answer, &QTimer::timeout, &answer, [&file] {
    if (auto* dialog = qobject_cast<QFileDialog*>(QApplication::activeModalWidget())) {
      dialog->findChild<QLineEdit*>(QStringLiteral("fileNameEdit"))->setText(file);
      QMetaObject::invokeMethod(dialog, "accept");
    }
  });
  answer.start(10);
  window.findChild<QAction*>(QStringLiteral("mnuLoadScores"))->trigger();
}

}  // namespace

/// bench-main-window [GAME]: starts the program, loads GAME if given, and ends once the window is usable.
int main(int argc, char** argv) {
  QApplication::setAttribute(Qt::AA_DontUseNativeDialogs);
  QApplication application(argc, argv);
  Program program;
  if (!program.Start()) {
    return 1;
  }
  if (argc > 1) {
    LoadThroughMenu(program.Window(), QString::fromLocal8Bit(argv[1]));
  }
  QuitWhenUsable(program.Window());
  return QApplication::exec();
}
