#include <QAction>
#include <QApplication>
#include <QFileDialog>
#include <QLineEdit>
#include <QTimer>

#include "app/Composition.h"
#include "app/frmRx.h"
#include "bench/FirstIdle.h"
#include "platform/ErrorReport.h"
#include "ui/Look.h"

namespace {

/// Loads `file` through the menu and the dialog.
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

/// bench-main-window [GAME]: the program as it starts, ended once it is usable, with GAME loaded first when
/// it is named.
int main(int argc, char** argv) {
  QApplication::setAttribute(Qt::AA_DontUseNativeDialogs);
  QApplication application(argc, argv);
  PrepareLook();
  Composition composition;
  frmRx window(composition.Services());
  composition.SetMainWindow(&window);
  if (!ReportErrors(composition.Boxes(), [&window] { window.FormLoad(); })) {
    return 1;
  }
  window.show();
  if (argc > 1) {
    LoadThroughMenu(window, QString::fromLocal8Bit(argv[1]));
  }
  QuitWhenUsable(window);
  return QApplication::exec();
}
