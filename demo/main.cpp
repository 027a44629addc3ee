#include <QApplication>
#include <QDir>
#include <cstdio>

#include "app/Program.h"
#include "demo/DemoRun.h"

/// tessarine-demo [--radio] FOLDER: takes one game from the download to the score sheets without an operator,
/// and leaves the results in FOLDER.
int main(int argc, char** argv) {
  QApplication::setAttribute(Qt::AA_DontUseNativeDialogs);
  QApplication application(argc, argv);
  QStringList arguments = QApplication::arguments().mid(1);
  const DemoSource source =
      arguments.removeAll(QStringLiteral("--radio")) > 0 ? DemoSource::Radio : DemoSource::BaseUnit;
  if (arguments.size() != 1 || !QDir(arguments.first()).exists()) {
    std::fprintf(stderr, "usage: tessarine-demo [--radio] FOLDER\n");
    return 2;
  }
  Program program;
  if (!program.Start()) {
    return 1;
  }
  const QStringList faults = DemoRun(program.Window(), source, QDir(arguments.first())).Run();
  for (const QString& fault : faults) {
    std::fprintf(stderr, "%s\n", qUtf8Printable(fault));
  }
  return faults.isEmpty() ? 0 : 1;
}
