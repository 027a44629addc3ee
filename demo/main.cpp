#include <QApplication>
#include <QDir>
#include <cstdio>

#include "app/Composition.h"
#include "app/frmRx.h"
#include "demo/DemoRun.h"
#include "platform/ErrorReport.h"

/// tessarine-demo FOLDER: one game pulled, shown and saved without an operator. Leaves the results in FOLDER.
int main(int argc, char** argv) {
  QApplication::setAttribute(Qt::AA_DontUseNativeDialogs);
  QApplication application(argc, argv);
  if (argc != 2 || !QDir(QString::fromLocal8Bit(argv[1])).exists()) {
    std::fprintf(stderr, "usage: tessarine-demo FOLDER\n");
    return 2;
  }
  PrepareApplication();
  Composition composition;
  frmRx window(composition.Services());
  composition.SetMainWindow(&window);
  if (!ReportErrors(composition.Boxes(), [&window] { window.FormLoad(); })) {
    return 1;
  }
  window.show();
  const QStringList faults = DemoRun(window, QDir(QString::fromLocal8Bit(argv[1]))).Run();
  for (const QString& fault : faults) {
    std::fprintf(stderr, "%s\n", qUtf8Printable(fault));
  }
  return faults.isEmpty() ? 0 : 1;
}
